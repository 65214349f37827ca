// Random command scripts: whatever is typed, nothing but the library's own exception comes out, the
// same script gives the same bytes, and a model that is written again declares nothing twice.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"
#include "Support/NetlistText.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <set>
#include <string>
#include <typeinfo>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;
using Support::SortedLines;
using Support::SplitLines;

namespace {

using Lines = std::vector<std::string>;

// Generators

std::string OneOf(const std::vector<std::string>& texts) {
    return *rc::gen::elementOf(texts);
}

std::string Number(int from, int to) {
    return std::to_string(*rc::gen::inRange(from, to));
}

/// A piece of one of the declared buses, or of a wider use of one.
std::string BusPiece() {
    const std::string base = OneOf({"B0", "B1", "B2", "b0", "Q0", "D0"});
    switch (*rc::gen::inRange(0, 4)) {
    case 0:
        return base + "(" + Number(0, 8) + ")";
    case 1:
        return base + "(" + Number(0, 8) + ":" + Number(0, 8) + ")";
    case 2:
        return base + "(7:0)";
    default:
        return base + "(" + Number(0, 20) + ":0)";
    }
}

std::string ScalarName() {
    return OneOf({"N0", "N1", "N2", "n1", "Y0", "Y1", "A0", "A1", "P0"});
}

std::string SignalName() {
    switch (*rc::gen::inRange(0, 5)) {
    case 0:
    case 1:
        return ScalarName();
    case 2:
    case 3:
        return BusPiece();
    default: {
        std::string compound = ScalarName() + OneOf({",", "\\"}) + BusPiece();
        for (int i = *rc::gen::inRange(0, 3); i > 0; --i) {
            compound += "," + (*rc::gen::arbitrary<bool>() ? ScalarName() : BusPiece());
        }
        return compound;
    }
    }
}

std::string InstanceName() {
    return "U" + Number(0, 5);
}

std::string PinName() {
    return OneOf({"I", "J", "D(3:0)", "E(0:3)", "K(2)", "O", "R", "S(3:0)", "W"});
}

std::string Constant() {
    return OneOf({"0", "1", "4:B:1010", "8:H:A5", "01", "2:B:10", "3:O:7", "x", "1:B:1"});
}

std::string Option() {
    return OneOf({"-GENERIC=SYN", "-GENERIC=NOSYN", "-GENERIC=NONE", "-SYNATTR=ASSIGN",
                  "-SYNATTR=ASSIGNNODEC", "-SYNATTR=NONE"});
}

std::string AttributeTarget() {
    return OneOf({"MODULE ATTRIBUTE", "COMPONENT ATTRIBUTE C0", "COMPONENT ATTRIBUTE C1",
                  "INSTANCE ATTRIBUTE U0", "INSTANCE ATTRIBUTE U1", "SIGNAL ATTRIBUTE N0",
                  "SIGNAL ATTRIBUTE A0", "SIGNAL ATTRIBUTE B0(7:0)", "INSTANCE PIN ATTRIBUTE U0.I",
                  "COMPONENT PIN ATTRIBUTE C0.O"});
}

std::string AttributeName() {
    return OneOf({"LOC", "loc", "INIT", "KEEP", "RATE"});
}

/// Two components, five instances, ports and signals of every kind.
const std::string& Prologue() {
    static const std::string prologue = [] {
        std::string lines;
        for (const char* cell : {"C0", "C1"}) {
            lines += std::string("ADD COMPONENT ") + cell + "\n";
            for (const char* pin :
                 {"I Input", "J Input", "D(3:0) Input", "E(0:3) Input", "K(2) Input", "O Output",
                  "R Output", "S(3:0) Output", "W BiDirectional"}) {
                lines += std::string("ADD PIN ") + cell + " " + pin + "\n";
            }
        }
        for (const char* instance : {"C0 U0", "C1 U1", "C0 U2", "C1 U3", "C0 U4"}) {
            lines += std::string("ADD INSTANCE ") + instance + "\n";
        }
        return lines + "ADD SIGNAL B0(7:0)\nADD SIGNAL B1(0:7)\nADD SIGNAL B2(3:3)\n"
                       "ADD PORT Q0(7:0) Output\nADD PORT D0(7:0) Input\nADD PORT Y0 Output\n"
                       "ADD PORT Y1 Output\nADD PORT A0 Input\nADD PORT A1 Input\n"
                       "ADD PORT P0 BiDirectional\nADD SIGNAL N0\nADD SIGNAL N1\nADD SIGNAL N2\n";
    }();
    return prologue;
}

/// A command that a careful user could type.
rc::Gen<std::string> SaneLine() {
    return rc::gen::exec([]() -> std::string {
        switch (*rc::gen::inRange(0, 12)) {
        case 0:
        case 1:
        case 2:
        case 3:
        case 4:
            return "CONNECT SIGNAL " + SignalName() + " " + InstanceName() + "." + PinName();
        case 5:
            return "CONNECT SIGNAL " + SignalName() + " " + SignalName();
        case 6:
            return "ASSIGN CONSTANT " + SignalName() + " " + Constant();
        case 7:
            return "ASSIGN CONSTANT " + InstanceName() + "." + PinName() + " " + Constant();
        case 8: {
            const std::string target = AttributeTarget();
            return "ADD " + target + " " + OneOf({"", "-TYPE=Integer ", "-TYPE=BitVector "}) +
                   AttributeName() + " " + OneOf({"1", "8:H:A5", "text"});
        }
        case 9: {
            // The words after SET stand in another order than those after ADD.
            const std::string target = AttributeTarget();
            const std::size_t split = target.find("ATTRIBUTE") + 9;
            return "SET " + target.substr(0, split) + " OPTION" + target.substr(split) + " " +
                   AttributeName() + " " + Option();
        }
        case 10:
            return OneOf({"ADD SIGNAL COMMENT N0 of a signal", "ADD INSTANCE COMMENT U0 of one",
                          "ADD COMPONENT COMMENT C0 of it", "ADD NOTES of all",
                          "SET SYNTHESIS EXEMPLAR", "SET SYNTHESIS SYNOPSYS", "SUPPRESS COMPONENT",
                          "USE DEFAULT LIBRARY false", "Use AttrType"});
        default:
            return "ADD " + OneOf({"SIGNAL ", "SIGNAL ", "INSTANCE C0 ", "COMPONENT "}) +
                   OneOf({"X0", "X1", "X2", "X3(3:0)", "X4(0:3)"});
        }
    });
}

std::string WildName() {
    static const std::vector<std::string> names = {"",
                                                   "\"\"",
                                                   "\"a b\"",
                                                   "%s%n",
                                                   "open",
                                                   "OPEN",
                                                   "A(7:0)",
                                                   "A(",
                                                   "A)",
                                                   "A(:)",
                                                   "A(1:)",
                                                   "A(:1)",
                                                   "A(1:2)x",
                                                   "A(-3:4)",
                                                   "A[3-0]",
                                                   "A<3>",
                                                   "A{2}",
                                                   "'A",
                                                   "A'",
                                                   ",",
                                                   "\\",
                                                   "A,",
                                                   ",A",
                                                   "A,,B",
                                                   "A\\B",
                                                   "A,A",
                                                   "A(1),A",
                                                   "A(1:0),A(3:0)",
                                                   "N",
                                                   "n",
                                                   "N.",
                                                   ".N",
                                                   "N.I",
                                                   "U.I",
                                                   "u.D(3:0)",
                                                   "U.D[3-0]",
                                                   "N_DUMMY",
                                                   "N_DUMMY_DUMMY",
                                                   "A_DUMMY(7:0)",
                                                   "A_DUMMY",
                                                   "INIT",
                                                   "MHALVEX",
                                                   "HHALVEX",
                                                   "Level",
                                                   "HALVEX",
                                                   "BOX_TYPE",
                                                   "BLACK_BOX",
                                                   "A(2147483647:0)",
                                                   "A(99999999999:0)",
                                                   "A(2147483647:99999999)",
                                                   "A(0:99999999)",
                                                   "A(+7:-0)",
                                                   "A(007:000)",
                                                   "A(3000000:0)",
                                                   "A(0:2999999)",
                                                   "A(2999999:0),A(0:2999999)",
                                                   "\x80\xff",
                                                   "\xc3\xa4",
                                                   "\t",
                                                   "a\rb",
                                                   "U_I_CONST_SIGNAL",
                                                   "U_I_openSignal",
                                                   "-TYPE=Bit",
                                                   "-TYPE=",
                                                   "-GENERIC=SYN",
                                                   "-SYNATTR=ASSIGN",
                                                   "-GENERIC=",
                                                   "Input",
                                                   "Output",
                                                   "b",
                                                   "String",
                                                   "Level",
                                                   "false",
                                                   "instance",
                                                   "siganl",
                                                   "signal",
                                                   "component",
                                                   "SYNPLICITY",
                                                   "8:H:A5",
                                                   "4:B:10",
                                                   "::",
                                                   "1"};
    return *rc::gen::elementOf(names);
}

/// Words of the language and odd names in any order, odd bytes, or a sane line with a word of its
/// taken out, doubled or replaced.
rc::Gen<std::string> WildLine() {
    return rc::gen::exec([]() -> std::string {
        switch (*rc::gen::inRange(0, 8)) {
        case 0: {
            const auto bytes = *rc::gen::container<std::string>(
                rc::gen::elementOf(std::string(" \"'\\.,()[]{}<>-:%\t\x01\x7f\x80\xff") + "ABU01"));
            return bytes;
        }
        case 1: {
            StringArray words((*SaneLine()).c_str(), " ", true, nullptr);
            const int i = *rc::gen::inRange(0, words.GetSize());
            words.SetAt(i,
                        OneOf({"", words.GetAt(i).CStr() + std::string(" ") + words.GetAt(i).CStr(),
                               WildName()}));
            return std::string(words.Concatenate(" ").GetView());
        }
        case 2:
            return *SaneLine();
        default: {
            const auto& catalogue = CommandFactory::GetCatalogue();
            std::string line =
                catalogue[*rc::gen::inRange<std::size_t>(0, catalogue.size())].phrase;
            if (line.compare(0, 5, "WRITE") == 0) {
                return line + " " + OneOf({"", "-APPEND ", "-NOHEADER ", "-APPEND -NOHEADER "}) +
                       "written";
            }
            for (int i = *rc::gen::inRange(0, 6); i > 0; --i) {
                line += " " + WildName();
            }
            return line;
        }
        }
    });
}

const std::string& WildPrologue() {
    static const std::string prologue = "ADD COMPONENT C\nADD PIN C I Input\n"
                                        "ADD PIN C D(3:0) Input\nADD PIN C K(1) Output\n"
                                        "ADD PIN C O Output\nADD PIN C W BiDirectional\n"
                                        "ADD INSTANCE C U\nADD PORT N Output\n";
    return prologue;
}

// What the scripts do

/// What came of a script: the outcome of every line, and all written bytes.
struct Outcome {
    Lines messages;
    std::string written;
    std::string verilog;
    std::string vhdl;
    int done = 0;

