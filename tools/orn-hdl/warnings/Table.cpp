#include "warnings/Table.h"

namespace Tool {

namespace {

constexpr std::array<Warning, static_cast<std::size_t>(Slip::Count)> Warnings = {{
    {Slip::ConstantDigit, "constant-digit",
     "a constant with a digit that its base does not have, or with an unknown base",
     "It is written as it stands, and compilers reject it.",
     "ADD SIGNAL D(3:0)\nASSIGN CONSTANT D(3:0) 4:B:1012",
     "digits of the base: LENGTH:BASE:DIGITS with base B, O or H, or decimal digits alone"},
    {Slip::ScalarConstant, "scalar-constant",
     "a signal or pin of one bit tied to something else than 0 or 1",
     "One bit holds no more; Verilog cuts the constant, VHDL rejects it.",
     "ADD SIGNAL A\nASSIGN CONSTANT A 4:B:1010", "0 or 1, or a bus of the constant's width"},
    {Slip::BracketNet, "bracket-net",
     "a bit, slice or compound whose brackets make it a net of that name",
     "At the first use of a name, only parentheses make a bit, a slice or a compound. Other "
     "brackets, and what has another form, make a net whose name contains them.",
     "ADD SIGNAL D(7:0)\nADD SIGNAL A\nCONNECT SIGNAL A D[3]",
     "parentheses: D(3), D(7:4), A,D(3:0)"},
    {Slip::PortRange, "port-range", "a reference that moves or widens the range of a port",
     "A slice that is as wide as its bus, or wider, gives the bus its range, also if the bus is a "
     "port.",
     "ADD PORT P(7:0) input\nADD SIGNAL B(15:0)\nCONNECT SIGNAL B(15:0) P(15:0)",
     "a slice within the range of the port"},
    {Slip::ScalarBesideBus, "scalar-beside-bus",
     "a scalar and a bus of one name, of which the second one was just made",
     "A bus is referred to with its whole range: its name alone is another net, and both are "
     "written by the same name.",
     "ADD SIGNAL D(7:0)\nADD SIGNAL B(15:0)\nCONNECT SIGNAL B(7:0) D",
     "the whole range, such as D(7:0)"},
    {Slip::SynthesisTool, "synthesis-tool", "an unknown word for SET SYNTHESIS",
     "An unknown word chooses QSN.", "SET SYNTHESIS SYNPLIFY",
     "QSN, EXEMPLAR, SYNPLICITY, SYNOPSYS, VERILOG2001 or PRECISION"},
    {Slip::FlagWord, "flag-word", "a flag word that is neither true nor false",
     "Every word but false is read as true.", "SUPPRESS CONFIGURATION off", "true or false"},
    {Slip::AttributeOption, "attribute-option",
     "an option of an attribute that is read as its name or its value",
     "-TYPE= is read before the attribute's name only; -GENERIC= and -SYNATTR= belong to SET ... "
     "ATTRIBUTE OPTION.",
     "ADD SIGNAL A\nADD SIGNAL ATTRIBUTE A KEEP -TYPE=Boolean",
     "-TYPE= before the attribute's name; SET ... ATTRIBUTE OPTION for the others"},
    {Slip::NoEffect, "no-effect", "a command that changes nothing in any output",
     "It is read and kept, and no netlist shows it.", "FLATTEN BUS true", "removing the line"},
}};

} // namespace

const std::array<Warning, static_cast<std::size_t>(Slip::Count)>& GetWarnings() {
    return Warnings;
}

const Warning& GetWarning(Slip slip) {
    return Warnings[static_cast<std::size_t>(slip)];
}

std::vector<RuleTexts> GetWarningRules() {
    std::vector<RuleTexts> rules;
    rules.reserve(Warnings.size());
    for (const Warning& warning : Warnings) {
        rules.push_back({warning.name, warning.what, warning.why, warning.help});
    }
    return rules;
}

bool WarningOptions::Drop(std::string_view name) {
    if (name == All) {
        dropped.set();
        return true;
    }
    for (const Warning& warning : Warnings) {
        if (warning.name == name) {
            dropped.set(static_cast<std::size_t>(warning.slip));
            return true;
        }
    }
    return false;
}

std::vector<std::string> GetWarningNames() {
    std::vector<std::string> names;
    names.reserve(Warnings.size());
    for (const Warning& warning : Warnings) {
        names.emplace_back(warning.name);
    }
    return names;
}

} // namespace Tool
