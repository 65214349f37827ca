// What the option commands do to the options of a model.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/DefaultOptions.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>

using namespace Orn_Hdl;
using Support::EngineScript;
using Support::ExpectDefaults;
using VerilogOption = HdlOptions::VerilogOption;

namespace {

/// A command that sets a flag unless its word is "false".
struct Flag {
    const char* phrase;
    bool HdlOptions::VhdlOption::*flag;
};

void PrintTo(const Flag& flag, std::ostream* out) {
    *out << flag.phrase;
}

class FlagCommands : public testing::TestWithParam<Flag> {
protected:
    bool FlagAfter(const std::string& words) {
        script_.Run(std::string(GetParam().phrase) + " " + words);
        return script_.GetOptions().vhdl.*GetParam().flag;
    }

    EngineScript script_;
};

} // namespace

TEST(Options, StartFromTheirDefaults) {
    ExpectDefaults(HdlOptions());
    EngineScript script;
    ExpectDefaults(script.GetOptions());
    script.Run("ADD SIGNAL N\nADD COMPONENT C");
    ExpectDefaults(script.GetOptions());
}

TEST(Options, AreCopiedWhole) {
    HdlOptions options;
    options.vhdl.libraries.Add("lib");
    options.verilog.includePaths.Add("path");
    options.verilog.SetSynthesisType("PRECISION");
    options.reference = "text";
    options.onePortPerLine = false;
    HdlOptions copy(options);
    options.vhdl.libraries.Add("more");
    EXPECT_EQ(copy.vhdl.libraries.GetSize(), 1);
    EXPECT_EQ(copy.verilog.includePaths.GetAt(0), "path");
    EXPECT_EQ(copy.verilog.synthesisType, 5);
    EXPECT_EQ(copy.reference, "text");
    EXPECT_FALSE(copy.onePortPerLine);
    copy = HdlOptions();
    ExpectDefaults(copy);
}

TEST(Options, SynthesisTypesIgnoreCase) {
    const struct {
        const char* text;
        int type;
    } cases[] = {{"QSN", 0},         {"EXEMPLAR", 1},  {"synplicity", 2}, {"Synopsys", 3},
                 {"VERILOG2001", 4}, {"precision", 5}, {"XYZ", 0},        {"", 0},
                 {"SYNPLICITY ", 0}, {"VERILOG95", 0}};
    for (const auto& c : cases) {
        VerilogOption option;
        option.synthesisType = VerilogOption::EXEMPLAR;
        option.SetSynthesisType(c.text);
        EXPECT_EQ(option.synthesisType, c.type) << c.text;
        EXPECT_EQ(option.IsSemiColonWrittenBeforeAttr(), c.type != 2) << c.text;
    }
    VerilogOption option;
    option.SetSynthesisType("PRECISION");
    option.SetSynthesisType(nullptr);
    EXPECT_EQ(option.synthesisType, 0);
}

TEST(Options, CaseTypesIgnoreCase) {
    EXPECT_EQ(VerilogOption::GetCaseType("DEFSULT"), 10);
    EXPECT_EQ(VerilogOption::GetCaseType("default"), 10);
    EXPECT_EQ(VerilogOption::GetCaseType("UpperCase"), 11);
    EXPECT_EQ(VerilogOption::GetCaseType("lowercase"), 12);
    EXPECT_EQ(VerilogOption::GetCaseType("UPPER"), 10);
    EXPECT_EQ(VerilogOption::GetCaseType(""), 10);
    EXPECT_EQ(VerilogOption::GetCaseType(nullptr), 10);
}

TEST_P(FlagCommands, OnlyFalseClearsTheFlag) {
    EXPECT_FALSE(FlagAfter("false"));
    EXPECT_TRUE(FlagAfter("true"));
    EXPECT_FALSE(FlagAfter("FALSE"));
    EXPECT_TRUE(FlagAfter(""));
    EXPECT_FALSE(FlagAfter("False further words"));
    EXPECT_TRUE(FlagAfter("no"));
    EXPECT_FALSE(FlagAfter("'false'"));
    EXPECT_TRUE(FlagAfter("0 false"));
    EXPECT_TRUE(FlagAfter("falsely"));
}