    friend bool operator==(const Outcome&, const Outcome&) = default;
};

/// Runs a script in a folder of its own. Anything but the library's own exception, with a message
/// that is a line, fails the property.
Outcome RunScript(const std::string& prologue, const Lines& lines) {
    const Support::TemporaryFolder folder;
    const Support::CurrentFolder current(folder.GetPath());
    const Support::EnvironmentVariable time("SOURCE_DATE_EPOCH", "0");
    EngineScript script(prologue);
    Outcome outcome;
    const int before = script.GetDoneCount();
    for (const std::string& line : lines) {
        try {
            script.GetEngine().Execute(line.c_str());
            outcome.messages.emplace_back();
        } catch (const std::exception& thrown) {
            RC_ASSERT(typeid(thrown) == typeid(Exception));
            outcome.messages.emplace_back(thrown.what());
            RC_ASSERT(!outcome.messages.back().empty());
            RC_ASSERT(outcome.messages.back().back() == '\n');
        }
    }
    outcome.done = script.GetDoneCount() - before;
    outcome.written = Support::ReadWholeFile("written");
    outcome.verilog = script.Verilog();
    outcome.vhdl = script.Vhdl();
    return outcome;
}

/// The names that a written module declares, as ports or as wires.
Lines DeclaredNames(const std::string& verilog) {
    Lines names;
    for (const char* keyword : {"wire ", "input ", "output ", "inout "}) {
        for (const std::string& line : Support::LinesThatBegin(verilog, keyword)) {
            const std::size_t end = line.find(';');
            const std::size_t start = line.rfind(' ', end) + 1;
            names.push_back(line.substr(start, end - start));
        }
    }
    return names;
}

/// The names that a written architecture declares.
Lines DeclaredSignals(const std::string& vhdl) {
    Lines names;
    for (const std::string& line : Support::LinesThatBegin(vhdl, "signal ")) {
        names.push_back(line.substr(7, line.find(' ', 7) - 7));
    }
    return names;
}

/// The assignments of a written module, each whole however many lines it takes. Those with a list
/// in braces are left out: two compounds, or a compound and a slice, may well read the same.
Lines PlainAssignments(const std::string& verilog) {
    Lines statements;
    for (std::size_t start = verilog.find(" assign "); start != std::string::npos;
         start = verilog.find(" assign ", start + 1)) {
        const std::string statement = verilog.substr(start, verilog.find(';', start) - start);
        if (statement.find('{') == std::string::npos) {
            statements.push_back(statement);
        }
    }
    return statements;
}

bool AreDistinct(Lines names) {
    for (std::string& name : names) {
        std::transform(name.begin(), name.end(), name.begin(), Port::ToUpper);
    }
    return std::set<std::string>(names.begin(), names.end()).size() == names.size();
}

void ExpectDeclaredOnce(const std::string& verilog, const std::string& vhdl) {
    RC_ASSERT(AreDistinct(DeclaredNames(verilog)));
    RC_ASSERT(AreDistinct(DeclaredSignals(vhdl)));
    RC_ASSERT(AreDistinct(PlainAssignments(verilog)));
}

/// Lines that fail are part of the game: the script goes on after them.
void RunAll(EngineScript& script, const Lines& lines) {
    for (const std::string& line : lines) {
        script.GetFailure(line);
    }
}

rc::Gen<Lines> SaneScript() {
    return rc::gen::scale(2.0, rc::gen::container<Lines>(SaneLine()));
}

rc::Gen<Lines> WildScript() {
    return rc::gen::container<Lines>(WildLine());
}

} // namespace

