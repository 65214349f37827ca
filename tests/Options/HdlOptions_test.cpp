#include "Orn_Hdl/Options.h"

#include "Support/DefaultOptions.h"
#include "Support/Names.h"

#include <gtest/gtest.h>

namespace {

using Orn_Hdl::HdlOptions;
using Verilog = HdlOptions::VerilogOption;

TEST(HdlOptions, StartFromTheirDefaults) {
    Support::ExpectDefaults(HdlOptions());
}

TEST(HdlOptions, CopiesHaveEveryField) {
    HdlOptions options;
    options.vhdl.suppressConfiguration = true;
    options.vhdl.flattenBus = true;
    options.vhdl.useDefaultLibrary = false;
    options.vhdl.libraries.Add("unisim");
    options.vhdl.useClauses.Add("unisim.all");
    options.vhdl.useAttrType = true;
    options.vhdl.openPin = false;
    options.vhdl.suppressComponent = true;
    options.verilog.SetSynthesisType("PRECISION");
    options.verilog.signalCase = Verilog::UPPERCASE;
    options.verilog.instanceCase = Verilog::LOWERCASE;
    options.verilog.componentCase = Verilog::UPPERCASE;
    options.verilog.includePaths.Add("a.vh");
    options.writeHeader = false;
    options.application = "application";
    options.command = "command";
    options.device = "device";
    options.purpose = "purpose";
    options.reference = "reference";
    options.onePortPerLine = false;
    options.hierarchicalInit = true;

    HdlOptions assigned;
    assigned.vhdl.libraries.Add("old");
    assigned = options;
    const HdlOptions constructed(options);
    options.vhdl.libraries.Add("later");
    const HdlOptions* const copies[] = {&assigned, &constructed};
    for (const HdlOptions* copy : copies) {
        EXPECT_TRUE(copy->vhdl.suppressConfiguration);
        EXPECT_TRUE(copy->vhdl.flattenBus);
        EXPECT_FALSE(copy->vhdl.useDefaultLibrary);
        EXPECT_EQ(Support::NamesOf(copy->vhdl.libraries), Support::Names{"unisim"});
        EXPECT_EQ(Support::NamesOf(copy->vhdl.useClauses), Support::Names{"unisim.all"});
        EXPECT_TRUE(copy->vhdl.useAttrType);
        EXPECT_FALSE(copy->vhdl.openPin);
        EXPECT_TRUE(copy->vhdl.suppressComponent);
        EXPECT_EQ(copy->verilog.synthesisType, 5);
        EXPECT_EQ(copy->verilog.signalCase, 11);
        EXPECT_EQ(copy->verilog.instanceCase, 12);
        EXPECT_EQ(copy->verilog.componentCase, 11);
        EXPECT_EQ(Support::NamesOf(copy->verilog.includePaths), Support::Names{"a.vh"});
        EXPECT_FALSE(copy->writeHeader);
        EXPECT_EQ(copy->application, "application");
        EXPECT_EQ(copy->command, "command");
        EXPECT_EQ(copy->device, "device");
        EXPECT_EQ(copy->purpose, "purpose");
        EXPECT_EQ(copy->reference, "reference");
        EXPECT_FALSE(copy->onePortPerLine);
        EXPECT_TRUE(copy->hierarchicalInit);
    }
}

TEST(VerilogOption, KnowsTheSynthesisTypesInAnyCase) {
    const char* const texts[] = {"QSN",      "EXEMPLAR",    "SYNPLICITY",
                                 "SYNOPSYS", "VERILOG2001", "PRECISION"};
    const char* const lower[] = {"qsn",      "exemplar",    "synplicity",
                                 "synopsys", "verilog2001", "precision"};
    for (int i = 0; i < 6; ++i) {
        Verilog option;
        option.SetSynthesisType(texts[i]);
        EXPECT_EQ(option.synthesisType, i) << texts[i];
        option.synthesisType = 3;
        option.SetSynthesisType(lower[i]);
        EXPECT_EQ(option.synthesisType, i) << lower[i];
        EXPECT_EQ(option.IsSemiColonWrittenBeforeAttr(), i != 2) << texts[i];
    }
}

TEST(VerilogOption, AnUnknownSynthesisTypeIsTheFirst) {
    for (const char* text :
         {"XYZ", "", "SYNPLICIT", "SYNPLICITYX", " SYNOPSYS", static_cast<const char*>(nullptr)}) {
        Verilog option;
        option.SetSynthesisType("SYNPLICITY");
        option.SetSynthesisType(text);
        EXPECT_EQ(option.synthesisType, 0);
        EXPECT_TRUE(option.IsSemiColonWrittenBeforeAttr());
    }
}

TEST(VerilogOption, KnowsTheNameCasesInAnyCase) {
    EXPECT_EQ(Verilog::GetCaseType("DEFSULT"), 10);
    EXPECT_EQ(Verilog::GetCaseType("UPPERCASE"), 11);
    EXPECT_EQ(Verilog::GetCaseType("uppercase"), 11);
    EXPECT_EQ(Verilog::GetCaseType("LowerCase"), 12);
    for (const char* text :
         {"default", "", "UPPER", "LOWERCASES", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(Verilog::GetCaseType(text), 10);
    }
}

} // namespace
