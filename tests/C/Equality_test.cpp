// What is done through the C interface is what is done through the C++ interface, to the byte.
#include "C/Session.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/Golden.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

using CTests::Session;
using CTests::ToString;

namespace {

/// A design made in both ways at once.
class BothWays {
public:
    const Session c;
    Support::EngineScript cpp;

    /// Executes a line in both ways; both succeed, or fail with the same text.
    void Execute(const std::string& line) {
        const bool succeeded = orn_hdl_model_execute(c.model, line.c_str()) == ORN_HDL_OK;
        EXPECT_EQ(succeeded ? std::string() : c.GetError(), cpp.GetFailure(line)) << line;
    }

    /// Requires the same from an operation in both ways.
    template <class Action> void Require(orn_hdl_status_t status, const Action& action) {
        EXPECT_EQ(status == ORN_HDL_OK ? std::string() : c.GetError(), Support::FailureOf(action));
    }

    void RequireSameDesign() {
        for (const auto& [language, extension] :
             {std::pair(ORN_HDL_VERILOG, ".v"), std::pair(ORN_HDL_VHDL, ".vhd")}) {
            EXPECT_EQ(orn_hdl_model_set_number(c.model, ORN_HDL_WRITE_HEADER, 0), ORN_HDL_OK);
            const std::string file = folder_ / ("c" + std::string(extension)).c_str();
            EXPECT_EQ(orn_hdl_model_write(c.model, language, file.c_str(), 0), ORN_HDL_OK);
            EXPECT_EQ(Support::ReadWholeFile(file),
                      language == ORN_HDL_VERILOG ? cpp.Verilog() : cpp.Vhdl());
        }
        EXPECT_EQ(CommandsOfC(), CommandsOfCpp());
    }

private:
    std::string CommandsOfC() const {
        char* text = nullptr;
        size_t length = 0;
        if (orn_hdl_model_write_commands_text(c.model, &text, &length) != ORN_HDL_OK) {
            return c.GetError();
        }
        std::string result(text, length);
        orn_hdl_free(text);
        return result;
    }
    std::string CommandsOfCpp() {
        Orn_Hdl::TextMemOutStream out;
        const std::string failure = Support::FailureOf([&] { cpp.GetModel().WriteCommands(out); });
        return failure.empty() ? std::string(out.GetValue().GetView()) : failure;
    }

    const Support::TemporaryFolder folder_;
};

TEST(CEquality, GoldenDesigns) {
    for (const std::string& name : Support::GoldenNames()) {
        SCOPED_TRACE(name);
        BothWays both;
        for (const std::string& line : Support::SplitLines(Support::GoldenText(name + ".cmd"))) {
            both.Execute(line);
        }
        both.RequireSameDesign();
    }
}

TEST(CEquality, EveryPhraseOfTheCatalogue) {
    BothWays both;
    for (const std::string& line : Support::SplitLines(Robustness::MidSizedDesign())) {
        both.Execute(line);
    }
    orn_hdl_command_t command;
    size_t count = 0;
    for (; orn_hdl_get_command(count, &command) == ORN_HDL_OK; ++count) {
        const std::string phrase = command.phrase;
        both.Execute(phrase);
        if (phrase.rfind("WRITE", 0) == 0) {
            continue;
        }
        for (const char* arguments :
             {" NEW", " NEW2 input", " R0 NEW3", " R0 INIT 8:B:1", " REG INIT 1", " A(7:0) KEEP 1",
              " REG.C NOTE first", " R0.C NOTE first", " INIT 2", " R0 -TYPE=User KIND x",
              " KIND COLOUR", " R0 KIND COLOUR", " R0.C NOTE -GENERIC=SYN", " \"two words\""}) {
            both.Execute(phrase + arguments);
        }
    }
    EXPECT_EQ(count, 61U);
    both.Execute("SET NETLIST NAME top");
    both.RequireSameDesign();
}

TEST(CEquality, AReplayedFile) {
    const Support::TemporaryFolder folder;
    const std::string file = folder / "design.cmd";
    Support::WriteWholeFile(file, Robustness::MidSizedDesign());
    BothWays both;
    EXPECT_EQ(orn_hdl_model_replay(both.c.model, file.c_str(), nullptr, nullptr, nullptr),
              ORN_HDL_OK);
    EXPECT_TRUE(both.cpp.GetModel().Read(file));
    both.RequireSameDesign();
}

/// Calls random operations of a model in both ways.
class RandomDesign {
public:
    explicit RandomDesign(unsigned seed) : random_(seed) {}

