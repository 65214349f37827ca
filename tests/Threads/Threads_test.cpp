// Engines are independent of one another, and the tables that they share are filled safely. Several
// threads may read one model.
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
            // The banner, which tells the file's name, is written and not compared.
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

/// A design with what is looked up in different ways: a wide component, buses and their parts, a
/// compound, attributes, comments, constants.
std::vector<std::string> DesignToRead() {
    std::vector<std::string> lines{"ADD COMPONENT WIDE", "ADD PORT q(7:0) OUTPUT"};
    for (int i = 0; i < 100; ++i) {
        lines.push_back("ADD PIN WIDE p" + std::to_string(i) + " INPUT");
    }
    for (const char* line :
         {"ADD INSTANCE WIDE u0", "ADD INSTANCE WIDE u1", "CONNECT SIGNAL q(3) u0.p7",
          "CONNECT SIGNAL q(2:1) u1.p8", "CONNECT SIGNAL q(0),q(1) u1.p9",
          "ASSIGN CONSTANT k 1:B:1", "ADD MODULE ATTRIBUTE a b", "ADD NOTES text"}) {
        lines.emplace_back(line);
    }
    return lines;
}

/// Calls what a caller who only reads can call. \return a number that depends on all answers.
std::size_t ReadAll(const Orn_Hdl::Model& model) {
    using namespace Orn_Hdl;
    const Netlist& netlist = *model.GetNetlist();
    std::size_t sum = netlist.GetCommentView().size() + netlist.GetName().GetLength();
    sum += netlist.GetAttr("a")->GetValueString().GetLength();
    for (const Component* component : netlist.GetComponentIterator()) {
        sum += component->GetPin("P99") != nullptr;
        sum += component->GetPin("missing") == nullptr;
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        for (int i = 0; i < 110; ++i) {
            const Pin* const pin = instance->GetPin(("p" + std::to_string(i)).c_str());
            sum += pin == nullptr ? 1 : pin->GetNameView().size();
            sum += pin != nullptr && pin->GetDefaultValue().GetValue().IsEmpty();
        }
        PtrArray<Pin*> pins;
        instance->GetOpenPin(pins, true);
        instance->GetOutPortConnectedToInPin(pins);
        sum += static_cast<std::size_t>(pins.GetSize()) + instance->GetComponentName().GetLength();
        sum += instance->GetComponentAttr("none") == nullptr;
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        StringSet names;
        signal->GetBaseName(names);
        sum += names.IsEmpty() + signal->GetDummySignalName().GetLength();
        sum += static_cast<std::size_t>(signal->GetWidth()) + signal->HasMultiDriver();
        sum += signal->GetConstantValue().GetValue().GetLength();
        sum += netlist.GetSignal(signal->GetNameView()) == signal;
        sum += netlist.GetParentBus(signal->GetName().CStr()) != nullptr;
        for (const Pin* pin : signal->GetPinIterator()) {
            sum += pin->GetSignal() == signal;
        }
        for (const Signal* alias : signal->GetSignalIterator()) {
            sum += alias->GetNameView().size();
        }
    }
    return sum + static_cast<std::size_t>(Netlist::GetLongestAttrName(&netlist));
}

TEST(Threads, SeveralThreadsMayReadOneModel) {
    Support::EngineScript script(DesignToRead());
    for (const bool isSorted : {false, true}) {
        if (isSorted) {
            script.GetModel().GetNetlist()->SortNetlist();
            script.GetModel().GetInstance("u1")->GetPin("p50")->SetName("renamed");
        }
        const Orn_Hdl::Model& model = script.GetModel();
        std::size_t sums[2] = {};
        std::thread one([&] { sums[0] = ReadAll(model); });
        std::thread two([&] { sums[1] = ReadAll(model); });
        one.join();
        two.join();
        EXPECT_NE(sums[0], 0U);
        EXPECT_EQ(sums[0], sums[1]);
        EXPECT_EQ(sums[0], ReadAll(model));
    }
}

} // namespace
