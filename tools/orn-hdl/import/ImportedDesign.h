// The contents of a JSON netlist: modules with ports, nets and cells, whose connections are lists
// of numbered bits. Large tables are flat: a million cells are a few arrays.
#pragma once

#include "import/JsonPath.h"

#include <cstdint>
#include <memory_resource>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// One bit of a port, net or connection: the index of a net bit, or one of four constants.
using Bit = std::uint32_t;
constexpr Bit Zero = 0xFFFFFFFC;
constexpr Bit One = 0xFFFFFFFD;
constexpr Bit Unknown = 0xFFFFFFFE;
constexpr Bit HighImpedance = 0xFFFFFFFF;

constexpr bool IsNet(Bit bit) noexcept {
    return bit < Zero;
}

/// The digit of a constant bit: x and z are don't cares.
constexpr char GetDigit(Bit bit) noexcept {
    return bit == Zero ? '0' : bit == One ? '1' : '-';
}

/// A run of consecutive entries in one of a module's tables.
struct Span {
    std::uint32_t start = 0;
    std::uint32_t count = 0;
};

/// `Unspecified` is the direction of a pin whose cell type has no module and whose cells give no
/// "port_directions".
enum class Direction : std::uint8_t { Input, Output, InOut, Unspecified };

/// The indices of the bits of a port or net. The first bit in the file is the rightmost one.
struct BitRange {
    std::int64_t offset = 0;
    /// Whether the range ascends: the leftmost bit has the lowest index.
    bool upto = false;
};

/// The value of a parameter or attribute.
struct Value {
    enum Kind : std::uint8_t {
        Bits,
        Text,
        Integer,
        /// A default in a cell library that is not a plain literal.
        Expression
    };

    Kind kind = Text;
    /// The digits 0, 1, x and z of `Bits`, leftmost first, or the text.
    std::string_view text;
    std::int32_t integer = 0;
};

struct NamedValue {
    std::string_view name;
    Value value;
};

struct ModulePort {
    std::string_view name;
    Direction direction = Direction::Unspecified;
    BitRange range;
    Span bits;
    /// Whether cells may do without the pin: it is a power pin of a cell library.
    bool isPower = false;
};

struct Net {
    std::string_view name;
    /// Whether a program generated the name.
    bool hidden = false;
    BitRange range;
    Span bits;
    Span attributes;
};

/// The digits with which registers that drive a net start, the leftmost first; at least one is 0
/// or 1. The net says so by its attribute "init".
struct FirstValue {
    /// Index into the nets of the module.
    std::uint32_t net = 0;
    std::string_view digits;
};

struct Connection {
    /// Index into the pins of the cell's type.
    std::uint32_t pin = 0;
    Span bits;
};

struct Cell {
    std::string_view name;
    /// Whether a program generated the name.
    bool hidden = false;
    std::uint32_t type = 0;
    Span connections;
    Span parameters;
    Span attributes;
};

struct Module {
    std::string_view name;
    /// Whether the module is marked as a black box or white box.
    bool blackBox = false;
    /// Whether the module is marked as the top of the design.
    bool top = false;
    bool hasMemories = false;
    /// Whether the module comes from a cell library, where ports may have an unknown width of 0.
    bool isLibraryCell = false;
    std::vector<ModulePort> ports;
    /// The default values of parameters.
    std::vector<NamedValue> defaults;
    std::vector<Net> nets;
    std::vector<FirstValue> firstValues;
    std::vector<Cell> cells;

    std::vector<Bit> bits;
    std::vector<Connection> connections;
    std::vector<NamedValue> values;
    /// The number of net bits.
    std::uint32_t netBits = 0;

    Bit GetBit(const Span& run, std::uint32_t i) const { return bits[run.start + i]; }
    /// The place of an object of one of the module's tables, such as "cells".
    JsonPath GetPath(std::string_view table, std::string_view object) const;
    JsonPath GetPinPath(const Cell& cell, std::string_view pin) const;
    Place GetPlace(const Cell& cell, std::string_view part, std::string_view partName) const {
        return Place{name, "cells", cell.name, part, partName};
    }
};

/// A pin of a cell type, collected from the cells.
struct TypePin {
    std::string_view name;
    Direction direction = Direction::Unspecified;
};

/// The type of cells.
struct CellType {
    std::string_view name;
    std::vector<TypePin> pins;
    std::unordered_map<std::string_view, std::uint32_t> pinIndex;

    std::uint32_t GetOrAddPin(std::string_view pin);
};

/// A whole file.
struct ImportedDesign {
    std::vector<Module> modules;
    std::vector<CellType> types;

    /// A copy of a text that lives as long as the design.
    std::string_view Keep(std::string_view text);

private:
    std::pmr::monotonic_buffer_resource texts_;
};

} // namespace Tool::Import