    void Run(int calls) {
        for (int i = 0; i < calls; ++i) {
            Call();
        }
        both_.RequireSameDesign();
    }

private:
    std::size_t Draw(std::size_t count) { return random_() % count; }
    template <std::size_t Count> std::string Pick(const char* const (&texts)[Count]) {
        return texts[Draw(Count)];
    }
    std::string Component() { return Pick({"INV", "REG", "MUX", "REG2"}); }
    std::string Instance() { return "U" + std::to_string(Draw(6)); }
    std::string Pin() { return Pick({"I", "O", "D(3:0)", "Q(3:0)", "S(1)"}); }
    std::string Signal() {
        return Pick({"A", "B", "D(7:0)", "D(3:0)", "D(2)", "E(0:3)", "A,B", "D(1:0),A", "Y"});
    }
    std::string Value() { return Pick({"1", "0", "4:B:1010", "4:H:F", "text", ""}); }

    void Call() {
        switch (Draw(3)) {
        case 0:
            return CallForObjects();
        case 1:
            return CallForConnections();
        default:
            return CallForAttributes();
        }
    }

    void CallForObjects() {
        const std::string name = Component();
        const std::string other = Component();
        const std::string instance = Instance();
        const std::string signal = Signal();
        const std::string pin = Pin();
        const std::string newName = Pick({"Z", "Y", "D(7:0)"});
        const std::string direction = Pick({"input", "output", "inout", "sideways"});
        const orn_hdl_model_t c = both_.c.model;
        switch (Draw(7)) {
        case 0:
            return both_.Require(orn_hdl_model_add_component(c, name.c_str()),
                                 [&] { Cpp().AddComponent(name); });
        case 1:
            return both_.Require(
                orn_hdl_model_add_pin(c, name.c_str(), pin.c_str(), direction.c_str(), nullptr),
                [&] { Cpp().AddPin(pin, direction, name); });
        case 2:
            return both_.Require(orn_hdl_model_add_instance(c, instance.c_str(), name.c_str()),
                                 [&] { Cpp().AddInstance(instance, name); });
        case 3:
            return both_.Require(orn_hdl_model_add_port(c, signal.c_str(), direction.c_str()),
                                 [&] { Cpp().AddPort(signal, direction); });
        case 4:
            return both_.Require(orn_hdl_model_add_signal(c, signal.c_str()),
                                 [&] { Cpp().AddSignal(signal); });
        case 5:
            return both_.Require(orn_hdl_model_rename_component(c, name.c_str(), other.c_str()),
                                 [&] { Cpp().RenameComponent(name, other); });
        default:
            return both_.Require(orn_hdl_model_rename_signal(c, signal.c_str(), newName.c_str()),
                                 [&] { Cpp().RenameSignal(signal, newName); });
        }
    }

    void CallForConnections() {
        const std::string signal = Signal();
        const std::string instance = Instance();
        const std::string pin = Pin();
        const std::string value = Value();
        const orn_hdl_model_t c = both_.c.model;
        switch (Draw(6)) {
        case 0:
            return both_.Require(orn_hdl_model_connect_signals(c, signal.c_str(), "B"),
                                 [&] { Cpp().ConnectSignals(signal, "B"); });
        case 1:
            return both_.Require(orn_hdl_model_assign_signal(c, signal.c_str(), value.c_str()),
                                 [&] { Cpp().AssignConstantToSignal(signal, value); });
        case 2:
            return both_.Require(
                orn_hdl_model_assign_pin(c, instance.c_str(), pin.c_str(), value.c_str()),
                [&] { Cpp().AssignConstantToPin(instance, pin, value); });
        default:
            return both_.Require(
                orn_hdl_model_connect(c, signal.c_str(), instance.c_str(), pin.c_str()),
                [&] { Cpp().ConnectSignalToPin(signal, instance, pin); });
        }
    }

