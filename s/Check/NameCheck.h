// The check of one name, for whoever finds one that is written.
#pragma once

#include "Check/Context.h"

#include <string_view>

namespace Orn_Hdl::Checking {

/// A name, and where it is written.
struct NameUse {
    /// The name without a range.
    std::string_view name;
    /// What bears it, with its article.
    std::string_view what;
    /// \{
    /// The command that brought it in; without `first`, the name is the first of its names.
    Kind kind = Kind::Design;
    std::string_view first;
    std::string_view second;
    /// \}
    /// May be null.
    const Object* object = nullptr;
    bool isInVerilog = true;
    bool isInVhdl = true;
    /// Whether Yosys does not read where it is written.
    bool isHiddenFromYosys = false;
    /// How the Verilog writer spells it.
    CaseType nameCase = HdlOptions::VerilogOption::DEFSULT;

    Cause MakeCause() const;
};

/// Checks length, characters, underscores and reserved words.
void CheckName(Context& context, const NameUse& use);

} // namespace Orn_Hdl::Checking