RC_GTEST_PROP(RandomScripts, TheSameScriptGivesTheSameBytes, ()) {
    const Lines lines = *SaneScript();
    const Outcome first = RunScript(Prologue(), lines);
    RC_ASSERT(RunScript(Prologue(), lines) == first);
    RC_ASSERT(first.done == std::count(first.messages.begin(), first.messages.end(), ""));
}

RC_GTEST_PROP(RandomScripts, WildLinesGiveNothingButExceptions, ()) {
    const Lines lines = *WildScript();
    const Outcome first = RunScript(WildPrologue(), lines);
    RC_ASSERT(RunScript(WildPrologue(), lines) == first);
}

RC_GTEST_PROP(RandomScripts, WritingAgainDeclaresNothingTwice, ()) {
    EngineScript script(Prologue());
    RunAll(script, *SaneScript());
    const bool verilogFirst = *rc::gen::arbitrary<bool>();
    const std::string early = verilogFirst ? script.Verilog() : script.Vhdl();
    const std::string late = verilogFirst ? script.Vhdl() : script.Verilog();
    const std::string& verilog = verilogFirst ? early : late;
    const std::string& vhdl = verilogFirst ? late : early;
    ExpectDeclaredOnce(verilog, vhdl);
    // The dummy signals of the first write are sorted in by the second.
    const std::string verilogAgain = script.Verilog();
    const std::string vhdlAgain = script.Vhdl();
    RC_ASSERT(SortedLines(verilogAgain) == SortedLines(verilog));
    RC_ASSERT(SortedLines(vhdlAgain) == SortedLines(vhdl));
    RC_ASSERT(script.Verilog() == verilogAgain);
    RC_ASSERT(script.Vhdl() == vhdlAgain);
}

