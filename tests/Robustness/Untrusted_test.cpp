// Command files that are not trusted: which commands touch files at all, and the guard over those
// that do.
#include "Robustness/FailingSystem.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace {

using Robustness::FailingSystem;
using Support::EngineScript;

constexpr const char* Design = "ADD COMPONENT C\nADD PIN C I input\nADD INSTANCE C U\nADD SIGNAL s";

/// Refuses names that begin with "no", and remembers what it was asked.
class Guard : public Orn_Hdl::OutputGuard {
public:
    Port::StringBase<char> WhyNot(const char* fileName) override {
        asked.emplace_back(fileName);
        return asked.back().rfind("no", 0) == 0 ? "because" : "";
    }

    std::vector<std::string> asked;
};

TEST(Untrusted, OnlyWriteCommandsTouchFiles) {
    const Support::TemporaryFolder folder;
    const std::string file = folder / "file";
    Support::WriteWholeFile(file, "ADD SIGNAL read\n");
    for (const Orn_Hdl::CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
        if (std::string(command.phrase).rfind("WRITE ", 0) == 0) {
            continue;
        }
        for (int arguments = 0; arguments < 6; ++arguments) {
            EngineScript script(Design);
            std::string line(command.phrase);
            for (int i = 0; i < arguments; ++i) {
                line.append(" ").append(file);
            }
            FailingSystem calls(0, 0);
            script.GetFailure(line);
            EXPECT_EQ(calls.GetCallCount(), 0) << line;
            EXPECT_EQ(script.GetNetlist().GetSignal("read"), nullptr) << line;
        }
    }
    EXPECT_EQ(Support::ReadWholeFile(file), "ADD SIGNAL read\n");
}

TEST(Untrusted, AGuardIsAskedForEveryWrite) {
    const Support::TemporaryFolder folder;
    const std::string file = folder / "file";
    EngineScript script(Design);
    EXPECT_EQ(script.GetModel().GetOutputGuard(), nullptr);
    Guard guard;
    script.GetModel().SetOutputGuard(&guard);
    EXPECT_EQ(script.GetModel().GetOutputGuard(), &guard);
    std::vector<std::string> expected;
    for (const char* command : {"WRITE VERILOG ", "WRITE VHDL "}) {
        for (const char* options : {"", "-APPEND ", "-OVERWRITE ", "-NOHEADER "}) {
            EXPECT_EQ(script.GetFailure(command + std::string(options) + file), "");
            expected.push_back(file);
        }
    }
    EXPECT_EQ(guard.asked, expected);
    script.GetModel().SetOutputGuard(nullptr);
    EXPECT_EQ(script.GetFailure("WRITE VERILOG " + file), "");
    EXPECT_EQ(guard.asked, expected);
}

TEST(Untrusted, ARefusedWriteFailsAndChangesNothing) {
    EngineScript script(Design);
    script.Run("CONNECT SIGNAL b U.I\nADD SIGNAL a");
    Guard guard;
    script.GetModel().SetOutputGuard(&guard);
    script.GetModel().RecordWrite("former", 5);
    FailingSystem calls(0, 0);
    for (const char* command :
         {"WRITE VERILOG -NOHEADER no%s", "WRITE VHDL -APPEND -NOHEADER no%s"}) {
        EXPECT_EQ(script.GetFailure(command), "Cannot write \"no%s\": because.\n");
    }
    EXPECT_EQ(calls.GetCallCount(), 0);
    EXPECT_TRUE(script.GetModel().GetOptions()->writeHeader);
    EXPECT_EQ(script.GetModel().GetWriteError(), 5);
    // Not even sorted.
    EXPECT_EQ((*script.GetNetlist().GetSignalIterator().begin())->GetNameView(), "s");
}

} // namespace
