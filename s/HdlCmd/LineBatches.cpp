#include "HdlCmd/LineBatches.h"

namespace Orn_Hdl {

LineBatches::LineBatches(Port::File& file, const Settings& settings)
    : settings_(settings), file_(file), batches_(settings.batches),
      work_(
          {settings.workers, settings.batches, true},
          [this](std::size_t number) { return Fill(batches_[number % batches_.size()]); },
          [this] { memory_.Replenish(); }) {}

/// Reads the lines of a batch. \return false if there are none.
bool LineBatches::Fill(Batch& batch) noexcept {
    try {
        Read(batch);
    } catch (...) {
        batch.failure = std::current_exception();
    }
    return !batch.lines.empty() || batch.failure != nullptr;
}

void LineBatches::Read(Batch& batch) {
    // Memory for as many characters is kept for the next batch.
    constexpr std::size_t LongBatch = std::size_t(1) << 18;
    batch.lines.clear();
    batch.words.Empty(LongBatch);
    batch.lines.reserve(settings_.lines);
    std::uint64_t bytes = 0;
    while (batch.lines.size() < settings_.lines && bytes < settings_.bytes && line_.Take(file_)) {
        batch.words.Add(line_.words);
        batch.lines.push_back({line_.bytes, Foresight::HashNames(line_.words)});
        bytes += line_.bytes;
        line_.Release(LongBatch);
    }
}

/// Steps to the next batch. \return false if there is none.
bool LineBatches::NextBatch() {
    if (batch_ != nullptr && batch_->failure != nullptr) {
        std::rethrow_exception(std::exchange(batch_->failure, nullptr));
    }
    batch_ = nullptr;
    given_ = 0;
    if (!work_.Next()) {
        return false;
    }
    batch_ = &batches_[work_.GetPlace()];
    return true;
}

} // namespace Orn_Hdl
