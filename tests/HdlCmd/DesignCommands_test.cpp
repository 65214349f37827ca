// What the commands that build a design do to it.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;

namespace {

std::vector<std::string> NamesOf(const Iterator<Signal*>& signals) {
    std::vector<std::string> names;
    for (const Signal* signal : signals) {
        names.emplace_back(signal->GetNameView());
    }
    return names;
}

std::vector<std::string> NamesOf(const Iterator<Pin*>& pins) {
    std::vector<std::string> names;
    for (const Pin* pin : pins) {
        names.emplace_back(pin->GetNameView());
    }
    return names;
}

using Names = std::vector<std::string>;

constexpr const char* Cells = "ADD COMPONENT AND2\n"
                              "ADD PIN AND2 I0 Input\n"
                              "ADD PIN AND2 D(3:0) Input\n"
                              "ADD PIN AND2 K(2) BiDirectional\n"
                              "ADD PIN AND2 O Output\n"
                              "ADD INSTANCE AND2 U1\n";

class DesignCommands : public testing::Test {
protected:
    Model& GetModel() { return script_.GetModel(); }
    Signal* GetSignal(const char* name) { return GetModel().GetSignal(name); }
    Pin* GetPin(const char* name) { return GetModel().GetInstance("U1")->GetPin(name); }

    EngineScript script_{Cells};
};

} // namespace

TEST_F(DesignCommands, SetNetlistName) {
    script_.Run("SET NETLIST NAME a[3-0] ignored");
    EXPECT_EQ(GetModel().GetName(), "a[3-0]");
}

TEST_F(DesignCommands, SetSourceFile) {
    script_.Run("SET SOURCE FILE \"my design.src\" ignored");
    EXPECT_EQ(GetModel().GetSourceFileName(), "my design.src");
}

TEST_F(DesignCommands, AddComponent) {
    script_.Run("ADD COMPONENT Or<2> ignored words");
    ASSERT_NE(GetModel().GetComponent("or(2)"), nullptr);
    EXPECT_EQ(GetModel().GetComponent("OR[2]")->GetName(), "Or(2)");
}

TEST_F(DesignCommands, AddPin) {
    script_.Run("ADD PIN and2 Q[1:0] bidir 2:B:01\nADD PIN AND2 C out\nADD PIN AND2 E i \"\" x");
    const Component* component = GetModel().GetComponent("AND2");
    EXPECT_EQ(NamesOf(component->GetPinIterator()),
              (Names{"I0", "D(3:0)", "K(2)", "O", "Q(1:0)", "C", "E"}));
    const Pin* bus = component->GetPin("q(1:0)");
    EXPECT_EQ(bus->GetPinType(), PinTypeBus);
    EXPECT_EQ(bus->GetPolarity(), Polarity(Polarity::BiDirectional));
    EXPECT_EQ(bus->GetDefaultValue().GetValue(), "01");
    EXPECT_EQ(bus->GetDefaultValue().GetLength(), 2);
    EXPECT_EQ(component->GetPin("C")->GetPolarity(), Polarity(Polarity::Output));
    EXPECT_EQ(component->GetPin("C")->GetDefaultValue().GetValue(), "");
    EXPECT_EQ(component->GetPin("E")->GetPolarity(), Polarity(Polarity::Input));
    EXPECT_EQ(component->GetPin("K(2)")->GetPinType(), PinTypeBusIndex);
    EXPECT_EQ(component->GetPin("I0")->GetPinType(), PinTypeScalar);
    // The instance that was made before has none of the new pins.
    EXPECT_EQ(NamesOf(GetModel().GetInstance("U1")->GetPinIterator()),
              (Names{"I0", "D(3:0)", "K(2)", "O"}));
}

TEST_F(DesignCommands, AddInstance) {
    script_.Run("ADD INSTANCE and2 u[2] ignored");
    const Instance* instance = GetModel().GetInstance("U(2)");
    ASSERT_NE(instance, nullptr);
    EXPECT_EQ(instance->GetName(), "u(2)");
    EXPECT_EQ(instance->GetComponent(), GetModel().GetComponent("AND2"));
    EXPECT_EQ(NamesOf(instance->GetPinIterator()), (Names{"I0", "D(3:0)", "K(2)", "O"}));
}

