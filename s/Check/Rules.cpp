#include "Check/Rules.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl {

namespace Checking {

namespace {

using Verdicts = Check::Verdicts;

/// Nine letters a rule: verilog-1995, verilog-2005, systemverilog-2017, vhdl-93, vhdl-2008, icarus,
/// verilator, yosys, ghdl.
constexpr Check::Rule Rules[] = {
    {"reserved-word", Verdicts("rrrrrrrrr"), "a name that is a reserved word of the target",
     "A reserved word is no identifier (IEEE 1364-2005, 3.7.4 and annex B; IEEE 1800-2017, annex "
     "B; "
     "IEEE 1076-2008, 15.10).",
     "ADD PORT signal Input", "another name"},
    {"illegal-name", Verdicts("rrrrrrrrr"), "a name with characters that the target does not allow",
     "A Verilog identifier is a letter or _ followed by letters, digits, _ and $ (IEEE 1364-2005, "
     "3.7); a VHDL identifier is a letter followed by letters, digits and _ (IEEE 1076-2008, "
     "15.4).",
     "ADD PORT A$1 Input", "letters, digits and single underscores, a letter first"},
    {"underscores", Verdicts("...rr...r"),
     "a name with an underscore at an end, or with two in a row",
     "VHDL allows an underscore between two letters or digits only (IEEE 1076-2008, 15.4).",
     "ADD PORT n__m Input", "other names"},
    {"name-length", Verdicts("www..r..r"), "a name that is longer than a tool takes",
     "GHDL takes 1,023 characters and Icarus some 16,000; a Verilog tool need not take more than "
     "1,024 (IEEE 1364-2005, 3.7).",
     "ADD PORT followed by a name of 1,024 characters", "a shorter name"},
    {"bit-pin", Verdicts("...rr...r"), "a pin of a component that is a single bit of a bus",
     "VHDL declares ports whole: no single bit of one can be declared (IEEE 1076-2008, 6.5.6.3).",
     "ADD PIN CELL I(3) Input", "a scalar pin, or a bus pin with its whole range"},
    {"pin-twice", Verdicts("rrrrrrr.r"), "two pins of one component with the same base name",
     "Both are written as one name, and a port is connected once (IEEE 1364-2005, 12.3.6) and "
     "declared once (IEEE 1076-2008, 12.3).",
     "ADD PIN CELL Q(1) Output\nADD PIN CELL Q(0) Output", "one bus pin Q(1:0)"},
    {"name-clash", Verdicts("rrrrrrrrr"), "two things of one scope that bear the same name",
     "A name is declared once in a scope: in VHDL generics, ports, signals, components, labels and "
     "attributes share one, whatever the letter case (IEEE 1076-2008, 12.1 and 12.3); in Verilog "
     "parameters, nets and instances (IEEE 1364-2005, 12.7).",
     "ADD PORT D(3:0) Input\nADD SIGNAL D", "another name for one of them"},
    {"module-name", Verdicts("......r.w"), "a name in the design that is the name of the design",
     "It hides the module or entity within itself. That is legal, but Verilator cannot have a port "
     "of that name.",
     "SET NETLIST NAME X\nADD PORT X Input", "another name for one of them"},
    {"own-component", Verdicts("rrrrrrwrr"), "a component that bears the name of the design",
     "The design would be a part of itself (IEEE 1364-2005, 12.1.2; IEEE 1076-2008, 7.3.3).",
     "SET NETLIST NAME X\nADD COMPONENT X", "another name for one of them"},
    {"hidden-library", Verdicts("........w"), "a name that hides a library which the netlist names",
     "Within the design the name no longer denotes the library (IEEE 1076-2008, 12.3).",
     "ADD PORT work Input", "another name"},
    {"predefined-name", Verdicts("...rr...r"),
     "a name that hides a type or value which the netlist uses",
     "The declarations that follow use the name for the type (IEEE 1076-2008, 12.3).",
     "ADD PORT std_logic Input", "another name"},
    {"predefined-attribute", Verdicts("...rr...r"),
     "an attribute that bears the name of a predefined one",
     "A predefined attribute cannot be given a value (IEEE 1076-2008, 7.2).",
     "ADD SIGNAL ATTRIBUTE A length 5\nSET SIGNAL ATTRIBUTE OPTION A length -SYNATTR=ASSIGN",
     "another name"},
    {"pin-width", Verdicts("...rrwwwr"), "a signal of another width than its pin",
     "In VHDL formal and actual have the same number of elements (IEEE 1076-2008, 6.5.6.3); "
     "Verilog "
     "pads or cuts (IEEE 1364-2005, 12.3.9.2).",
     "ADD PIN REG4 D(3:0) Input\nCONNECT SIGNAL A(7:0) U1.D(3:0)", "a slice of the pin's width"},
    {"slice-outside", Verdicts("wwwrrrwrr"), "a bit or slice beyond its bus",
     "VHDL rejects an index out of range (IEEE 1076-2008, 8.4 and 8.5); Verilog reads x and drops "
     "what is written (IEEE 1364-2005, 5.2.1).",
     "ADD PORT A(3:0) Input\nCONNECT SIGNAL A(7) U1.I",
     "declaring the bus wide enough before its parts are used"},
    {"alias-width", Verdicts("...rr.w.r"), "an alias between signals of different widths or kinds",
     "A VHDL assignment needs equal types and lengths (IEEE 1076-2008, 10.5); Verilog pads or cuts "
     "at the left (IEEE 1364-2005, 5.5).",
     "CONNECT SIGNAL Y(3:0) A(1:0)", "signals of one width"},
    {"alias-bits", Verdicts("...mm.w.m"),
     "an alias of different widths that is written bit by bit in VHDL",
     "VHDL assigns from the left as many bits as the narrower side has; Verilog assigns from the "
     "right and pads with 0 (IEEE 1364-2005, 5.5).",
     "CONNECT SIGNAL Y(3:0) A,B", "signals of one width"},
    {"wide-bus", Verdicts("wwwwwwwww"), "a bus that is wider, or indexed higher, than a tool takes",
     "A Verilog tool need not take more than 65,536 bits (IEEE 1364-2005, 4.3.1). Yosys rejects "
     "indices near 2,147,483,647. The writers write an index of more than 32 bits as the nearest "
     "one.",
     "ADD PORT D(2147483647:2147483640) Input", "narrower buses with smaller indices"},
    {"constant-digits", Verdicts("mmm..mmm."),
     "a constant without length and base, whose digits Verilog reads as a decimal number",
     "Verilog reads 1010 as one thousand and ten (IEEE 1364-2005, 3.5.1), VHDL as four bits "
     "(IEEE 1076-2008, 15.7).",
     "ASSIGN CONSTANT D(3:0) 1010", "4:B:1010"},
    {"constant-width", Verdicts("...rr.w.r"), "a constant of another width than its signal",
     "VHDL needs as many digits as the signal has bits (IEEE 1076-2008, 10.5); Verilog pads or "
     "cuts "
     "(IEEE 1364-2005, 5.5).",
     "ASSIGN CONSTANT D(3:0) 4:B:10", "as many binary digits as the signal has bits"},
    {"constant-length", Verdicts("wwwwwwrww"), "a constant whose digits do not fit its length",
     "Verilog cuts the digits at the left to the length, which must be greater than 0 "
     "(IEEE 1364-2005, 3.5.1); VHDL reads all of them.",
     "ASSIGN CONSTANT D(3:0) 3:B:1010", "the length that the digits have"},
    {"constant-character", Verdicts("rrrrrrrrr"),
     "a constant with a character that is no digit of its base",
     "Each base has its digits (IEEE 1364-2005, 3.5.1; IEEE 1076-2008, 15.8). A bit "
     "string of VHDL-93 has no others; Verilog has x and z too.",
     "ASSIGN CONSTANT D(3:0) 4:B:1012", "digits of the base"},
    {"constant-left-out", Verdicts("...mm...m"),
     "a constant that VHDL cannot have, and which is left out there",
     "What is written bit by bit in VHDL (a compound, a slice against its bus) needs one binary "
     "digit a bit. Other constants are not written.",
     "ADD PORT Y(7:0) Output\nASSIGN CONSTANT Y(4:7) 4:H:5", "one binary digit a bit"},
    {"no-ports", Verdicts("...rr...r"), "a design without ports",
     "VHDL has no empty list of ports (IEEE 1076-2008, 6.5.6.1).", "SET NETLIST NAME bare",
     "a port that nothing is wired to"},
    {"open-input", Verdicts("...rrw..r"), "an input pin that nothing is wired to",
     "In VHDL an input without a default must be connected (IEEE 1076-2008, 6.5.6.3).",
     "ADD PIN INV I Input\nADD INSTANCE INV U1", "wiring it, or SET OPEN PIN false for VHDL"},
    {"open-bit", Verdicts("...rr...r"), "the signal open on a bus pin",
     "A part of a port cannot be open on its own (IEEE 1076-2008, 6.5.7.3).",
     "CONNECT SIGNAL open U1.Q(0:0)", "leaving the pin unwired"},
    {"open-member", Verdicts("rrrrrrrrr"), "the signal open as a part of a compound on a pin",
     "A concatenation has no open part (IEEE 1364-2005, 5.1.14; IEEE 1076-2008, 6.5.7.3).",
     "CONNECT SIGNAL open,A U1.D(1:0)", "a signal of its own for these bits"},
    {"open-signal", Verdicts("...mm...m"), "a signal named open that is used like any other",
     "The VHDL writer reads the name as the reserved word: it declares no such port or signal, and "
     "leaves its constants and aliases out.",
     "ADD PORT open Input", "another name"},
    {"open-signal-taken", Verdicts("...mm...m"),
     "an open input whose own signal bears the name of another signal",
     "With SET OPEN PIN false the VHDL writer ties an open input to a signal "
     "INSTANCE_PIN_openSignal. If a signal of that name exists, it is used.",
     "SET OPEN PIN false\nADD SIGNAL U1_I_openSignal", "another name for the signal"},
    {"late-pin", Verdicts("...rrww.r"), "a pin that was added after an instance of its component",
     "The instance does not have it. In VHDL an input must be connected (IEEE 1076-2008, 6.5.6.3).",
     "ADD INSTANCE INV U1\nADD PIN INV EN Input", "adding all pins before the first instance"},
    {"assigned-input", Verdicts("...rr.rwr"), "an input port that a constant or an alias assigns",
     "VHDL does not assign to a port of mode in (IEEE 1076-2008, 6.5.2); Verilog may make it an "
     "inout (IEEE 1364-2005, 12.3.8).",
     "ADD PORT A Input\nASSIGN CONSTANT A 1", "another direction, or a signal of its own"},
    {"driven-input", Verdicts("......ww."), "an input port that an output pin drives",
     "The port's value and the pin's meet on one net.", "ADD PORT A Input\nCONNECT SIGNAL A U1.O",
     "an output or bidirectional port"},
    {"two-drivers", Verdicts("......ww."), "a net with two drivers",
     "Their values are resolved to x where they differ (IEEE 1364-2005, 4.6.1; IEEE 1164).",
     "CONNECT SIGNAL Y U1.O\nCONNECT SIGNAL Y U2.O", "one driver, unless they can be disabled"},
    {"undriven", Verdicts(".......w."), "a net that is read and that nothing drives",
     "It is z in Verilog and U in VHDL.", "CONNECT SIGNAL N U1.I", "a driver or a constant"},
    {"alias-loop", Verdicts("......ww."), "aliases that lead back to their signal",
     "The nets hold whatever they held, or x.", "CONNECT SIGNAL M N\nCONNECT SIGNAL N M",
     "one alias of the two"},
    {"output-read", Verdicts("...r....r"), "an alias that reads an output port",
     "VHDL-93 does not read a port of mode out (IEEE 1076-1993, 1.1.1.2); VHDL-2008 does.",
     "ADD PORT Y Output\nCONNECT SIGNAL Z Y", "VHDL-2008, or an alias of the driver's net"},
    {"dummy-taken", Verdicts("...r....r"),
     "a port used against its direction, whose dummy signal cannot be made",
     "The writers wire such pins to a dummy signal of the port's name with _DUMMY. When the name "
     "is "
     "taken, or a narrower dummy signal was made for an earlier write, the port itself is used.",
     "ADD PORT Y Output\nADD SIGNAL Y_DUMMY\nCONNECT SIGNAL Y U2.I",
     "another name for the signal, or the whole bus declared first"},
    {"attribute-types", Verdicts("...rr...r"),
     "with USE ATTRTYPE, one attribute name with two types",
     "An attribute is declared once, with the first type, and its values have that type "
     "(IEEE 1076-2008, 6.7 and 7.2).",
     "USE ATTRTYPE\nADD SIGNAL ATTRIBUTE A LOC P1\nADD SIGNAL ATTRIBUTE B -TYPE=Integer LOC 1",
     "one type a name, or no USE ATTRTYPE"},
    {"undeclared-attribute", Verdicts("...rr...r"),
     "an attribute of the option ASSIGNNODEC that nothing declares",
     "An attribute is declared before it is given a value (IEEE 1076-2008, 7.2).",
     "SET SIGNAL ATTRIBUTE OPTION A LOC -SYNATTR=ASSIGNNODEC",
     "-SYNATTR=ASSIGN, or a use clause for the package that declares it"},
    {"user-type", Verdicts("...rr...r"), "an attribute of the type User without a declared type",
     "The type's name is written as it is (IEEE 1076-2008, 6.7 and 6.5.6.2).",
     "ADD MODULE ATTRIBUTE -TYPE=User W fast\nSET MODULE ATTRIBUTE OPTION W -GENERIC=SYN",
     "SET ... ATTRIBUTE USERTYPE with a type that the use clauses make visible"},
    {"user-value", Verdicts("...rr...r"), "a value that its user type does not have",
     "The value is written as it is (IEEE 1076-2008, 9.3.1).",
     "ADD MODULE ATTRIBUTE -TYPE=User W fast\nSET MODULE ATTRIBUTE USERTYPE W integer",
     "a literal of the type"},
    {"undeclared-generic", Verdicts("...rr...r"),
     "a generic on an instance whose component has no generic of that name",
     "A generic map names generics of the component (IEEE 1076-2008, 6.5.7.2).",
     "ADD INSTANCE ATTRIBUTE U1 INIT 1\nSET INSTANCE ATTRIBUTE OPTION U1 INIT -GENERIC=SYN",
     "the attribute, with the same option, on the component too"},
    {"generic-type", Verdicts("...rr...r"),
     "a generic that has other types on an instance and on its component",
     "The actual is of the formal's type (IEEE 1076-2008, 6.5.6.2).",
     "ADD COMPONENT ATTRIBUTE C -TYPE=Integer W 5\nADD INSTANCE ATTRIBUTE U1 -TYPE=String W 7",
     "one type for both"},
    {"generic-digits", Verdicts("mmm..mmm."),
     "a bit-vector generic without length and base, whose digits Verilog reads as a decimal number",
     "Verilog reads 0110 as one hundred and ten (IEEE 1364-2005, 3.5.1), VHDL as four bits "
     "(IEEE 1076-2008, 15.7).",
     "ADD COMPONENT ATTRIBUTE LUT4 -TYPE=BitVector INIT 0110100110010110", "16:B:0110100110010110"},
    {"hidden-generic", Verdicts(".......w."), "a generic that is kept from synthesis",
     "It stands between translate_off and translate_on, which Yosys obeys with a warning.",
     "SET MODULE ATTRIBUTE OPTION W -GENERIC=NOSYN", "-GENERIC=SYN"},
    {"float-generic", Verdicts(".......w."), "a generic of the type Float on an instance",
     "Yosys takes the number for a text (a warning).",
     "ADD INSTANCE ATTRIBUTE U1 -TYPE=Float RATE 0.5\n"
     "SET INSTANCE ATTRIBUTE OPTION U1 RATE -GENERIC=SYN",
     "a generic of another type"},
    {"quote-in-value", Verdicts("rrrrrrrrr"), "a value that holds a double quote",
     "The quote ends the string (IEEE 1364-2005, 3.6; IEEE 1076-2008, 15.7).",
     "ADD SIGNAL ATTRIBUTE A NOTE 7\\\"", "a value without the quote"},
    {"comment-in-value", Verdicts("rrr..rrr."),
     "an attribute with */, in a dialect that writes it in a block comment",
     "The comment ends there (IEEE 1364-2005, 3.3).",
     "SET SYNTHESIS SYNPLICITY\nADD SIGNAL ATTRIBUTE A NOTE a*/b",
     "a value without it, or another dialect"},
    {"backslash-in-value", Verdicts("mmm..mmm."), "a text generic that holds a backslash",
     "Verilog reads it and the next character as one (IEEE 1364-2005, 3.6.3), VHDL as two.",
     "ADD MODULE ATTRIBUTE PATH a\\\\nb", "a value without it"},
    {"character-in-value", Verdicts("...rr...r"), "a value with a control character",
     "A VHDL string holds graphic characters only (IEEE 1076-2008, 15.7).",
     "ADD SIGNAL ATTRIBUTE A NOTE with a tab in the value", "a value without it"},
    {"directive-comment", Verdicts("......rrm"), "a comment that a tool obeys",
     "Comments that begin with synopsys, synthesis, pragma or verilator are commands to some "
     "tools. "
     "Synthesis leaves out what follows translate_off, in VHDL too.",
     "ADD NOTES synopsys translate_off", "other words at the comment's beginning"},
    {"missing-configuration", Verdicts("...ww...w"),
     "a configuration that uses a component's configuration, which WORK may not have",
     "The configuration of the design uses WORK.CFG_ with the component's name "
     "(IEEE 1076-2008, 7.3.2.2).",
     "ADD COMPONENT INV", "SUPPRESS CONFIGURATION, or the attribute LEVEL HALVEX on the component"},
    {"undeclared-component", Verdicts("...rr...r"),
     "SUPPRESS COMPONENT without a package that could declare the components",
     "A component is declared before it is placed (IEEE 1076-2008, 11.7).",
     "SUPPRESS COMPONENT true\nUSE DEFAULT LIBRARY false", "a use clause, or the declarations"},
    {"library-clause", Verdicts("...rr...r"), "a library clause with a name that is no identifier",
     "A library clause lists identifiers (IEEE 1076-2008, 13.2).", "ADD LIBRARY 2x",
     "the library's name"},
    {"use-clause", Verdicts("...rr...r"),
     "a use clause that is malformed, or names an undeclared library",
     "A use clause has selected names, whose library is declared before it (IEEE 1076-2008, 12.4). "
     "The clauses for ieee stand behind the user's.",
     "ADD USE LIBRARY cells.parts.all", "ADD LIBRARY for the library, and LIBRARY.PACKAGE.all"},
    {"needed-library", Verdicts("...ww...w"), "a library that the tools have to be given",
     "Its units are analysed before the netlist (IEEE 1076-2008, 13.5).", "ADD LIBRARY cells",
     "analysing the library first"},
    {"no-std-logic", Verdicts("...rr...r"),
     "USE DEFAULT LIBRARY false without a clause for std_logic_1164",
     "The type std_logic is not visible (IEEE 1076-2008, 12.3).", "USE DEFAULT LIBRARY false",
     "ADD LIBRARY ieee and ADD USE LIBRARY ieee.std_logic_1164.all"},
    {"include-file", Verdicts("wwwwwwwww"), "a file that the Verilog tools have to find",
     "The text of the file stands in the directive's place (IEEE 1364-2005, 19.5).",
     "ADD INCLUDE cells.v", "the file in a folder that the tool searches"},
};
static_assert(std::size(Rules) == static_cast<std::size_t>(RuleId::Count));

} // namespace

const Check::Rule& GetRule(RuleId rule) noexcept {
    return Rules[static_cast<std::size_t>(rule)];
}

} // namespace Checking

const std::vector<Check::Rule>& Check::GetRules() {
    static const std::vector<Rule> rules(std::begin(Checking::Rules), std::end(Checking::Rules));
    return rules;
}

const Check::Rule* Check::FindRule(std::string_view name) {
    const std::vector<Rule>& rules = GetRules();
    const auto found = std::find_if(rules.begin(), rules.end(), [name](const Rule& rule) {
        return Port::EqualIgnoringCase(rule.name, name);
    });
    return found == rules.end() ? nullptr : &*found;
}

} // namespace Orn_Hdl