    /// An operation on an attribute or a comment of one kind of holder: the C++ side executes the
    /// command that calls it.
    void CallForAttributes() {
        const auto holder = static_cast<orn_hdl_holder_t>(Draw(6));
        const bool isOfComponent =
            holder == ORN_HDL_OF_COMPONENT || holder == ORN_HDL_OF_COMPONENT_PIN;
        const std::string owner = isOfComponent                 ? Component()
                                  : holder == ORN_HDL_OF_SIGNAL ? Signal()
                                                                : Instance();
        const std::string pin = Pin();
        const std::string name = Pick({"INIT", "LOC", "KEEP"});
        const std::string value = Pick({"1", "0", "4:B:1010", "text"});
        const std::string type = Pick({"String", "Integer", "BitVector", "User"});
        const std::string option = Pick({"NONE", "SYN", "NOSYN"});
        static constexpr const char* Words[] = {"MODULE", "COMPONENT",     "INSTANCE",
                                                "SIGNAL", "COMPONENT PIN", "INSTANCE PIN"};
        const std::string kind = Words[holder];
        const std::string place = holder == ORN_HDL_OF_MODULE         ? ""
                                  : holder < ORN_HDL_OF_COMPONENT_PIN ? " " + owner
                                                                      : " " + owner + "." + pin;
        const orn_hdl_model_t c = both_.c.model;
        const char* const o = owner.c_str();
        const char* const p = pin.c_str();
        const char* const n = name.c_str();
        const auto execute = [&](const std::string& line) {
            return [this, line] { both_.cpp.GetEngine().Execute(line); };
        };
        switch (Draw(6)) {
        case 0:
            return both_.Require(
                orn_hdl_model_set_attribute(c, holder, o, p, n, value.c_str()),
                execute("SET " + kind + " ATTRIBUTE VALUE" + place + " " + name + " " + value));
        case 1:
            return both_.Require(orn_hdl_model_set_generic(c, holder, o, p, n, option.c_str()),
                                 execute("SET " + kind + " ATTRIBUTE OPTION" + place + " " + name +
                                         " -GENERIC=" + option));
        case 2:
            return both_.Require(orn_hdl_model_set_synthesis(c, holder, o, p, n, "ASSIGN"),
                                 execute("SET " + kind + " ATTRIBUTE OPTION" + place + " " + name +
                                         " -SYNATTR=ASSIGN"));
        case 3:
            return both_.Require(
                orn_hdl_model_set_user_type(c, holder, o, p, n, "colour"),
                execute("SET " + kind + " ATTRIBUTE USERTYPE" + place + " " + name + " colour"));
        case 4:
            return both_.Require(orn_hdl_model_add_comment(c, holder, o, p, value.c_str()),
                                 execute("ADD " + kind + " COMMENT" + place + " " + value));
        default:
            return both_.Require(
                orn_hdl_model_add_attribute(c, holder, o, p, n, value.c_str(), type.c_str()),
                execute("ADD " + kind + " ATTRIBUTE" + place + " -TYPE=" + type + " " + name + " " +
                        value));
        }
    }

    Orn_Hdl::Model& Cpp() { return both_.cpp.GetModel(); }

    BothWays both_;
    std::mt19937 random_;
};

TEST(CEquality, RandomDesigns) {
    for (unsigned seed = 1; seed <= 60; ++seed) {
        SCOPED_TRACE(seed);
        RandomDesign(seed).Run(200);
    }
}

TEST(CEquality, ManyObjectsInOneCall) {
    BothWays both;
    for (const char* line : {"ADD COMPONENT INV", "ADD PIN INV I input", "ADD PIN INV O output"}) {
        both.Execute(line);
    }
    std::vector<std::string> names;
    std::vector<const char*> pointers;
    std::vector<orn_hdl_connection_t> connections;
    for (int i = 0; i < 100; ++i) {
        names.push_back("U" + std::to_string(i));
    }
    for (std::size_t i = 0; i < names.size(); ++i) {
        pointers.push_back(names[i].c_str());
        connections.push_back({"N", names[i].c_str(), "I"});
        both.cpp.Run("ADD INSTANCE INV " + names[i] + "\n");
    }
    for (const std::string& name : names) {
        both.cpp.Run("CONNECT SIGNAL N " + name + ".I\n");
    }
    size_t done = 0;
    EXPECT_EQ(
        orn_hdl_model_add_instances(both.c.model, "INV", pointers.data(), pointers.size(), &done),
        ORN_HDL_OK);
    EXPECT_EQ(done, 100U);
    EXPECT_EQ(
        orn_hdl_model_connect_many(both.c.model, connections.data(), connections.size(), &done),
        ORN_HDL_OK);
    EXPECT_EQ(done, 100U);
    both.RequireSameDesign();
    EXPECT_EQ(orn_hdl_model_add_instances(both.c.model, "INV", pointers.data(), 2, &done),
              ORN_HDL_FAILED);
    EXPECT_EQ(done, 0U);
    EXPECT_EQ(orn_hdl_model_add_instances(both.c.model, "INV", nullptr, 2, nullptr),
              ORN_HDL_INVALID_ARGUMENT);
}

} // namespace