TEST_F(DesignCommands, AddPort) {
    script_.Run("ADD PORT A in\nADD PORT B[3:0] OUTPUT\nADD PORT C b ignored");
    EXPECT_EQ(GetSignal("A")->GetPortPolarity(), Polarity(Polarity::Input));
    EXPECT_EQ(GetSignal("B(3:0)")->GetPortPolarity(), Polarity(Polarity::Output));
    EXPECT_EQ(GetSignal("B(3:0)")->GetSignalType(), SignalTypeBus);
    EXPECT_EQ(GetSignal("C")->GetPortPolarity(), Polarity(Polarity::BiDirectional));
    EXPECT_TRUE(GetSignal("C")->IsPort());
}

TEST_F(DesignCommands, AddSignal) {
    script_.Run("ADD SIGNAL N\nADD SIGNAL M Output\nADD SIGNAL B(0:3) Input\nADD SIGNAL K(1)");
    EXPECT_FALSE(GetSignal("N")->IsPort());
    // The direction is looked at and then not used.
    EXPECT_FALSE(GetSignal("M")->IsPort());
    EXPECT_FALSE(GetSignal("B(0:3)")->IsPort());
    EXPECT_EQ(GetSignal("B(0:3)")->GetSignalType(), SignalTypeBus);
    EXPECT_EQ(GetSignal("K(1)")->GetSignalType(), SignalTypeScalar);
    script_.Run("ADD SIGNAL X,Y(1:0)");
    EXPECT_EQ(GetSignal("X,Y(1:0)")->GetSignalType(), SignalTypeScalar);
}

TEST_F(DesignCommands, ConnectSignalToAPin) {
    script_.Run(
        "CONNECT SIGNAL N u1.i0\nCONNECT SIGNAL B(3:0) U1.d[3-0]\nCONNECT SIGNAL B(2) U1.K<2>");
    EXPECT_EQ(GetPin("I0")->GetSignal(), GetSignal("N"));
    EXPECT_EQ(NamesOf(GetSignal("N")->GetPinIterator()), (Names{"I0"}));
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), GetSignal("B(3:0)"));
    EXPECT_EQ(GetPin("K(2)")->GetSignal(), GetSignal("B(2)"));
    EXPECT_EQ(GetSignal("B(2)")->GetSignalType(), SignalTypeBusIndex);
}

TEST_F(DesignCommands, ConnectSignalToASecondTimeMovesThePin) {
    script_.Run("CONNECT SIGNAL N U1.I0\nCONNECT SIGNAL M U1.I0");
    EXPECT_EQ(GetPin("I0")->GetSignal(), GetSignal("M"));
    EXPECT_EQ(NamesOf(GetSignal("N")->GetPinIterator()), (Names{"I0"}));
    script_.Run("CONNECT SIGNAL N U1.I0");
    EXPECT_EQ(GetPin("I0")->GetSignal(), GetSignal("N"));
    EXPECT_EQ(NamesOf(GetSignal("N")->GetPinIterator()), (Names{"I0"}));
}

TEST_F(DesignCommands, ConnectSignals) {
    script_.Run("CONNECT SIGNAL A B\nCONNECT SIGNAL A C\nCONNECT SIGNAL A B\nCONNECT SIGNAL A A");
    EXPECT_EQ(NamesOf(GetSignal("A")->GetSignalIterator()), (Names{"B", "C"}));
    EXPECT_TRUE(NamesOf(GetSignal("B")->GetSignalIterator()).empty());
}

TEST_F(DesignCommands, ADotSelectsThePinForm) {
    script_.Run("CONNECT SIGNAL A.B N");
    EXPECT_EQ(NamesOf(GetSignal("A.B")->GetSignalIterator()), (Names{"N"}));
    EXPECT_EQ(script_.GetFailure("CONNECT SIGNAL N A.B"), "Signal \"A\" not found.\n");
    EXPECT_EQ(script_.GetFailure("ASSIGN CONSTANT A.B 1"), "Signal \"A\" not found.\n");
}

