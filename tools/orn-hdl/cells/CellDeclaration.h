// What a library file tells of a cell: its ports and parameters.
#pragma once

#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Cells {

/// A file that cannot be read as a cell library.
class Error : public std::runtime_error {
public:
    Error(std::size_t line, const std::string& text) : std::runtime_error(text), line_(line) {}

    std::size_t GetLine() const noexcept { return line_; }

private:
    std::size_t line_;
};

enum class PortDirection : std::uint8_t { Input, Output, InOut, Unknown };

struct PortRange {
    std::int64_t left = 0;
    std::int64_t right = 0;
};

struct CellPort {
    enum Width : std::uint8_t {
        Scalar,
        Bus,
        /// The width depends on parameters, or is not understood.
        Unknown
    };

    std::string name;
    PortDirection direction = PortDirection::Unknown;
    Width width = Scalar;
    /// The range of a bus.
    PortRange range;
    /// Whether netlists may do without the port: it is a power pin.
    bool isPower = false;
};

struct CellParameter {
    enum Kind : std::uint8_t {
        Bits,
        Text,
        Integer,
        /// The default is not a plain literal.
        Expression
    };

    std::string name;
    Kind kind = Expression;
    /// The digits 0, 1, x and z of `Bits`, leftmost first, or the text.
    std::string text;
    std::int32_t integer = 0;
};

struct CellDeclaration {
    std::string name;
    std::vector<CellPort> ports;
    std::vector<CellParameter> parameters;
};

/// The widest bus whose range is taken from a library.
constexpr std::int64_t WidestBus = std::int64_t(1) << 20;

/// Sets the width of a port; a range that is too wide is unknown.
inline void SetRange(CellPort& port, PortRange range) noexcept {
    constexpr std::int64_t Highest = std::int64_t(1) << 31;
    const bool isValid = range.left < Highest && range.left > -Highest && range.right < Highest &&
                         range.right > -Highest && range.left - range.right < WidestBus &&
                         range.right - range.left < WidestBus;
    port.width = isValid ? CellPort::Bus : CellPort::Unknown;
    port.range = isValid ? range : PortRange();
}

/// The cells of a Verilog file: the headers of its modules. Bodies are passed over, except for the
/// declarations of ports and parameters. \throws Error
std::vector<CellDeclaration> ReadVerilogCells(std::string_view text);
/// The cells of a Liberty file. \throws Error
std::vector<CellDeclaration> ReadLibertyCells(std::string_view text);

} // namespace Tool::Cells
