// A design as a JSON netlist tells it: modules with ports, nets and cells, whose connections are
// lists of numbered bits. Large tables are flat: a million cells are a few arrays.
#pragma once

#include <cstdint>
#include <cstring>
#include <memory_resource>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// The file cannot be imported: `what()` tells where in it, and why.
class Error : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// A place in a JSON file, such as modules.top.cells["u.1"].connections.A[3].
class Path {
public:
    Path() = default;
    explicit Path(std::string_view key) { AddKey(key); }

    Path& AddKey(std::string_view key);
    Path& AddIndex(std::size_t index);
    const std::string& GetText() const noexcept { return text_; }

private:
    std::string text_;
};

/// One bit of a port, net or connection: the index of a net bit, or one of four constants.
using Bit = std::uint32_t;
constexpr Bit Zero = 0xFFFFFFFC;
constexpr Bit One = 0xFFFFFFFD;
constexpr Bit Unknown = 0xFFFFFFFE;
constexpr Bit HighImpedance = 0xFFFFFFFF;

constexpr bool IsNet(Bit bit) noexcept {
    return bit < Zero;
}

/// A stretch of one of a module's tables.
struct Span {
    std::uint32_t start = 0;
    std::uint32_t count = 0;
};

enum class Direction : std::uint8_t { Input, Output, InOut, Untold };

/// How the bits of a port or net are numbered. The first bit in the file is the rightmost one.
struct Range {
    std::int64_t offset = 0;
    bool upto = false;
};

/// The value of a parameter or attribute.
struct Value {
    enum Kind : std::uint8_t { Bits, Text, Integer };

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
    Direction direction = Direction::Untold;
    Range range;
    Span bits;
};

struct Net {
    std::string_view name;
    bool hidden = false;
    Range range;
    Span bits;
    Span attributes;
};

struct Connection {
    /// Index into the pins of the cell's type.
    std::uint32_t pin = 0;
    Span bits;
};

struct Cell {
    std::string_view name;
    bool hidden = false;
    std::uint32_t type = 0;
    Span connections;
    Span parameters;
    Span attributes;
};

struct Module {
    std::string_view name;
    /// Marked as one whose contents do not matter.
    bool blackBox = false;
    bool top = false;
    bool hasMemories = false;
    std::vector<ModulePort> ports;
    std::vector<NamedValue> defaults;
    std::vector<Net> nets;
    std::vector<Cell> cells;

    std::vector<Bit> bits;
    std::vector<Connection> connections;
    std::vector<NamedValue> values;
    /// How many net bits there are.
    std::uint32_t netBits = 0;
};

/// A pin of a cell type, as the cells tell it.
struct TypePin {
    std::string_view name;
    Direction direction = Direction::Untold;
};

/// What the cells of one type have in common.
struct CellType {
    std::string_view name;
    std::vector<TypePin> pins;
    std::unordered_map<std::string_view, std::uint32_t> pinIndex;

    std::uint32_t GetOrAddPin(std::string_view pin);
};

struct Design {
    std::vector<Module> modules;
    std::vector<CellType> types;

    /// A copy of a text that lives as long as the design.
    std::string_view Keep(std::string_view text);

private:
    std::pmr::monotonic_buffer_resource texts_;
};

} // namespace Tool::Import