TEST_F(DesignCommands, AssignConstantToASignal) {
    script_.Run("ASSIGN CONSTANT N 0\nASSIGN CONSTANT B(7:0) 8:h:A5\nASSIGN CONSTANT B(3) \"\" x");
    EXPECT_EQ(GetSignal("N")->GetConstantValue().GetValue(), "0");
    const BitVectorValue& value = GetSignal("B(7:0)")->GetConstantValue();
    EXPECT_EQ(value.GetValue(), "A5");
    EXPECT_EQ(value.GetBase(), 16);
    EXPECT_EQ(value.GetLength(), 8);
    EXPECT_TRUE(value.HasBaseAndLength());
    EXPECT_EQ(GetSignal("B(3)")->GetConstantValue().GetValue(), "");
    script_.Run("ASSIGN CONSTANT N 1");
    EXPECT_EQ(GetSignal("N")->GetConstantValue().GetValue(), "1");
}

TEST_F(DesignCommands, AssignConstantToAPin) {
    script_.Run(
        "ASSIGN CONSTANT U1.I0 1\nASSIGN CONSTANT U1.D(3:0) 1010\nASSIGN CONSTANT U1.K(2) 0");
    const struct {
        const char* pin;
        const char* signal;
        int type;
        const char* value;
    } cases[] = {{"I0", "U1_I0_CONST_SIGNAL", SignalTypeScalar, "1"},
                 {"D(3:0)", "U1_D_CONST_SIGNAL(3:0)", SignalTypeBus, "1010"},
                 {"K(2)", "U1_K_CONST_SIGNAL(2)", SignalTypeScalar, "0"}};
    for (const auto& c : cases) {
        const Signal* signal = GetPin(c.pin)->GetSignal();
        ASSERT_NE(signal, nullptr) << c.pin;
        EXPECT_EQ(signal->GetName(), c.signal);
        EXPECT_EQ(signal, GetSignal(c.signal));
        EXPECT_EQ(signal->GetSignalType(), c.type);
        EXPECT_EQ(signal->GetConstantValue().GetValue(), c.value);
        // Only the pin knows of the link.
        EXPECT_TRUE(signal->GetPinIterator().IsAtEnd());
    }
    script_.Run("ASSIGN CONSTANT U1.I0 0");
    EXPECT_EQ(GetSignal("U1_I0_CONST_SIGNAL")->GetConstantValue().GetValue(), "0");
}

TEST_F(DesignCommands, TheConstantOfAPinUsesStoredNames) {
    script_.Run("ASSIGN CONSTANT u1.d[3-0] 4:B:0000\nASSIGN CONSTANT u1.i0 1");
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal()->GetName(), "U1_D_CONST_SIGNAL(3:0)");
    EXPECT_EQ(GetPin("I0")->GetSignal()->GetName(), "U1_I0_CONST_SIGNAL");
}

TEST_F(DesignCommands, NotesAndComments) {
    script_.Run("ADD NOTES two  words \"and  three more\"\n"
                "ADD MODULE COMMENT second\n"
                "ADD COMPONENT COMMENT AND2 of  the component\n"
                "ADD INSTANCE COMMENT U1 \"of the  instance\"\n"
                "ADD SIGNAL N\n"
                "ADD SIGNAL COMMENT N one\n"
                "ADD SIGNAL COMMENT N two\n"
                "ADD COMPONENT PIN COMMENT AND2.I0 of a pin\n"
                "ADD INSTANCE PIN COMMENT U1.D(3:0) of another");
    EXPECT_EQ(script_.GetNetlist().GetComment(), "two words and  three more\nsecond\n");
    EXPECT_EQ(GetModel().GetComponent("AND2")->GetComment(), "of the component\n");
    EXPECT_EQ(GetModel().GetInstance("U1")->GetComment(), "of the  instance\n");
    EXPECT_EQ(GetSignal("N")->GetComment(), "one\ntwo\n");
    EXPECT_EQ(GetModel().GetComponent("AND2")->GetPin("I0")->GetComment(), "of a pin\n");
    EXPECT_EQ(GetPin("D(3:0)")->GetComment(), "of another\n");
    EXPECT_EQ(GetPin("I0")->GetComment(), "");
}

