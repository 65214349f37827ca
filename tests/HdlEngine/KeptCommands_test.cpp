// What a kept command takes of the heap and of the system, kind by kind. A design of a million
// instances is millions of commands: one more block a command is seen in its time and its memory,
// and here first.
#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/CountedAllocations.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

namespace {

constexpr std::size_t Commands = 100'000;
/// Blocks that the tables of a design take while they grow.
constexpr std::size_t Growth = 100;

/// Lines in which "#" stands for the number of the command.
struct Kind {
    const char* name;
    /// Executed once.
    std::vector<const char*> design;
    /// Executed for every number before the counted command; may be empty.
    const char* object;
    const char* command;
    /// Blocks that one command takes of the heap at most.
    std::size_t blocks;
    /// Pages of 2 MiB that all of them take at most, for themselves and their objects, and tables
    /// that have grown too large for a page.
    std::size_t pages;
};

std::ostream& operator<<(std::ostream& out, const Kind& kind) {
    return out << kind.name;
}

/// The lines of a template for every number, made before anything is counted.
std::vector<std::string> LinesOf(std::string_view pattern) {
    std::vector<std::string> lines;
    for (std::size_t i = 0; i < (pattern.empty() ? 0 : Commands); ++i) {
        std::string line;
        for (const char c : pattern) {
            line += c == '#' ? std::to_string(i) : std::string(1, c);
        }
        lines.push_back(line);
    }
    return lines;
}

class KeptCommand : public testing::TestWithParam<Kind> {};

void Measure(const Kind& kind) {
    const std::vector<std::string> commands = LinesOf(kind.command);
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel("top", "");
    Orn_Hdl::Model& model = *engine.GetModel("top");
    for (const char* line : kind.design) {
        model.ExecuteLine(line);
    }
    for (const std::string& line : LinesOf(kind.object)) {
        model.ExecuteLine(line);
    }
    const auto taken = Support::CountAllocations([&] {
        for (const std::string& line : commands) {
            model.ExecuteLine(line);
        }
    });
    EXPECT_LE(taken.blocks, kind.blocks * Commands + Growth);
    EXPECT_LE(taken.maps, kind.pages);
    const std::size_t kept = kind.design.size() + (*kind.object == '\0' ? 1 : 2) * Commands;
    EXPECT_EQ(static_cast<std::size_t>(model.GetCommandManager()->GetDoneCommandCount()), kept)
        << "every command is kept";
}

TEST_P(KeptCommand, TakesNoMoreThanItIsKnownTo) {
#if defined(ORN_HDL_SANITIZED)
    GTEST_SKIP() << "the pool hands its blocks out one by one under the sanitizers";
#endif
    // A thread of its own starts with no page that another test has begun to fill.
    std::thread([] { Measure(GetParam()); }).join();
}

const std::vector<const char*> GateAndBus{"ADD COMPONENT AND2", "ADD PIN AND2 I0 input",
                                          "ADD PIN AND2 I1 input", "ADD PIN AND2 O output",
                                          "ADD SIGNAL d(99999:0)"};
const std::vector<const char*> Gate{"ADD COMPONENT AND2", "ADD PIN AND2 I0 input",
                                    "ADD PIN AND2 I1 input", "ADD PIN AND2 O output"};

INSTANTIATE_TEST_SUITE_P(
    Each, KeptCommand,
    testing::Values(
        Kind{"NoOperation", {}, "", "NOOP", 0, 2},
        Kind{"AddComponent", {}, "", "ADD COMPONENT C#", 1, 14},
        Kind{"AddPin", {}, "ADD COMPONENT C#", "ADD PIN C# I input", 1, 6},
        Kind{"AddInstance", Gate, "", "ADD INSTANCE AND2 U#", 0, 20},
        Kind{"AddPort", {}, "", "ADD PORT p# input", 0, 13},
        Kind{"AddSignal", {}, "", "ADD SIGNAL n#", 0, 13},
        Kind{"AddBus", {}, "", "ADD SIGNAL n#(7:0)", 0, 22},
        Kind{"ConnectToANewNet", Gate, "ADD INSTANCE AND2 U#", "CONNECT SIGNAL n# U#.O", 0, 8},
        Kind{"ConnectToOneNet", Gate, "ADD INSTANCE AND2 U#", "CONNECT SIGNAL n U#.I0", 0, 2},
        Kind{"ConnectToABit", GateAndBus, "ADD INSTANCE AND2 U#", "CONNECT SIGNAL d(#) U#.O", 0, 9},
        Kind{"ConnectSignals", {}, "ADD SIGNAL a#", "CONNECT SIGNAL a# b#", 4, 10},
        Kind{"AssignConstant", Gate, "ADD INSTANCE AND2 U#", "ASSIGN CONSTANT U#.I0 1", 7, 8},
        Kind{"AddAttribute", Gate, "ADD INSTANCE AND2 U#", "ADD INSTANCE ATTRIBUTE U# LOC X#Y#", 4,
             7},
        Kind{"AddComment", Gate, "ADD INSTANCE AND2 U#", "ADD INSTANCE COMMENT U# seen", 1, 2}),
    [](const testing::TestParamInfo<Kind>& kind) { return std::string(kind.param.name); });

} // namespace
