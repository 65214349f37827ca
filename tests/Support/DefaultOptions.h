/// \file
/// The options of a model that no command has changed yet.
#pragma once

#include "Orn_Hdl/Options.h"

#include <gtest/gtest.h>

namespace Support {

inline void ExpectDefaults(const Orn_Hdl::HdlOptions& options) {
    EXPECT_FALSE(options.vhdl.suppressConfiguration);
    EXPECT_FALSE(options.vhdl.flattenBus);
    EXPECT_TRUE(options.vhdl.useDefaultLibrary);
    EXPECT_TRUE(options.vhdl.libraries.IsEmpty());
    EXPECT_TRUE(options.vhdl.useClauses.IsEmpty());
    EXPECT_FALSE(options.vhdl.useAttrType);
    EXPECT_TRUE(options.vhdl.openPin);
    EXPECT_FALSE(options.vhdl.suppressComponent);
    EXPECT_EQ(options.verilog.synthesisType, 0);
    EXPECT_EQ(options.verilog.signalCase, 10);
    EXPECT_EQ(options.verilog.instanceCase, 10);
    EXPECT_EQ(options.verilog.componentCase, 10);
    EXPECT_TRUE(options.verilog.includePaths.IsEmpty());
    EXPECT_TRUE(options.writeHeader);
    EXPECT_EQ(options.application, "");
    EXPECT_EQ(options.command, "");
    EXPECT_EQ(options.device, "");
    EXPECT_EQ(options.purpose, "");
    EXPECT_EQ(options.reference, "");
    EXPECT_TRUE(options.onePortPerLine);
    EXPECT_FALSE(options.hierarchicalInit);
}

} // namespace Support