TEST_F(DesignCommands, AnEmptyTextIsALine) {
    script_.Run("ADD NOTES \"\" \"\" x");
    EXPECT_EQ(script_.GetNetlist().GetComment(), "  x\n");
}

TEST_F(DesignCommands, NoOperation) {
    const int done = script_.GetDoneCount();
    script_.Run("NOOP\nnoop with words");
    EXPECT_EQ(script_.GetDoneCount(), done + 2);
}

// Signals made by their first use

TEST_F(DesignCommands, TheFirstUseDeclaresASignal) {
    script_.Run("CONNECT SIGNAL N U1.I0\nCONNECT SIGNAL Q(7:0) M\nASSIGN CONSTANT Z 1");
    EXPECT_EQ(GetSignal("N")->GetSignalType(), SignalTypeScalar);
    EXPECT_EQ(GetSignal("Q(7:0)")->GetSignalType(), SignalTypeBus);
    EXPECT_EQ(GetSignal("M")->GetSignalType(), SignalTypeScalar);
    EXPECT_EQ(GetSignal("Z")->GetSignalType(), SignalTypeScalar);
}

TEST_F(DesignCommands, BracketsDecideWhatAFirstUseDeclares) {
    script_.Run("ADD SIGNAL B[7-0]");
    EXPECT_EQ(GetSignal("B(7:0)")->GetSignalType(), SignalTypeBus);
    script_.Run("CONNECT SIGNAL B(3) X");
    EXPECT_EQ(GetSignal("B(3)")->GetSignalType(), SignalTypeBusIndex);
    EXPECT_EQ(GetSignal("X")->GetSignalType(), SignalTypeScalar);
    script_.Run("CONNECT SIGNAL B<4> X");
    EXPECT_EQ(GetSignal("B(4)")->GetSignalType(), SignalTypeScalar);
    EXPECT_EQ(script_.GetFailure("CONNECT SIGNAL B<3:0> X"),
              "Signal \"B<3:0>\" already declared.\n");
    // What exists is found in any brackets.
    script_.Run("CONNECT SIGNAL B[3] U1.I0");
    EXPECT_EQ(GetPin("I0")->GetSignal(), GetSignal("B(3)"));
}

TEST_F(DesignCommands, ANegativeIndexIsNoShape) {
    script_.Run("CONNECT SIGNAL B(-1) X\nCONNECT SIGNAL B(3:-1) Y");
    EXPECT_EQ(GetSignal("B(:1)")->GetSignalType(), SignalTypeScalar);
    EXPECT_EQ(GetSignal("B(3::1)")->GetSignalType(), SignalTypeScalar);
    EXPECT_EQ(GetSignal("B(-1)"), GetSignal("B(:1)"));
}

TEST_F(DesignCommands, ABitOrSliceSpellsItsBaseNameAsTheBusDoes) {
    script_.Run("ADD SIGNAL Data(7:0)\nCONNECT SIGNAL dATA(+3) X\nCONNECT SIGNAL DATA(3:0) X");
    EXPECT_EQ(GetSignal("data(+3)")->GetName(), "Data(+3)");
    EXPECT_EQ(GetSignal("data(3:0)")->GetName(), "Data(3:0)");
    EXPECT_EQ(GetSignal("data(3:0)")->GetSignalType(), SignalTypeBusSlice);
    const Bus* bus = script_.GetNetlist().GetParentBus("DATA");
    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), (Names{"Data(+3)", "Data(3:0)"}));
}

