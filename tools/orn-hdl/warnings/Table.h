// The warnings of `orn-hdl run`: what help, pages and logs say of them.
#pragma once

#include "diagnostics/MachineFormats.h"

#include <array>
#include <bitset>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Tool {

/// The places of the table.
enum class Slip : std::size_t {
    ConstantDigit,
    ScalarConstant,
    BracketNet,
    PortRange,
    ScalarBesideBus,
    SynthesisTool,
    FlagWord,
    AttributeOption,
    NoEffect,
    Count
};

/// What is known of one kind of warning.
struct Warning {
    Slip slip;
    /// By which the command line names it.
    std::string_view name;
    /// The slip, as a noun.
    std::string_view what;
    /// What becomes of it.
    std::string_view why;
    /// Commands that are warned of; the last line is the slip.
    std::string_view example;
    std::string_view help;
};

const std::array<Warning, static_cast<std::size_t>(Slip::Count)>& GetWarnings();
const Warning& GetWarning(Slip slip);
/// The table as a log of SARIF shows it.
std::vector<RuleTexts> GetWarningRules();

/// Which warnings are printed, and whether they are errors.
struct WarningOptions {
    /// The name that stands for all warnings.
    static constexpr std::string_view All = "all";

    std::bitset<static_cast<std::size_t>(Slip::Count)> dropped;
    bool areErrors = false;

    /// Drops the warnings of a name. \return false if there are none of that name.
    bool Drop(std::string_view name);
    bool Has(Slip slip) const { return !dropped[static_cast<std::size_t>(slip)]; }
};

/// The names of all warnings.
std::vector<std::string> GetWarningNames();

} // namespace Tool
