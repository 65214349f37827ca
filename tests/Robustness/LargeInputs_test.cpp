// Large inputs: done or refused, in memory and time that grow with the input and no faster. Times
// are not asserted; a step that took quadratic time would not end within the test's limit.
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <string>

namespace {

using Support::EngineScript;

std::size_t CountOf(const std::string& text, const std::string& piece) {
    std::size_t count = 0;
    for (std::size_t at = text.find(piece); at != std::string::npos;
         at = text.find(piece, at + piece.size())) {
        ++count;
    }
    return count;
}

template <class T> int Length(const Orn_Hdl::Iterator<T*>& list) {
    int count = 0;
    for ([[maybe_unused]] const T* element : list) {
        ++count;
    }
    return count;
}

TEST(LargeInput, ALineOfAHundredMegabytes) {
    constexpr std::size_t Size = 100'000'000;
    EngineScript script;
    std::string line = "ADD NOTES ";
    line.resize(Size, 'x');
    EXPECT_EQ(script.GetFailure(line), "");
    EXPECT_EQ(script.GetNetlist().GetCommentView().size(), Size - 10 + 1);
    line.assign(Size, 'x');
    EXPECT_EQ(script.GetFailure(line), "Command not find.\n");
    line.assign(Size, ' ');
    EXPECT_EQ(script.GetFailure(line), "");
}

TEST(LargeInput, ALineOfTenMillionWords) {
    EngineScript script;
    std::string line = "ADD NOTES";
    for (int i = 0; i < 10'000'000; ++i) {
        line += " x";
    }
    EXPECT_EQ(script.GetFailure(line), "");
    EXPECT_EQ(script.GetNetlist().GetCommentView().size(), 20'000'000u);
}

TEST(LargeInput, ANameOfAMegabyte) {
    const std::string name(1'000'000, 'n');
    EngineScript script;
    script.Run("ADD COMPONENT C\nADD PIN C I input\nADD INSTANCE C U\nADD SIGNAL " + name +
               "\nADD SIGNAL " + name + "_bus(7:0)\nCONNECT SIGNAL " + name +
               " U.I\nCONNECT SIGNAL " + name + "_bus(3) " + name + "x");
    EXPECT_EQ(CountOf(script.Verilog(), name), 6u);
    EXPECT_EQ(CountOf(script.Vhdl(), name), 6u);
    const std::string digits(1'000'000, '9');
    script.Run("ADD SIGNAL wide(" + digits + ":0)");
    EXPECT_EQ(script.GetModel().GetSignal(("wide(" + digits + ":0)").c_str())->GetWidth(),
              2147483647);
}

TEST(LargeInput, ACompoundOfAHundredThousandMembers) {
    constexpr int Members = 100'000;
    std::string name = "m0";
    for (int i = 1; i < Members; ++i) {
        name.append(",m").append(std::to_string(i));
    }
    EngineScript script("ADD COMPONENT C\nADD PIN C I(99999:0) input\nADD INSTANCE C U");
    script.Run("CONNECT SIGNAL " + name + " U.I(99999:0)");
    const Orn_Hdl::Signal* const compound = script.GetModel().GetSignal(name.c_str());
    ASSERT_NE(compound, nullptr);
    EXPECT_EQ(compound->GetWidth(), Members);
    EXPECT_EQ(CountOf(script.Verilog(), "wire m"), std::size_t(Members));
    EXPECT_EQ(CountOf(script.Vhdl(), "signal m"), std::size_t(Members));
}

TEST(LargeInput, ABusOfTwoToTheThirtyFirstBits) {
    EngineScript script;
    script.Run(
        "ADD COMPONENT C\nADD PIN C I(2147483647:0) input\nADD PIN C O(0:2147483647) output\n"
        "ADD INSTANCE C U\nADD PORT a(2147483647:0) input\nADD SIGNAL b(0:2147483647)\n"
        "CONNECT SIGNAL a(2147483647:0) U.I(2147483647:0)\n"
        "CONNECT SIGNAL b(0:2147483647) U.O(0:2147483647)\n"
        "CONNECT SIGNAL a(0:2000000000) c(2000000000:0)\n"
        "ASSIGN CONSTANT c(7) 1");
    EXPECT_EQ(script.GetModel().GetSignal("a(2147483647:0)")->GetWidth(), 2147483647);
    EXPECT_EQ(CountOf(script.Verilog(), "[2147483647:0]"), 2u);
    EXPECT_LT(script.Vhdl().size(), 100'000u);
}

TEST(LargeInput, TenThousandModelsInOneEngine) {
    constexpr int Models = 10'000;
    const auto name = [](const char* stem, int i) { return stem + std::to_string(i); };
    Orn_Hdl::Engine engine;
    for (int i = 0; i < Models; ++i) {
        ASSERT_TRUE(engine.CreateAndAddModel(name("model", i).c_str(), ""));
        engine.Execute(name("MODEL", i).c_str(), ("SET NETLIST NAME " + name("top", i)).c_str());
        engine.GetModel(name("Top", i).c_str())->SetName(name("design", i).c_str());
        engine.Execute(name("design", i).c_str(), "ADD SIGNAL s");
    }
    EXPECT_FALSE(engine.CreateAndAddModel("DESIGN77", ""));
    for (int i = 0; i < Models; i += 2) {
        EXPECT_TRUE(engine.RemoveModel(name("design", i).c_str()));
    }
    EXPECT_EQ(engine.GetModel("design0"), nullptr);
    EXPECT_NE(engine.GetModel("design1"), nullptr);
}

/// How many instances the large file has: more by hand.
int CountOfInstances() {
    const char* const wanted = std::getenv("ORN_HDL_INSTANCES");
    return wanted == nullptr ? 330'000 : std::stoi(wanted);
}

TEST(LargeInput, AMillionCommandsInOneFile) {
    const int instances = CountOfInstances();
    const Support::TemporaryFolder folder;
    const std::string name = folder / "design.cmd";
    {
        std::ofstream file(name);
        file << "ADD COMPONENT C\nADD PIN C I input\nADD PIN C O output\nADD SIGNAL clock\n";
        for (int i = 0; i < instances; ++i) {
            file << "ADD INSTANCE C U" << i << "\nCONNECT SIGNAL n" << i << " U" << i
                 << ".O\nCONNECT SIGNAL clock U" << i << ".I\n";
        }
    }
    Orn_Hdl::Engine engine;
    ASSERT_TRUE(engine.ReadCommandFile("top", name.c_str()));
    Orn_Hdl::Model& model = *engine.GetModel("top");
    EXPECT_EQ(model.GetCommandManager()->GetDoneCommandCount(), 4 + 3 * instances);
    EXPECT_EQ(Length(model.GetSignal("clock")->GetPinIterator()), instances);
    engine.Execute("top", ("WRITE VERILOG -NOHEADER " + (folder / "out.v")).c_str());
    EXPECT_EQ(CountOf(Support::ReadWholeFile(folder / "out.v"), "wire "),
              std::size_t(instances) + 1);
}

TEST(LargeInput, SignalsOnManyListsAreRemovedInAnyOrder) {
    constexpr int Count = 100'000;
    EngineScript script;
    Orn_Hdl::Netlist& netlist = script.GetNetlist();
    auto* const hub = new Orn_Hdl::ScalarSignal("hub");
    netlist.Add(hub);
    for (int i = 0; i < Count; ++i) {
        auto* const alias = new Orn_Hdl::ScalarSignal(("alias" + std::to_string(i)).c_str());
        netlist.Add(alias);
        hub->Connect(alias);
    }
    EXPECT_EQ(Length(hub->GetSignalIterator()), Count);
    netlist.Remove(hub);
    EXPECT_EQ(Length(netlist.GetSignalIterator()), Count);
}

/// A line that names so many things in a row.
template <class Name> std::string Row(int count, Name name) {
    std::string row;
    for (int i = 0; i < count; ++i) {
        row.append(i == 0 ? "" : ",").append(name(i));
    }
    return row;
}

TEST(LargeInput, NamesThatDifferInPunctuationAlone) {
    EngineScript script;
    std::string lines;
    for (unsigned i = 0; i < 1U << 16U; ++i) {
        std::string name = "n";
        for (unsigned bit = 1; bit < 1U << 16U; bit *= 2) {
            name += (i & bit) == 0 ? "_" : "$";
        }
        lines.append("ADD SIGNAL ").append(name).append("\n");
        lines.append("ADD MODULE ATTRIBUTE ").append(name).append(" 1\n");
    }
    script.Run(lines);
    EXPECT_EQ(Length(script.GetNetlist().GetSignalIterator()), 1 << 16);
}

TEST(LargeInput, ManyBusesAreWidened) {
    constexpr int Count = 30'000;
    EngineScript script;
    std::string lines;
    for (const char* range : {"(3:0)", "(7:0)"}) {
        for (int i = 0; i < Count; ++i) {
            lines += "CONNECT SIGNAL b" + std::to_string(i) + range + " x\n";
        }
    }
    script.Run(lines);
    EXPECT_EQ(Length(script.GetNetlist().GetSignalIterator()), 2 * Count + 1);
}

TEST(LargeInput, APinIsWiredToManyNets) {
    constexpr int Count = 60'000;
    EngineScript script("ADD COMPONENT C\nADD PIN C I input\nADD INSTANCE C U");
    std::string lines;
    for (int time = 0; time < 2; ++time) {
        for (int i = 0; i < Count; ++i) {
            lines += "CONNECT SIGNAL n" + std::to_string(i) + " U.I\n";
        }
    }
    script.Run(lines);
    EXPECT_EQ(Length(script.GetModel().GetSignal("n0")->GetPinIterator()), 1);
}

TEST(LargeInput, ACompoundOfOutputPortsThatIsReadInside) {
    constexpr int Count = 100'000;
    EngineScript script("ADD COMPONENT C\nADD PIN C I input\nADD PIN C J input\nADD PIN C K input\n"
                        "ADD INSTANCE C U\nADD PORT y output\nADD PORT d(100000:0) output");
    std::string lines;
    for (int i = 0; i < Count; ++i) {
        lines += "ADD PORT p" + std::to_string(i) + " output\n";
    }
    script.Run(lines);
    script.Run("CONNECT SIGNAL " + Row(Count, [](int) { return std::string("y"); }) + " U.I");
    script.Run("CONNECT SIGNAL " +
               Row(Count, [](int i) { return "d(" + std::to_string(i) + ")"; }) + " U.J");
    script.Run("CONNECT SIGNAL " + Row(Count, [](int i) { return "p" + std::to_string(i); }) +
               " U.K");
    EXPECT_EQ(CountOf(script.Vhdl(), "  signal p"), std::size_t(Count));
}

TEST(LargeInput, AnOutputPortThatIsReadInsideHasManyAliases) {
    constexpr int Count = 200'000;
    EngineScript script("ADD COMPONENT C\nADD PIN C I input\nADD INSTANCE C U\n"
                        "ADD PORT y output\nCONNECT SIGNAL y U.I");
    std::string lines;
    for (int i = 0; i < Count; ++i) {
        lines += "CONNECT SIGNAL y a" + std::to_string(i) + "\n";
    }
    script.Run(lines);
    EXPECT_EQ(CountOf(script.Vhdl(), "y_DUMMY <= a"), std::size_t(Count));
}

TEST(LargeInput, AWideCompoundIsAliasedWithABit) {
    const std::string wide = Row(200, [](int) { return std::string("d(1048575:0)"); });
    EngineScript script;
    script.Run("ADD SIGNAL d(1048575:0)\nCONNECT SIGNAL x " + wide + "\nCONNECT SIGNAL " + wide +
               " y\nASSIGN CONSTANT " + wide + " 10");
    const std::string text = script.Vhdl();
    EXPECT_LT(text.size(), 10'000U);
    EXPECT_EQ(CountOf(text, "x <= d(1048575);"), 1U);
    EXPECT_EQ(CountOf(text, "d(1048575) <= y;"), 1U);
}

TEST(LargeInput, SignalsAreRemovedInTheOrderInWhichTheyWereAdded) {
    constexpr int Count = 30'000;
    EngineScript script("ADD COMPONENT C\nADD PIN C I input\nADD INSTANCE C U");
    std::string lines;
    for (int i = 0; i < Count; ++i) {
        const std::string number = std::to_string(i);
        lines += "ADD PORT p" + number + " output\nCONNECT SIGNAL p" + number + " U.I\n";
        lines +=
            "ADD INSTANCE C U" + number + "\nCONNECT SIGNAL p" + number + " U" + number + ".I\n";
    }
    script.Run(lines);
    Orn_Hdl::Netlist& netlist = script.GetNetlist();
    netlist.CreateVhdlDummySignals();
    for (int i = 0; i < Count; ++i) {
        netlist.Remove(netlist.GetInstance("U" + std::to_string(i)));
        netlist.Remove(netlist.GetSignal("p" + std::to_string(i)));
    }
    EXPECT_EQ(Length(netlist.GetSignalIterator()), Count);
}

} // namespace