TEST_F(DesignCommands, CompoundsAreMadeOfTheirMembers) {
    script_.Run("ADD SIGNAL B(7:0)\nCONNECT SIGNAL A,B(3:0)\\B(7),New,C(2),D(1:0) U1.I0");
    const auto* compound = dynamic_cast<CompoundBus*>(GetSignal("A,B(3:0)\\B(7),New,C(2),D(1:0)"));
    ASSERT_NE(compound, nullptr);
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()),
              (Names{"A", "B(3:0)", "B(7)", "New", "C(2)", "D(1:0)"}));
    const int types[] = {SignalTypeScalar, SignalTypeBusSlice, SignalTypeBusIndex,
                         SignalTypeScalar, SignalTypeScalar,   SignalTypeBus};
    for (int i = 0; i < 6; ++i) {
        EXPECT_EQ(compound->GetAt(i)->GetSignalType(), types[i]) << i;
        EXPECT_EQ(compound->GetAt(i), GetSignal(compound->GetAt(i)->GetName().CStr())) << i;
    }
    EXPECT_EQ(compound->GetWidth(), 10);
    EXPECT_EQ(GetPin("I0")->GetSignal(), compound);
}

TEST_F(DesignCommands, ACompoundMayNameOneSignalTwice) {
    script_.Run("CONNECT SIGNAL A,a,A U1.I0");
    const auto* compound = dynamic_cast<CompoundBus*>(GetSignal("A,a,A"));
    ASSERT_NE(compound, nullptr);
    ASSERT_EQ(compound->GetSize(), 3);
    EXPECT_EQ(compound->GetAt(0), compound->GetAt(1));
    EXPECT_EQ(compound->GetAt(0), compound->GetAt(2));
}

TEST_F(DesignCommands, EmptyPiecesOfACompoundAreSkipped) {
    script_.Run("CONNECT SIGNAL A,,B\\,C X");
    const auto* compound = dynamic_cast<CompoundBus*>(GetSignal("A,,B\\,C"));
    ASSERT_NE(compound, nullptr);
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), (Names{"A", "B", "C"}));
    // One piece alone makes no compound.
    script_.Run("CONNECT SIGNAL D, X");
    EXPECT_EQ(GetSignal("D,")->GetSignalType(), SignalTypeScalar);
}

TEST_F(DesignCommands, PinsAreFoundAmongManyAndAmongLateOnes) {
    std::string lines = "ADD COMPONENT Wide\n";
    for (int i = 0; i < 200; ++i) {
        lines +=
            "ADD PIN Wide P" + std::to_string(i) + " " + (i % 2 == 0 ? "Input" : "Output") + "\n";
        if (i == 50) {
            lines += "ADD INSTANCE Wide Early\n";
        }
    }
    script_.Run(lines + "ADD INSTANCE Wide Late");
    EXPECT_EQ(script_.GetFailure("ADD PIN wide p150 Input"),
              "Component \"wide\" already has pin \"p150\".\n");
    EXPECT_EQ(script_.GetFailure("CONNECT SIGNAL N Early.p51"), "Pin \"Early.p51\" not found.\n");
    for (const char* moment : {"before", "after"}) {
        for (int i = 0; i < 200; ++i) {
            const std::string pin = "p" + std::to_string(i);
            EXPECT_EQ(script_.GetFailure("CONNECT SIGNAL N late." + pin), "") << moment << pin;
        }
        // Writing sorts the pins of every instance.
        script_.Verilog();
    }
    EXPECT_EQ(NamesOf(GetSignal("N")->GetPinIterator()).size(), 200u);
    EXPECT_EQ(script_.GetFailure("CONNECT SIGNAL N Late.P200"), "Pin \"Late.P200\" not found.\n");
}

// Widening

