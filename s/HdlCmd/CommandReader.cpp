#include "HdlModel/Netlist/ReadAhead.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"
#include "Port/LinesAtHand.h"

#include <array>

namespace Orn_Hdl {

struct CommandReader::Implementation {
    struct Line {
        StringArray words;
        std::uint64_t bytes = 0;
    };

    static constexpr std::size_t Distance = ReadAhead::Distance;
    /// Room for a line as long as this is kept for the next.
    static constexpr std::uint64_t LongLine = 1 << 20;

    explicit Implementation(Model& owner) noexcept : model(owner) {}

    void Split(std::string_view text) {
        Line& line = lines[(first + count) % Distance];
        line.bytes = file.GetLineSize();
        line.words.Empty();
        line.words.ParseCommandLine(text.substr(0, text.find('\0')));
        ++count;
        ReadAhead::Note(*model.GetNetlist(), line.words);
    }

    Model& model;
    Port::File file;
    /// A ring of the line in hand, if `Next` has given one, and those behind it.
    std::array<Line, Distance> lines;
    std::size_t first = 0;
    std::size_t count = 0;
    bool isInHand = false;
    std::uint64_t position = 0;
};

CommandReader::CommandReader(Model& model)
    : implementation_(std::make_unique<Implementation>(model)) {}

CommandReader::~CommandReader() = default;

bool CommandReader::Open(const char* fileName) {
    Implementation& own = *implementation_;
    own.count = 0;
    own.isInHand = false;
    own.position = 0;
    return own.file.open(fileName, Port::File::Read, true);
}

const StringArray* CommandReader::Next() {
    Implementation& own = *implementation_;
    if (own.isInHand) {
        Implementation::Line& done = own.lines[own.first];
        if (done.bytes > Implementation::LongLine) {
            done.words = StringArray();
        }
        own.first = (own.first + 1) % Implementation::Distance;
        --own.count;
        own.isInHand = false;
    }
    std::string_view text;
    // Only for the line that is asked for is it worth waiting.
    if (own.count == 0 && own.file.NextLine(text)) {
        own.Split(text);
    }
    while (own.count < Implementation::Distance && Port::LinesAtHand::Next(own.file, text)) {
        own.Split(text);
    }
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
    return implementation_->file.GetError();
}

} // namespace Orn_Hdl
