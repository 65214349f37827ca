// The values of Verilog's numbers, as far as a library needs them.
#pragma once

#include "cells/CellDeclaration.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace Tool::Cells {

/// Sets the default of a parameter to a number. Leaves it an expression if the number is none that
/// a netlist can hold.
/// \param text the number as it stands in the file.
/// \param width the width that the parameter is declared with.
void SetNumber(CellParameter& parameter, std::string_view text, bool isNegative,
               std::optional<std::int64_t> width);

/// Adds up the tokens of a sum of plain numbers, such as 8-1.
class ConstantSum {
public:
    void Add(std::string_view token) noexcept;
    /// The sum; nothing if the tokens were anything else.
    std::optional<std::int64_t> Get() const noexcept;

private:
    std::int64_t sum_ = 0;
    std::int64_t sign_ = 1;
    bool needsNumber_ = true;
    bool isValid_ = true;
};

} // namespace Tool::Cells