TEST_F(DesignCommands, AWiderUseReplacesTheBus) {
    script_.Run("ADD PORT Q(7:0) Output\n"
                "ADD SIGNAL COMMENT Q(7:0) kept\n"
                "ADD SIGNAL ATTRIBUTE Q(7:0) LOC P1\n"
                "ASSIGN CONSTANT Q(7:0) 8:H:A5\n"
                "CONNECT SIGNAL Q(7:0) U1.D(3:0)\n"
                "CONNECT SIGNAL Q(7:0) alias\n"
                "CONNECT SIGNAL other Q(7:0)\n"
                "CONNECT SIGNAL A,Q(7:0) compound\n"
                "CONNECT SIGNAL Q(3:0) U1.I0\n"
                "CONNECT SIGNAL Q(5) U1.O\n"
                "CONNECT SIGNAL q(15:0) U1.K(2)");
    auto* bus = dynamic_cast<Bus*>(GetSignal("Q(15:0)"));
    ASSERT_NE(bus, nullptr);
    EXPECT_EQ(bus->GetName(), "Q(15:0)");
    EXPECT_EQ(script_.GetNetlist().GetParentBus("Q"), bus);
    EXPECT_EQ(bus->GetPortPolarity(), Polarity(Polarity::Output));
    EXPECT_EQ(bus->GetComment(), "kept\n");
    ASSERT_NE(bus->GetAttr("LOC"), nullptr);
    EXPECT_EQ(bus->GetConstantValue().GetValue(), "");
    EXPECT_EQ(GetPin("K(2)")->GetSignal(), bus);

    auto* slice = dynamic_cast<BusSlice*>(GetSignal("Q(7:0)"));
    ASSERT_NE(slice, nullptr);
    EXPECT_EQ(slice->GetParentBus(), bus);
    EXPECT_EQ(slice->GetComment(), "");
    EXPECT_EQ(slice->GetAttr("LOC"), nullptr);
    EXPECT_EQ(slice->GetConstantValue().GetValue(), "A5");
    EXPECT_EQ(slice->GetConstantValue().GetBase(), 16);
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), slice);
    EXPECT_EQ(NamesOf(slice->GetPinIterator()), (Names{"D(3:0)"}));
    EXPECT_EQ(NamesOf(slice->GetSignalIterator()), (Names{"alias"}));
    EXPECT_EQ(*GetSignal("other")->GetSignalIterator().begin(), slice);
    EXPECT_EQ(dynamic_cast<CompoundBus*>(GetSignal("A,Q(7:0)"))->GetAt(1), slice);

    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), (Names{"Q(7:0)", "Q(3:0)", "Q(5)"}));
    EXPECT_EQ(dynamic_cast<BusSlice*>(GetSignal("Q(3:0)"))->GetParentBus(), bus);
    EXPECT_EQ(dynamic_cast<BusIndex*>(GetSignal("Q(5)"))->GetParentBus(), bus);
    EXPECT_EQ(GetPin("O")->GetSignal(), GetSignal("Q(5)"));

    const Names all = NamesOf(script_.GetNetlist().GetSignalIterator());
    ASSERT_GE(all.size(), 2u);
    EXPECT_EQ(all[all.size() - 2], "Q(15:0)");
    EXPECT_EQ(all[all.size() - 1], "Q(7:0)");
}

TEST_F(DesignCommands, AUseOfTheSameWidthReplacesTheBus) {
    script_.Run("ADD SIGNAL Q(7:0)\nCONNECT SIGNAL Q(0:7) X");
    EXPECT_EQ(GetSignal("Q(0:7)")->GetSignalType(), SignalTypeBus);
    EXPECT_EQ(GetSignal("Q(7:0)")->GetSignalType(), SignalTypeBusSlice);
    script_.Run("CONNECT SIGNAL Q(15:8) X");
    EXPECT_EQ(GetSignal("Q(15:8)")->GetSignalType(), SignalTypeBus);
    const auto* bus = dynamic_cast<Bus*>(GetSignal("Q(15:8)"));
    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), (Names{"Q(0:7)", "Q(7:0)"}));
}

TEST_F(DesignCommands, APinSetWithoutBeingListedFollowsTheWidening) {
    script_.Run("ASSIGN CONSTANT U1.D(3:0) 4:B:1010\n"
                "CONNECT SIGNAL U1_D_CONST_SIGNAL(7:0) X");
    EXPECT_EQ(GetSignal("U1_D_CONST_SIGNAL(7:0)")->GetSignalType(), SignalTypeBus);
    const Signal* slice = GetSignal("U1_D_CONST_SIGNAL(3:0)");
    EXPECT_EQ(slice->GetSignalType(), SignalTypeBusSlice);
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), slice);
    EXPECT_EQ(slice->GetConstantValue().GetValue(), "1010");
}

