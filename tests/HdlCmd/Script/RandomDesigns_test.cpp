// `Model::WriteCommands` on random designs, made by commands and by calls.

#include "HdlCmd/Script/RoundTrip.h"
#include "Orn_Hdl/Orn_Hdl.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <functional>
#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::Agreement;
using Support::FailureOf;
using Support::RoundTrip;

namespace {

std::string OneOf(const std::vector<std::string>& texts) {
    return *rc::gen::elementOf(texts);
}

/// A scalar or a bus.
std::string AnyPort() {
    return OneOf({"A", "B", "y", "N1", "D(7:0)", "D(0:7)", "D(15:0)", "Q(0:3)", "Q(0:0)", "y_DUMMY",
                  "D_DUMMY(7:0)", "COMMENT", "D[3:0]"});
}

/// A scalar, a bus, or a part of one, mostly of those that other commands name too.
std::string AnySignal() {
    return OneOf({"A",
                  "B",
                  "y",
                  "N1",
                  "N10",
                  "D(7:0)",
                  "D(3:0)",
                  "D(0:7)",
                  "D(2)",
                  "D(9)",
                  "D(15:0)",
                  "Q(0:3)",
                  "Q(1:2)",
                  "Q(2:1)",
                  "Q(3)",
                  "Q(0:0)",
                  "U1_I_CONST_SIGNAL",
                  "U2_B_CONST_SIGNAL(1:0)",
                  "U1_I_openSignal",
                  "y_DUMMY",
                  "D_DUMMY(2)",
                  "COMMENT",
                  "D[5]",
                  "\"a b\""});
}

std::string AnyCompound() {
    std::string name = AnySignal();
    const int count = *rc::gen::inRange(1, 3);
    for (int i = 0; i < count; ++i) {
        name.append(OneOf({",", "\\", ",,"})).append(AnySignal());
    }
    return name;
}

std::string AnyComponent() {
    return OneOf({"C", "C2", "PIN"});
}

std::string AnyInstance() {
    return OneOf({"U1", "U2", "U10", "u_1", "COMMENT"});
}

std::string AnyPin() {
    return OneOf({"I", "O", "B(1:0)", "X(2)", "IO"});
}

std::string AnyText() {
    return OneOf({"1", "0", "4:H:A", "8:B:1", "text", "\"two  words\"", "1.50", "-3", "true",
                  "\"it's\"", "a\\", "\"\" \"\""});
}

/// What has attributes and comments, with its name if it has one.
std::string AnyHolder() {
    switch (*rc::gen::inRange(0, 6)) {
    case 0:
        return "MODULE";
    case 1:
        return "COMPONENT " + AnyComponent();
    case 2:
        return "INSTANCE " + AnyInstance();
    case 3:
        return "COMPONENT PIN " + AnyComponent() + "." + AnyPin();
    case 4:
        return "INSTANCE PIN " + AnyInstance() + "." + AnyPin();
    default:
        return "SIGNAL " + AnySignal();
    }
}

/// A command about a holder, with words between its kind and its name.
std::string About(const std::string& verb, const std::string& word, const std::string& rest) {
    const std::string holder = AnyHolder();
    const std::size_t name = holder.rfind(' ');
    const bool isNamed = name != std::string::npos;
    return verb + " " + holder.substr(0, name) + " " + word + " " +
           (isNamed ? holder.substr(name + 1) + " " : "") + rest;
}

std::string AnyOption() {
    return OneOf({"SET SYNTHESIS SYNPLICITY", "UPPERCASE siganl", "LOWERCASE instance",
                  "LOWERCASE component", "Set Open Pin false", "Use AttrType", "SUPPRESS COMPONENT",
                  "USE DEFAULT LIBRARY false", "ADD LIBRARY L", "ADD INCLUDE f.v",
                  "Set Purpose a  \"b  c\"", "SET NETLIST NAME top"});
}

std::string AnyDesignLine(bool withCompounds) {
    const auto anySignal = [withCompounds] {
        return withCompounds && *rc::gen::inRange(0, 4) == 0 ? AnyCompound() : AnySignal();
    };
    const std::string attribute = OneOf({"K", "INIT", "Level", "LOC"});
    switch (*rc::gen::inRange(0, 20)) {
    case 0:
        return "ADD COMPONENT " + AnyComponent();
    case 1:
    case 2:
        return "ADD PIN " + AnyComponent() + " " + AnyPin() + " " + OneOf({"in", "out", "bi"});
    case 3:
    case 4:
        return "ADD INSTANCE " + AnyComponent() + " " + AnyInstance();
    case 5:
    case 6:
        return "ADD PORT " + AnyPort() + " " + OneOf({"in", "out", "out", "bi"});
    case 7:
        return "ADD SIGNAL " + AnySignal();
    case 8:
    case 9:
        return "CONNECT SIGNAL " + anySignal() + " " + anySignal();
    case 10:
        return "ASSIGN CONSTANT " + anySignal() + " " + AnyText();
    case 11:
        return "ASSIGN CONSTANT " + AnyInstance() + "." + AnyPin() + " " + AnyText();
    case 12:
        return About("ADD", "COMMENT", AnyText());
    case 13:
        return About("ADD", "ATTRIBUTE",
                     OneOf({"", "-TYPE=Float ", "-TYPE=User ", "-TYPE=BitVector "}) + attribute +
                         " " + OneOf({"HALVEX", AnyText()}));
    case 14:
        return About("SET", "ATTRIBUTE OPTION",
                     attribute + OneOf({" -GENERIC=SYN", " -SYNATTR=ASSIGN", " -GENERIC=NOSYN"}));
    case 15:
        return About("SET", "ATTRIBUTE USERTYPE", attribute + " colour_t");
    case 16:
        return AnyOption();
    default:
        return "CONNECT SIGNAL " + anySignal() + " " + AnyInstance() + "." + AnyPin();
    }
}

/// A design with some components and instances, so that most lines find what they name.
std::vector<std::string> AnyDesign(bool withCompounds) {
    std::vector<std::string> lines = {
        "ADD COMPONENT C",     "ADD PIN C I in",      "ADD PIN C O out",
        "ADD PIN C B(1:0) in", "ADD INSTANCE C U1",   "ADD INSTANCE C U2",
        "ADD PORT y out",      "ADD PORT D(7:0) out", "CONNECT SIGNAL y U1.I"};
    const int count = *rc::gen::inRange(0, 40);
    for (int i = 0; i < count; ++i) {
        lines.push_back(AnyDesignLine(withCompounds));
    }
    return lines;
}

std::string Show(const std::vector<std::string>& lines) {
    std::string text;
    for (const std::string& line : lines) {
        text.append(line).append("\n");
    }
    return text;
}

void Run(Model& model, const std::vector<std::string>& lines) {
    for (const std::string& line : lines) {
        FailureOf([&] { model.ExecuteLine(line); });
    }
}

/// Whether no check has failed in this test, which ends the search for a smaller case.
void AssertAgreement() {
    RC_ASSERT_FALSE(testing::Test::HasFailure());
}

RC_GTEST_PROP(WriteCommandsRandom, DesignsComeAgain, ()) {
    const std::vector<std::string> lines = AnyDesign(true);
    RC_LOG() << Show(lines);
    RoundTrip([&](Model& model) { Run(model, lines); }).Check();
    AssertAgreement();
}

RC_GTEST_PROP(WriteCommandsRandom, WrittenDesignsComeAgain, ()) {
    const std::vector<std::string> lines = AnyDesign(false);
    RC_LOG() << Show(lines);
    const bool isVhdl = *rc::gen::arbitrary<bool>();
    RoundTrip([&](Model& model) {
        Run(model, lines);
        isVhdl ? Support::WriteVhdl(model) : Support::WriteVerilog(model);
    }).Check();
    AssertAgreement();
}

// The lines of compounds of dummies, and of parts that have yet to get dummies, may move.
RC_GTEST_PROP(WriteCommandsRandom, DesignsThatGoOnAfterWritesComeAgain, ()) {
    const std::vector<std::string> first = AnyDesign(true);
    const std::vector<std::string> second = AnyDesign(true);
    RC_LOG() << Show(first) << "after a write:\n" << Show(second);
    const bool isVhdl = *rc::gen::arbitrary<bool>();
    RoundTrip([&](Model& model) {
        Run(model, first);
        isVhdl ? Support::WriteVhdl(model) : Support::WriteVerilog(model);
        Run(model, second);
    }).Check(Agreement::LinesInAnyOrder);
    AssertAgreement();
}

RC_GTEST_PROP(WriteCommandsRandom, RenamedDesignsComeAgain, ()) {
    const std::vector<std::string> lines = AnyDesign(true);
    RC_LOG() << Show(lines);
    struct Names {
        std::string former;
        std::string wanted;
    };
    std::vector<Names> names;
    for (int i = 0; i < 6; ++i) {
        names.push_back({OneOf({AnySignal(), AnyInstance(), AnyComponent()}),
                         OneOf({"R", "R(7:0)", "R(0:3)", "S", "T", "u9", "d(7:0)"})});
    }
    const auto build = [&](Model& model) {
        Run(model, lines);
        for (const Names& pair : names) {
            const char* const former = pair.former.c_str();
            FailureOf([&] { model.RenameSignal(former, pair.wanted.c_str()); });
            FailureOf([&] { model.RenameInstance(former, pair.wanted.c_str()); });
            FailureOf([&] { model.RenameComponent(former, pair.wanted.c_str()); });
        }
    };
    // The port at which a constant of a pin is has not the name that the renamed instance gives it.
    const std::string failure = FailureOf([&] { RoundTrip(build).Check(); });
    RC_ASSERT(failure.empty() ||
              failure.find("a port to which it is connected does not list it") != failure.npos);
    AssertAgreement();
}

} // namespace