INSTANTIATE_TEST_SUITE_P(
    Flags, FlagCommands,
    testing::Values(Flag{"FLATTEN BUS", &HdlOptions::VhdlOption::flattenBus},
                    Flag{"SUPPRESS CONFIGURATION", &HdlOptions::VhdlOption::suppressConfiguration},
                    Flag{"SUPPRESS COMPONENT", &HdlOptions::VhdlOption::suppressComponent},
                    Flag{"USE DEFAULT LIBRARY", &HdlOptions::VhdlOption::useDefaultLibrary},
                    Flag{"Set Open Pin", &HdlOptions::VhdlOption::openPin}));

TEST(OptionCommands, ListsGrow) {
    EngineScript script("ADD INCLUDE a.vh ignored\nADD INCLUDE \"b c.vh\"\nADD INCLUDE a.vh\n"
                        "ADD LIBRARY cells\nADD LIBRARY pads\n"
                        "ADD USE LIBRARY cells.all\nADD USE LIBRARY \"pads . all\"");
    const HdlOptions& options = script.GetOptions();
    EXPECT_EQ(options.verilog.includePaths.Concatenate("|"), "a.vh|b c.vh|a.vh");
    EXPECT_EQ(options.vhdl.libraries.Concatenate("|"), "cells|pads");
    EXPECT_EQ(options.vhdl.useClauses.Concatenate("|"), "cells.all|pads . all");
}

TEST(OptionCommands, SynthesisType) {
    EngineScript script("SET SYNTHESIS synopsys ignored");
    EXPECT_EQ(script.GetOptions().verilog.synthesisType, VerilogOption::SYNOPSYS);
    script.Run("SET SYNTHESIS other");
    EXPECT_EQ(script.GetOptions().verilog.synthesisType, VerilogOption::QSN);
}

TEST(OptionCommands, NameCases) {
    EngineScript script("UPPERCASE Instance\nUPPERCASE SIGANL\nUPPERCASE component ignored");
    const VerilogOption& option = script.GetOptions().verilog;
    EXPECT_EQ(option.instanceCase, VerilogOption::UPPERCASE);
    EXPECT_EQ(option.signalCase, VerilogOption::UPPERCASE);
    EXPECT_EQ(option.componentCase, VerilogOption::UPPERCASE);
    script.Run("LOWERCASE SIGNAL");
    EXPECT_EQ(option.signalCase, VerilogOption::LOWERCASE);
    EXPECT_EQ(option.instanceCase, VerilogOption::UPPERCASE);
    script.Run("LOWERCASE INSTANCE\nLOWERCASE COMPONENT");
    EXPECT_EQ(option.instanceCase, VerilogOption::LOWERCASE);
    EXPECT_EQ(option.componentCase, VerilogOption::LOWERCASE);
}

TEST(OptionCommands, FlagsThatAreNeverCleared) {
    EngineScript script;
    script.Run("Use AttrType false");
    EXPECT_TRUE(script.GetOptions().vhdl.useAttrType);
    script.GetOptions().onePortPerLine = false;
    script.Run("SET PORT ONEPERLINE false");
    EXPECT_TRUE(script.GetOptions().onePortPerLine);
}

TEST(OptionCommands, HeaderTexts) {
    EngineScript script("Set Application the tool\n"
                        "Set Command run  -x \"a  b\"\n"
                        "Set Device \"big device\" ignored\n"
                        "Set Purpose of  this file\n"
                        "Set Reference see elsewhere");
    const HdlOptions& options = script.GetOptions();
    EXPECT_EQ(options.application, "the");
    EXPECT_EQ(options.command, "run -x a  b");
    EXPECT_EQ(options.device, "big device");
    EXPECT_EQ(options.purpose, "of this file");
    EXPECT_EQ(options.reference, "see elsewhere");
    script.Run("set application other");
    EXPECT_EQ(options.application, "other");
}

TEST(OptionCommands, ModelsHaveOptionsOfTheirOwn) {
    EngineScript script("FLATTEN BUS");
    script.GetEngine().CreateAndAddModel("other", "");
    ExpectDefaults(*script.GetEngine().GetModel("other")->GetOptions());
}
