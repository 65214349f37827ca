#include "HdlCmd/LineBatches.h"
#include "HdlModel/Netlist/ReadAhead.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"
#include "Port/LinesAtHand.h"
#include "Port/OrderedWork.h"
#include "Port/Prefetch.h"

#include <array>
#include <memory>

namespace Orn_Hdl {

struct CommandReader::Implementation {
    static constexpr std::size_t Distance = ReadAhead::Distance;
    /// Room for a line as long as this is kept for the next.
    static constexpr std::uint64_t LongLine = 1 << 20;

    explicit Implementation(Model& owner) noexcept : model(owner) {}

    SplitLine& GetFree() noexcept { return lines[(first + count) % Distance]; }
    bool HasThreads() const {
        return Port::OrderedWork::GetWorkersFor(model.GetOptions()->threads) > 0;
    }
    void Add() noexcept;
    void Leave() noexcept;
    void LookAhead();
    void LookAheadInBuffer();
    void LookAheadInBatches();

    Model& model;
    /// While there are batches, another thread uses it.
    alignas(Port::CacheLine) Port::File file;
    /// A ring of the line in hand, if `Next` has given one, and those behind it.
    alignas(Port::CacheLine) std::array<SplitLine, Distance> lines;
    std::size_t first = 0;
    std::size_t count = 0;
    bool isInHand = false;
    std::uint64_t position = 0;
    /// The lines behind the ring, if they are split on another processor; the file is then theirs.
    std::unique_ptr<LineBatches> batches;
};

/// Takes the line that the free place of the ring has got.
void CommandReader::Implementation::Add() noexcept {
    ++count;
    // The line before: a processor waits long before it can read what it has just written.
    if (count > 1) {
        ReadAhead::Note(*model.GetNetlist(), lines[(first + count - 2) % Distance].words);
    }
}

/// Gives up the line in hand.
void CommandReader::Implementation::Leave() noexcept {
    if (isInHand) {
        lines[first].Release(LongLine);
        first = (first + 1) % Distance;
        --count;
        isInHand = false;
    }
}

/// Fills the ring.
void CommandReader::Implementation::LookAhead() {
    if (batches == nullptr) {
        LookAheadInBuffer();
    }
    if (batches != nullptr) {
        LookAheadInBatches();
    }
}

void CommandReader::Implementation::LookAheadInBuffer() {
    while (count < Distance && GetFree().TakeAtHand(file)) {
        Add();
    }
    if (count == Distance) {
        return;
    }
    if (Port::LinesAtHand::GoesOn(file) && HasThreads()) {
        batches = std::make_unique<LineBatches>(file, LineBatches::Settings());
    } else if (count == 0 && GetFree().Take(file)) {
        // Only for the line that is asked for is it worth waiting.
        Add();
        LookAheadInBuffer();
    }
}

void CommandReader::Implementation::LookAheadInBatches() {
    Foresight::Hashes names;
    while (count < Distance && batches->Next(GetFree(), names)) {
        ++count;
        ReadAhead::Note(*model.GetNetlist(), names);
    }
    if (count == 0) {
        batches.reset();
    }
}

CommandReader::CommandReader(Model& model)
    : implementation_(std::make_unique<Implementation>(model)) {}

CommandReader::~CommandReader() = default;

bool CommandReader::Open(const char* fileName) {
    Implementation& own = *implementation_;
    own.batches.reset();
    own.count = 0;
    own.isInHand = false;
    own.position = 0;
    return own.file.open(fileName, Port::File::Read, true);
}

const StringArray* CommandReader::Next() {
    Implementation& own = *implementation_;
    own.Leave();
    own.LookAhead();
    if (own.count == 0) {
        return nullptr;
    }
    own.isInHand = true;
    own.position += own.lines[own.first].bytes;
    return &own.lines[own.first].words;
}

std::uint64_t CommandReader::GetPosition() const noexcept {
    return implementation_->position;
}

int CommandReader::GetError() const noexcept {
    // A failure is told when the lines before it have been given.
    return implementation_->batches != nullptr ? 0 : implementation_->file.GetError();
}

} // namespace Orn_Hdl
