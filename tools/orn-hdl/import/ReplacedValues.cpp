#include "import/ReplacedValues.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace Tool::Import {

namespace {

class ReplacedValues {
public:
    ReplacedValues(const Module& top, const UnknownValues& unknown, Warnings& warnings)
        : top_(top), replacement_(GetDigit(unknown.Replace(Unknown))), warnings_(warnings) {}

    void CountPort(const ModulePort& port);
    void CountConnection(const Cell& cell, const Span& bits, const ImportedPin& pin);
    void CountParameters(const Cell& cell);
    bool HasBits() const noexcept { return hasBits_; }

private:
    void Add(const JsonPath& path, Bit bit) {
        hasBits_ = true;
        warnings_.Add(path, std::string("the value ") + (bit == Unknown ? "x" : "z") + " becomes " +
                                replacement_);
    }

    const Module& top_;
    const char replacement_;
    Warnings& warnings_;
    /// Whether a bit was replaced.
    bool hasBits_ = false;
};

/// An inout port that is z stays open.
void ReplacedValues::CountPort(const ModulePort& port) {
    for (std::uint32_t i = 0; i < port.bits.count; ++i) {
        const Bit bit = top_.GetBit(port.bits, i);
        if (bit == Unknown || (bit == HighImpedance && port.direction != Direction::InOut)) {
            Add(top_.GetPath("ports", port.name).AddKey("bits").AddIndex(i), bit);
        }
    }
}

void ReplacedValues::CountConnection(const Cell& cell, const Span& bits, const ImportedPin& pin) {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        if (const Bit bit = top_.GetBit(bits, i); bit == Unknown || bit == HighImpedance) {
            Add(top_.GetPinPath(cell, pin.oldName).AddIndex(i), bit);
        }
    }
}

/// Counts whole parameters, whose contents may be those of a memory.
void ReplacedValues::CountParameters(const Cell& cell) {
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        if (value.value.kind == Value::Bits &&
            value.value.text.find_first_of("xz") != std::string_view::npos) {
            warnings_.Add(top_.GetPath("cells", cell.name).AddKey("parameters").AddKey(value.name),
                          std::string("x and z in a parameter become ") + replacement_);
        }
    }
}

} // namespace

bool TellReplacedValues(const Module& top, const ImportedComponents& components,
                        const UnknownValues& unknown, Warnings& warnings) {
    if (!unknown.HasReplacement()) {
        return false;
    }
    ReplacedValues values(top, unknown, warnings);
    for (const ModulePort& port : top.ports) {
        values.CountPort(port);
    }
    for (std::size_t c = 0; c < top.cells.size(); ++c) {
        const Cell& cell = top.cells[c];
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const Connection& connection = top.connections[cell.connections.start + k];
            values.CountConnection(cell, connection.bits,
                                   components.GetOf(c).GetPin(connection.pin));
        }
        if (unknown.HasDigit()) {
            values.CountParameters(cell);
        }
    }
    return values.HasBits();
}

} // namespace Tool::Import
