// Engines are independent of one another, and the tables that they share are filled safely.
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/Environment.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

namespace {

constexpr int Rounds = 20;

/// Builds and writes the design again and again. \return the last netlists.
std::string BuildAndWrite(const std::string& file) {
    std::string text;
    for (int i = 0; i < Rounds; ++i) {
        Support::EngineScript script(Robustness::MidSizedDesign());
        text.clear();
        for (const char* language : {"VERILOG ", "VHDL "}) {
            // The banner contains the file's name, so it is written but not compared.
            script.Run("WRITE " + std::string(language) + file);
            script.Run("WRITE " + std::string(language) + "-NOHEADER " + file);
            text += Support::ReadWholeFile(file);
        }
        EXPECT_TRUE(Orn_Hdl::Engine::IsVhdlKeyword("Entity"));
        EXPECT_TRUE(Orn_Hdl::Engine::IsVerilogKeyword("module"));
        EXPECT_FALSE(Orn_Hdl::Engine::IsVerilogKeyword("Module"));
    }
    return text;
}

TEST(Threads, EnginesAreIndependent) {
    const Support::EnvironmentVariable time("SOURCE_DATE_EPOCH", "1000000000");
    const Support::TemporaryFolder first;
    const Support::TemporaryFolder second;
    std::string texts[2];
    // Nothing is done before: both threads fill the shared tables.
    std::thread one([&] { texts[0] = BuildAndWrite(first / "netlist"); });
    std::thread two([&] { texts[1] = BuildAndWrite(second / "netlist"); });
    one.join();
    two.join();
    EXPECT_NE(texts[0], "");
    EXPECT_TRUE(texts[0] == texts[1]);
}

TEST(Threads, AnEngineMayMoveToAnotherThread) {
    const Support::TemporaryFolder folder;
    std::vector<std::unique_ptr<Support::EngineScript>> scripts;
    for (int i = 0; i < 3; ++i) {
        std::thread([&] {
            scripts.push_back(
                std::make_unique<Support::EngineScript>(Robustness::MidSizedDesign()));
        }).join();
    }
    std::thread([&] {
        for (const auto& script : scripts) {
            EXPECT_NE(script->Verilog(), "");
        }
        scripts.clear();
    }).join();
    EXPECT_TRUE(scripts.empty());
}

} // namespace