RC_GTEST_PROP(RandomScripts, CommandsBetweenWritesDeclareNothingTwice, ()) {
    EngineScript script(Prologue());
    for (int i = 0; i < 4; ++i) {
        RunAll(script, *rc::gen::resize(10, SaneScript()));
        const std::string verilog = script.Verilog();
        ExpectDeclaredOnce(verilog, script.Vhdl());
    }
}

RC_GTEST_PROP(RandomScripts, AFileGivesWhatItsLinesGive, ()) {
    EngineScript script(Prologue());
    Lines carriedOut;
    for (const std::string& line : *SaneScript()) {
        if (script.GetFailure(line).empty()) {
            carriedOut.push_back(line);
        }
    }
    const std::string lineEnd = *rc::gen::elementOf(Lines{"\n", "\r\n"});
    std::string text;
    for (const std::string& line : SplitLines(Prologue())) {
        text += line + lineEnd;
    }
    for (const std::string& line : carriedOut) {
        text += line + lineEnd;
    }
    EngineScript lines(Prologue());
    for (const std::string& line : carriedOut) {
        // A line that failed may have prepared the ground for a later one.
        RC_PRE(lines.GetFailure(line).empty());
    }
    const Support::TemporaryFolder folder;
    const std::string file = folder / "design.cmd";
    Support::WriteWholeFile(file, text);
    EngineScript replayed;
    RC_ASSERT(Support::FailureOf([&] {
                  RC_ASSERT(replayed.GetEngine().ReadCommandFile("top", file.c_str()));
              }) == "");
    RC_ASSERT(replayed.Verilog() == lines.Verilog());
    RC_ASSERT(replayed.Vhdl() == lines.Vhdl());
    RC_ASSERT(replayed.GetDoneCount() == lines.GetDoneCount());
}

RC_GTEST_PROP(RandomScripts, OddFilesAreReadOrRefused, ()) {
    const std::string text = *rc::gen::container<std::string>(
        rc::gen::elementOf(std::string("NOOP NOOP \"'\n\n\r\t\\\xff") + std::string(1, '\0')));
    const Support::TemporaryFolder folder;
    const std::string file = folder / "odd.cmd";
    Support::WriteWholeFile(file, text);
    EngineScript script;
    const std::string failure = Support::FailureOf(
        [&] { RC_ASSERT(script.GetEngine().ReadCommandFile("top", file.c_str())); });
    RC_ASSERT(failure.empty() || failure == "Command not find.\n");
}
