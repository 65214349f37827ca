#include "HdlCmd/LineBatches.h"

namespace Orn_Hdl {

LineBatches::LineBatches(Port::File& file, const Settings& settings)
    : settings_(settings), file_(file), batches_(settings.batches),
      work_({settings.workers, settings.batches, true},
            [this](std::size_t number) { return Fill(batches_[number % batches_.size()]); }) {}

/// Reads the lines of a batch. \return false if there are none.
bool LineBatches::Fill(Batch& batch) noexcept {
    batch.count = 0;
    try {
        batch.lines.resize(settings_.lines);
        std::uint64_t bytes = 0;
        std::string_view text;
        while (batch.count < batch.lines.size() && bytes < settings_.bytes &&
               file_.NextLine(text)) {
            Line& line = batch.lines[batch.count];
            line.split.Set(file_, text);
            line.names = Foresight::HashNames(line.split.words);
            ++batch.count;
            bytes += line.split.bytes;
        }
    } catch (...) {
        batch.failure = std::current_exception();
    }
    return batch.count > 0 || batch.failure != nullptr;
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