TEST_F(DesignCommands, TheSecondSignalOfAConnectionMayWidenTheFirst) {
    script_.Run("ADD SIGNAL Q(7:0)\nCONNECT SIGNAL Q(1:0) X\nCONNECT SIGNAL Q(7:0) Q(15:0)");
    const Signal* slice = GetSignal("Q(7:0)");
    ASSERT_EQ(slice->GetSignalType(), SignalTypeBusSlice);
    EXPECT_EQ(NamesOf(slice->GetSignalIterator()), (Names{"Q(15:0)"}));
    const auto* bus = dynamic_cast<Bus*>(GetSignal("Q(15:0)"));
    ASSERT_NE(bus, nullptr);
    EXPECT_TRUE(bus->GetSignalIterator().IsAtEnd());
    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), (Names{"Q(7:0)", "Q(1:0)"}));
}

TEST_F(DesignCommands, ALaterMemberOfACompoundMayWidenAnEarlierOne) {
    script_.Run("ADD SIGNAL Q(7:0)\nCONNECT SIGNAL Q(7:0),A,Q(15:0),Q(7:0) U1.I0");
    const auto* compound = dynamic_cast<CompoundBus*>(GetSignal("Q(7:0),A,Q(15:0),Q(7:0)"));
    ASSERT_NE(compound, nullptr);
    ASSERT_EQ(compound->GetSize(), 4);
    EXPECT_EQ(compound->GetAt(0)->GetSignalType(), SignalTypeBusSlice);
    EXPECT_EQ(compound->GetAt(0), GetSignal("Q(7:0)"));
    EXPECT_EQ(compound->GetAt(2), GetSignal("Q(15:0)"));
    EXPECT_EQ(compound->GetAt(3), compound->GetAt(0));
    EXPECT_EQ(compound->GetWidth(), 33);
}

TEST_F(DesignCommands, WidthsBeyondThirtyTwoBitsDoNotOverflow) {
    script_.Run("ADD SIGNAL B(2147483647:0)\n"
                "CONNECT SIGNAL B(7:0) X\n"
                "CONNECT SIGNAL B(99999999999999999999:0) Y\n"
                "CONNECT SIGNAL B(2147483647:0),B(2147483647:0) Z");
    EXPECT_EQ(GetSignal("B(7:0)")->GetSignalType(), SignalTypeBusSlice);
    EXPECT_EQ(GetSignal("B(99999999999999999999:0)")->GetWidth(), 2147483647);
    EXPECT_EQ(GetSignal("B(2147483647:0),B(2147483647:0)")->GetWidth(), 2147483647);
}

// Models without an engine

TEST(ModelNames, NullGivesTheDefaultName) {
    CommandFactory factory;
    Model model(&factory);
    EXPECT_EQ(model.GetName(), "hdlNetlist");
    model.SetName(nullptr);
    EXPECT_EQ(model.GetName(), "HDL_NETLIST");
    model.SetName("");
    EXPECT_EQ(model.GetName(), "");
    model.SetSourceFileName(nullptr);
    EXPECT_EQ(model.GetSourceFileName(), "");
    EXPECT_FALSE(model.IsModified());
}

TEST(ModelNames, NullCommentsAddNothing) {
    CommandFactory factory;
    Model model(&factory);
    model.AddComponent("C");
    model.AddPin("I", Polarity(Polarity::Input), "C", nullptr);
    model.AddInstance("U", "C");
    model.SetModifiedFlag(false);
    model.AddNotes(nullptr);
    model.AddComponentPinComment("C", "I", nullptr);
    model.AddInstancePinComment("U", "I", nullptr);
    model.AddInstancePinComment("none", "none", nullptr);
    EXPECT_EQ(model.GetNetlist()->GetComment(), "");
    EXPECT_EQ(model.GetPin("I", model.GetComponent("C"))->GetComment(), "");
    EXPECT_EQ(model.GetPin("I", model.GetInstance("U"))->GetComment(), "");
}
