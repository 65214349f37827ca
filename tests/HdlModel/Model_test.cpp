#include "Orn_Hdl/Model.h"

#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Exception.h"
#include "Support/Names.h"
#include "Support/Parts.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

/// A model with a buffer U1.
class ModelTest : public testing::Test {
protected:
    ModelTest() {
        model_.GetNetlist()->Add(Support::MakeBuffer().release());
        model_.AddInstance("U1", "BUF");
        model_.SetModifiedFlag(false);
    }

    /// Expects that `action` fails with `message`, from the right place, and modifies nothing.
    void ExpectFailure(const char* message, const std::function<void()>& action) {
        model_.SetModifiedFlag(false);
        ExpectMessage(message, action);
        EXPECT_FALSE(model_.IsModified());
    }

    /// The same of an action that may have declared signals before it fails.
    void ExpectMessage(const char* message, const std::function<void()>& action) {
        try {
            action();
            ADD_FAILURE() << "no failure, but it should be " << message;
        } catch (const Exception& exception) {
            EXPECT_EQ(exception.getLocalized(), message);
            EXPECT_EQ(exception.GetModule(), "DesignEntry");
            EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlModel");
            EXPECT_EQ(exception.GetRevision(), "$Revision: 1.8 $");
        }
    }

    /// Expects that `action` succeeds and sets the modified flag.
    void ExpectChange(const std::function<bool()>& action) {
        model_.SetModifiedFlag(false);
        EXPECT_TRUE(action());
        EXPECT_TRUE(model_.IsModified());
    }

    Names Signals() { return NamesOf(model_.GetNetlist()->GetSignalIterator()); }
    Signal* Get(const char* name) { return model_.GetSignal(name); }
    Pin* GetPin(const char* name) { return model_.GetInstance("U1")->GetPin(name); }

    Model model_{nullptr};
};

TEST(Model, StartsEmptyAndUnmodified) {
    CommandFactory factory;
    Model model(&factory);
    EXPECT_FALSE(model.IsModified());
    EXPECT_EQ(model.GetName(), "hdlNetlist");
    EXPECT_EQ(model.GetSourceFileName(), "");
    EXPECT_EQ(model.GetCommandFactory(), &factory);
    EXPECT_TRUE(model.GetNetlist()->GetSignalIterator().IsAtEnd());
    EXPECT_TRUE(model.GetOptions()->writeHeader);
    EXPECT_EQ(model.GetWrittenFileName(), "");
    EXPECT_EQ(model.GetWriteError(), 0);
    EXPECT_EQ(model.GetWriteLeftover(), 0U);
    model.SetModifiedFlag(true);
    EXPECT_TRUE(model.IsModified());
}

TEST_F(ModelTest, NamesDoNotModify) {
    model_.SetName("top[1]");
    EXPECT_EQ(model_.GetName(), "top[1]");
    EXPECT_EQ(model_.GetNetlist()->GetName(), "top[1]");
    model_.SetName(nullptr);
    EXPECT_EQ(model_.GetName(), "HDL_NETLIST");
    model_.SetSourceFileName("a.cmd");
    EXPECT_EQ(model_.GetNetlist()->GetSourceFileName(), "a.cmd");
    model_.SetSourceFileName(nullptr);
    EXPECT_EQ(model_.GetSourceFileName(), "");
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(ModelTest, LookUpsGiveNullForWhatIsAbsent) {
    Component* component = model_.GetComponent("buf");
    Instance* instance = model_.GetInstance("u1");
    ASSERT_NE(component, nullptr);
    ASSERT_NE(instance, nullptr);
    EXPECT_EQ(model_.GetComponent("U1"), nullptr);
    EXPECT_EQ(model_.GetInstance(nullptr), nullptr);
    EXPECT_EQ(model_.GetSignal("N"), nullptr);
    EXPECT_EQ(model_.GetPin("d[3-0]", component), component->GetPin("D(3:0)"));
    EXPECT_EQ(model_.GetPin("i", instance), instance->GetPin("I"));
    EXPECT_EQ(model_.GetPin("X", instance), nullptr);
    EXPECT_EQ(model_.GetPin("I", static_cast<Component*>(nullptr)), nullptr);
    EXPECT_EQ(model_.GetPin("I", static_cast<Instance*>(nullptr)), nullptr);
    EXPECT_EQ(model_.GetAttr("a", component), nullptr);
    EXPECT_EQ(model_.GetAttr("a", nullptr), nullptr);
}

TEST_F(ModelTest, AddComponent) {
    ExpectChange([&] { return model_.AddComponent("C[1]"); });
    EXPECT_EQ(model_.GetComponent("C(1)")->GetName(), "C(1)");
    ExpectFailure("Invalid Name.\n", [&] { model_.AddComponent(nullptr); });
    ExpectFailure("Identifier \"c<1>\" already defined.\n", [&] { model_.AddComponent("c<1>"); });
}

TEST_F(ModelTest, AnEmptyNameIsAName) {
    ExpectChange([&] { return model_.AddComponent(""); });
    ExpectFailure("Identifier \"\" already defined.\n", [&] { model_.AddInstance("", "BUF"); });
    ExpectFailure("Identifier \"\" already defined.\n", [&] { model_.AddSignal(""); });
}

TEST_F(ModelTest, ComponentsInstancesAndSignalsShareOneNameSpace) {
    model_.AddSignal("N");
    for (const char* name : {"buf", "u1", "n"}) {
        const std::string message = "Identifier \"" + std::string(name) + "\" already defined.\n";
        ExpectFailure(message.c_str(), [&] { model_.AddComponent(name); });
        ExpectFailure(message.c_str(), [&] { model_.AddInstance(name, "BUF"); });
        ExpectFailure(message.c_str(), [&] { model_.AddSignal(name); });
    }
}

TEST_F(ModelTest, AddPin) {
    ExpectChange([&] { return model_.AddPin("Q[1]", Out, "buf", "8:H:A5"); });
    const Pin* pin = model_.GetComponent("BUF")->GetPin("Q(1)");
    ASSERT_NE(pin, nullptr);
    EXPECT_EQ(pin->GetPinType(), 3);
    EXPECT_EQ(pin->GetDefaultValue().GetLength(), 8);
    ExpectChange([&] { return model_.AddPin("R", Out, "BUF", nullptr); });
    ExpectChange([&] { return model_.AddPin("", Out, "BUF", ""); });
    ExpectFailure("Invalid Name.\n", [&] { model_.AddPin(nullptr, In, "none", ""); });
    ExpectFailure("Component \"none\" not found.\n", [&] { model_.AddPin("A", In, "none", ""); });
    ExpectFailure("Component \"\" not found.\n", [&] { model_.AddPin("A", In, nullptr, ""); });
    ExpectFailure("Component \"Buf\" already has pin \"i\".\n",
                  [&] { model_.AddPin("i", In, "Buf", ""); });
    ExpectFailure("Component \"BUF\" already has pin \"d[3-0]\".\n",
                  [&] { model_.AddPin("d[3-0]", In, "BUF", ""); });
}

TEST_F(ModelTest, AddInstance) {
    ExpectChange([&] { return model_.AddInstance("U[2]", "buf"); });
    EXPECT_EQ(model_.GetInstance("u(2)")->GetComponentName(), "BUF");
    EXPECT_EQ(NamesOf(model_.GetInstance("U(2)")->GetPinIterator()),
              (Names{"I", "O", "B", "D(3:0)"}));
    ExpectFailure("Invalid Name.\n", [&] { model_.AddInstance(nullptr, "none"); });
    ExpectFailure("Identifier \"U1\" already defined.\n",
                  [&] { model_.AddInstance("U1", "none"); });
    ExpectFailure("Component \"none\" not found.\n", [&] { model_.AddInstance("U9", "none"); });
    ExpectFailure("Component \"\" not found.\n", [&] { model_.AddInstance("U9", nullptr); });
}

TEST_F(ModelTest, AddSignal) {
    ExpectChange([&] { return model_.AddSignal("N"); });
    ExpectChange([&] { return model_.AddSignal("B[7-0]"); });
    EXPECT_EQ(Get("N")->GetSignalType(), 50);
    EXPECT_EQ(Get("B(7:0)")->GetSignalType(), 51);
    EXPECT_EQ(Get("B(7:0)")->GetName(), "B(7:0)");
    ExpectFailure("Invalid Name.\n", [&] { model_.AddSignal(nullptr); });
    ExpectFailure("Identifier \"b<7:0>\" already defined.\n", [&] { model_.AddSignal("b<7:0>"); });
    ExpectChange([&] { return model_.AddSignal("B"); });
    EXPECT_EQ(Get("B")->GetSignalType(), 50);
}

TEST_F(ModelTest, ASecondBusOfABaseNameIsAlreadyDeclared) {
    model_.AddSignal("A(7:0)");
    ExpectFailure("Signal \"A(3:0)\" already declared.\n", [&] { model_.AddSignal("A(3:0)"); });
    ExpectFailure("Signal \"a[15-0]\" already declared.\n", [&] { model_.AddSignal("a[15-0]"); });
    EXPECT_EQ(Signals(), Names{"A(7:0)"});
}

TEST_F(ModelTest, ABitThatIsAddedIsAScalar) {
    ExpectChange([&] { return model_.AddSignal("A(3)"); });
    EXPECT_EQ(Get("A(3)")->GetSignalType(), 50);
}

TEST_F(ModelTest, ConnectSignalToPinLinksBothWays) {
    model_.AddSignal("N");
    ExpectChange([&] { return model_.ConnectSignalToPin("n", "u1", "i"); });
    EXPECT_EQ(GetPin("I")->GetSignal(), Get("N"));
    EXPECT_EQ(NamesOf(Get("N")->GetPinIterator()), Names{"I"});
}

TEST_F(ModelTest, ConnectSignalToPinNamesWhatIsMissing) {
    ExpectMessage("Signal \"U9\" not found.\n",
                  [&] { model_.ConnectSignalToPin("N1", "U9", "A"); });
    EXPECT_EQ(Signals(), Names{"N1"}) << "nothing that was done is undone";
    ExpectMessage("Pin \"U1.A\" not found.\n", [&] { model_.ConnectSignalToPin("N2", "U1", "A"); });
    ExpectMessage("Pin \"u1.\" not found.\n",
                  [&] { model_.ConnectSignalToPin("N3", "u1", nullptr); });
    ExpectFailure("Signal \"B(3)\" not found.\n",
                  [&] { model_.ConnectSignalToPin("B(3)", "U9", "A"); });
    ExpectFailure("Signal \"\" not found.\n",
                  [&] { model_.ConnectSignalToPin("N1", nullptr, "A"); });
}

TEST_F(ModelTest, ConnectSignalsKnowsARenamedSignalByTheNameUnderWhichItWasAdded) {
    model_.AddSignal("A");
    model_.AddSignal("B");
    Signal* const renamed = Get("A");
    renamed->SetName("B");
    ExpectChange([&] { return model_.ConnectSignals("A", "X"); });
    EXPECT_EQ(NamesOf(renamed->GetSignalIterator()), Names{"X"});
    EXPECT_EQ(NamesOf(Get("B")->GetSignalIterator()), Names());
}

TEST_F(ModelTest, ConnectSignalsIsOneWay) {
    ExpectChange([&] { return model_.ConnectSignals("A", "B"); });
    EXPECT_EQ(Signals(), (Names{"A", "B"}));
    EXPECT_EQ(NamesOf(Get("A")->GetSignalIterator()), Names{"B"});
    EXPECT_EQ(NamesOf(Get("B")->GetSignalIterator()), Names());
    ExpectFailure("Signal \"K(1)\" not found.\n", [&] { model_.ConnectSignals("K(1)", "L(1)"); });
    ExpectMessage("Signal \"L(1)\" not found.\n", [&] { model_.ConnectSignals("C", "L(1)"); });
    EXPECT_NE(Get("C"), nullptr) << "nothing that was done is undone";
}

TEST_F(ModelTest, AFailureLeavesTheModifiedFlagAsItWas) {
    EXPECT_THROW(model_.ConnectSignalToPin("N1", "U9", "A"), Exception);
    EXPECT_FALSE(model_.IsModified()) << "although the signal N1 has been declared";
    model_.SetModifiedFlag(true);
    EXPECT_THROW(model_.ConnectSignalToPin("N2", "U9", "A"), Exception);
    EXPECT_TRUE(model_.IsModified());
}

TEST_F(ModelTest, AssignConstantToSignal) {
    ExpectChange([&] { return model_.AssignConstantToSignal("N", "1"); });
    EXPECT_EQ(Get("N")->GetConstantValue().GetValue(), "1");
    ExpectChange([&] { return model_.AssignConstantToSignal("B(7:0)", "8:H:A5"); });
    EXPECT_EQ(Get("B(7:0)")->GetConstantValue().GetLength(), 8);
    ExpectFailure("Signal \"K(1)\" not found.\n",
                  [&] { model_.AssignConstantToSignal("K(1)", "1"); });
}

TEST_F(ModelTest, AssignConstantToPinMakesASignalOfItsOwn) {
    model_.AddPin("E[+2]", In, "BUF", "");
    model_.AddInstance("Abc", "BUF");
    ExpectChange([&] { return model_.AssignConstantToPin("ABC", "i", "1"); });
    ExpectChange([&] { return model_.AssignConstantToPin("abc", "d[3-0]", "4:B:1010"); });
    ExpectChange([&] { return model_.AssignConstantToPin("abc", "e[+2]", "1"); });
    EXPECT_EQ(Signals(),
              (Names{"Abc_I_CONST_SIGNAL", "Abc_D_CONST_SIGNAL(3:0)", "Abc_E_CONST_SIGNAL(+2)"}));
    const Instance* instance = model_.GetInstance("Abc");
    for (const char* name : {"I", "D(3:0)", "E(+2)"}) {
        const Signal* signal = instance->GetPin(name)->GetSignal();
        ASSERT_NE(signal, nullptr) << name;
        EXPECT_TRUE(signal->GetPinIterator().IsAtEnd()) << "only the pin points at it";
    }
    EXPECT_EQ(Get("Abc_D_CONST_SIGNAL(3:0)")->GetSignalType(), 51);
    EXPECT_EQ(Get("Abc_D_CONST_SIGNAL(3:0)")->GetConstantValue().GetValue(), "1010");
    EXPECT_EQ(Get("Abc_E_CONST_SIGNAL(+2)")->GetSignalType(), 50);
}

TEST_F(ModelTest, AssignConstantToPinTwiceGivesTheSignalAnotherValue) {
    model_.AssignConstantToPin("U1", "I", "1");
    ExpectChange([&] { return model_.AssignConstantToPin("U1", "I", "0"); });
    EXPECT_EQ(Signals(), Names{"U1_I_CONST_SIGNAL"});
    EXPECT_EQ(GetPin("I")->GetSignal()->GetConstantValue().GetValue(), "0");
}

TEST_F(ModelTest, AssignConstantToPinNamesWhatIsMissing) {
    ExpectFailure("Signal \"U9\" not found.\n",
                  [&] { model_.AssignConstantToPin("U9", "I", "1"); });
    ExpectFailure("Pin \"X\" not found.\n", [&] { model_.AssignConstantToPin("U1", "X", "1"); });
    ExpectFailure("Pin \"\" not found.\n", [&] { model_.AssignConstantToPin("U1", nullptr, "1"); });
}

TEST_F(ModelTest, ABitIsMadeOnUseWhenItsBusExists) {
    model_.AddSignal("B[7-0]");
    ExpectChange([&] { return model_.ConnectSignals("B(3)", "X"); });
    EXPECT_EQ(Signals(), (Names{"B(7:0)", "B(3)", "X"}));
    EXPECT_EQ(Get("B(3)")->GetSignalType(), 53);
    EXPECT_EQ(dynamic_cast<BusIndex&>(*Get("B(3)")).GetParentBus(), Get("B(7:0)"));
    EXPECT_EQ(Get("X")->GetSignalType(), 50);
}

TEST_F(ModelTest, OnlyTheFormInParenthesesIsABitOrSliceOnUse) {
    model_.AddSignal("B[7-0]");
    ExpectChange([&] { return model_.ConnectSignals("B<3>", "X"); });
    EXPECT_EQ(Signals(), (Names{"B(7:0)", "B(3)", "X"}));
    EXPECT_EQ(Get("B(3)")->GetSignalType(), 50) << "a scalar signal with a strange name";
    ExpectFailure("Signal \"B<3:0>\" already declared.\n",
                  [&] { model_.ConnectSignals("B<3:0>", "X"); });
    ExpectChange([&] { return model_.ConnectSignals("C[3:0]", "X"); });
    EXPECT_EQ(Get("C(3:0)")->GetSignalType(), 51);
    ExpectChange([&] { return model_.ConnectSignals("X,C[1]", "X"); });
    EXPECT_EQ(Get("X,C(1)")->GetSignalType(), 50);
}

TEST_F(ModelTest, ANegativeIndexIsNoneOnceItsSignHasBecomeAColon) {
    model_.AddSignal("B(7:0)");
    ExpectChange([&] { return model_.ConnectSignals("B(-3)", "X"); });
    EXPECT_EQ(Get("B(:3)")->GetSignalType(), 50);
    ExpectChange([&] { return model_.ConnectSignals("C(-3:0)", "X"); });
    EXPECT_EQ(Get("C(:3:0)")->GetSignalType(), 50);
    ExpectChange([&] { return model_.ConnectSignals("B(+3)", "X"); });
    EXPECT_EQ(Get("B(+3)")->GetSignalType(), 53);
}

TEST_F(ModelTest, ASliceIsMadeOnUseWhenItsBusIsWider) {
    model_.AddSignal("D(7:0)");
    ExpectChange([&] { return model_.ConnectSignalToPin("d(3:0)", "U1", "D(3:0)"); });
    EXPECT_EQ(Signals(), (Names{"D(7:0)", "D(3:0)"})) << "it spells its base name as the bus does";
    EXPECT_EQ(Get("D(3:0)")->GetSignalType(), 52);
    EXPECT_EQ(NamesOf(dynamic_cast<Bus&>(*Get("D(7:0)")).GetBusSliceIterator()), Names{"D(3:0)"});
    model_.ConnectSignalToPin("d(5)", "U1", "I");
    EXPECT_EQ(Signals().back(), "D(5)");
    model_.ConnectSignals("d(20:17)", "X");
    EXPECT_EQ(Get("D(20:17)")->GetSignalType(), 52) << "only the widths are compared";
}

TEST_F(ModelTest, ABusIsDeclaredOnUseWhenThereIsNone) {
    ExpectChange([&] { return model_.ConnectSignalToPin("Q(3:0)", "U1", "D(3:0)"); });
    EXPECT_EQ(Get("Q(3:0)")->GetSignalType(), 51);
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), Get("Q(3:0)"));
}

TEST_F(ModelTest, ACompoundIsMadeOfItsMembers) {
    model_.AddSignal("B(7:0)");
    ExpectChange([&] { return model_.ConnectSignalToPin("A,b(3:0),K(2)\\b(6)", "U1", "D(3:0)"); });
    EXPECT_EQ(Signals(), (Names{"B(7:0)", "A", "B(3:0)", "K(2)", "B(6)", "A,b(3:0),K(2)\\b(6)"}));
    const auto& compound = dynamic_cast<CompoundBus&>(*Get("A,b(3:0),K(2)\\b(6)"));
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"A", "B(3:0)", "K(2)", "B(6)"}));
    EXPECT_EQ(Get("K(2)")->GetSignalType(), 50) << "a bit without a bus is a scalar";
    EXPECT_EQ(Get("B(3:0)")->GetSignalType(), 52);
    EXPECT_EQ(compound.GetWidth(), 7);
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), &compound);
    model_.ConnectSignals("A,b(3:0),K(2)\\b(6)", "X");
    EXPECT_EQ(Signals().size(), 7u) << "it is found again";
}

TEST_F(ModelTest, ACompoundSkipsEmptyPiecesAndMayNameASignalTwice) {
    model_.ConnectSignals(",A,,B\\A,", "X");
    EXPECT_EQ(Signals(), (Names{"A", "B", ",A,,B\\A,", "X"}));
    EXPECT_EQ(NamesOf(dynamic_cast<CompoundBus&>(*Get(",A,,B\\A,")).GetBusMemberIterator()),
              (Names{"A", "B", "A"}));
}

TEST_F(ModelTest, TheMembersOfACompoundAreLookedUpAfterAllOfThemWereMade) {
    model_.ConnectSignals("K(2),K(3:0),K(1)", "X");
    const auto& compound = dynamic_cast<CompoundBus&>(*Get("K(2),K(3:0),K(1)"));
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"K(2)", "K(3:0)", "K(1)"}));
    EXPECT_EQ(Get("K(2)")->GetSignalType(), 50) << "the bus did not exist yet";
    EXPECT_EQ(Get("K(1)")->GetSignalType(), 53);
}

TEST_F(ModelTest, AnEmptyNameConnectsToASignalWithoutAName) {
    ExpectChange([&] { return model_.ConnectSignalToPin("", "U1", "I"); });
    EXPECT_EQ(GetPin("I")->GetSignal(), Get(""));
    ExpectChange([&] { return model_.ConnectSignals(nullptr, "X"); });
    EXPECT_EQ(Signals(), (Names{"", "X"}));
}

TEST_F(ModelTest, UserTextIsNoFormat) {
    ExpectFailure("Component \"%s%n%d\" not found.\n", [&] { model_.AddInstance("U2", "%s%n%d"); });
}

TEST_F(ModelTest, TakesNamesAndIndicesOfAnySize) {
    const std::string base(100000, 'a');
    const std::string digits(100000, '9');
    EXPECT_TRUE(model_.ConnectSignals((base + "(" + digits + ":0)").c_str(), base.c_str()));
    EXPECT_TRUE(model_.ConnectSignals((base + "(" + digits + ")").c_str(), "X"));
    EXPECT_TRUE(model_.ConnectSignals("G(2147483647:0)", "G(3:0)"));
    EXPECT_TRUE(model_.ConnectSignals("G(4294967295:0)", "G(7:0)"));
    std::string compound = "m0";
    for (int i = 1; i < 20000; ++i) {
        compound += ",m" + std::to_string(i);
    }
    EXPECT_TRUE(model_.ConnectSignals(compound.c_str(), "X"));
    EXPECT_EQ(Get(compound.c_str())->GetWidth(), 20000);
    ExpectFailure(("Component \"" + base + "\" not found.\n").c_str(),
                  [&] { model_.AddInstance("U2", base.c_str()); });
}

class Widening : public ModelTest {
protected:
    Bus& GetBus(const char* name) { return dynamic_cast<Bus&>(*Get(name)); }
    BusSlice& GetSlice(const char* name) { return dynamic_cast<BusSlice&>(*Get(name)); }
};

TEST_F(Widening, KeepsTheOldBusAsASliceWithAllItsConnections) {
    model_.AddPin("Q(7:0)", Out, "BUF", "");
    model_.AddInstance("U2", "BUF");
    Pin* pin = model_.GetInstance("U2")->GetPin("Q(7:0)");
    ExpectChange([&] { return model_.ConnectSignalToPin("Q(7:0)", "U2", "Q(7:0)"); });
    EXPECT_EQ(Get("Q(7:0)")->GetSignalType(), 51);
    ExpectChange([&] { return model_.ConnectSignals("Q(15:0)", "X"); });
    EXPECT_EQ(Signals(), (Names{"Q(15:0)", "Q(7:0)", "X"}));
    EXPECT_EQ(Get("Q(15:0)")->GetSignalType(), 51);
    EXPECT_EQ(GetSlice("Q(7:0)").GetParentBus(), Get("Q(15:0)"));
    EXPECT_EQ(pin->GetSignal(), Get("Q(7:0)"));
    EXPECT_EQ(NamesOf(Get("Q(7:0)")->GetPinIterator()), Names{"Q(7:0)"});
    EXPECT_EQ(NamesOf(Get("Q(15:0)")->GetPinIterator()), Names());
    EXPECT_EQ(model_.GetNetlist()->GetParentBus("Q"), Get("Q(15:0)"));
}

TEST_F(Widening, MovesPortPolarityAttributesAndComment) {
    model_.AddSignal("q(7:0)");
    Get("q(7:0)")->SetPortPolarity(Out);
    model_.AddSignalAttr("q(7:0)", "LOC", "x", nullptr);
    model_.AddSignalComment("q(7:0)", "comment");
    model_.AssignConstantToSignal("q(7:0)", "8:H:A5");
    model_.ConnectSignals("q(7:0)", "X");
    model_.ConnectSignals("Y", "q(7:0)");
    model_.ConnectSignals("A,q(7:0)", "Z");
    model_.ConnectSignals("Q(15:0)", "W");
    ASSERT_NE(Get("q(15:0)"), nullptr);
    const Signal& wide = *Get("q(15:0)");
    const Signal& slice = *Get("q(7:0)");
    EXPECT_EQ(wide.GetName(), "q(15:0)") << "the base name is spelled as before";
    EXPECT_EQ(wide.GetPortPolarity(), Out);
    EXPECT_EQ(NamesOf(wide.GetAttrIterator()), Names{"LOC"});
    EXPECT_EQ(wide.GetComment(), "comment\n");
    EXPECT_EQ(wide.GetConstantValue().GetValue(), "");
    EXPECT_EQ(slice.GetSignalType(), 52);
    EXPECT_EQ(slice.GetConstantValue().GetValue(), "A5");
    EXPECT_FALSE(slice.HasAttrs());
    EXPECT_EQ(slice.GetComment(), "");
    EXPECT_EQ(NamesOf(slice.GetSignalIterator()), Names{"X"});
    EXPECT_EQ(NamesOf(wide.GetSignalIterator()), Names{"W"});
    EXPECT_EQ(Get("Y")->GetSignalIterator().GetCurrent(), &slice);
    EXPECT_EQ(dynamic_cast<CompoundBus&>(*Get("A,q(7:0)")).GetAt(1), &slice);
    EXPECT_EQ(Signals(), (Names{"X", "Y", "A", "A,q(7:0)", "Z", "q(15:0)", "q(7:0)", "W"}));
}

TEST_F(Widening, MakesTheOldBusTheSliceAlsoWhereABusOrACompoundHasItAsAlias) {
    model_.ConnectSignals("b(7:0)", "q(7:0)");
    model_.ConnectSignals("c(6:0),d", "q(7:0)");
    model_.ConnectSignals("q(15:0)", "X");
    for (const char* name : {"b(7:0)", "c(6:0),d"}) {
        EXPECT_EQ(NamesOf(Get(name)->GetSignalIterator()), Names{"q(7:0)"}) << name;
        EXPECT_EQ(Get(name)->GetSignalIterator().GetCurrent(), &GetSlice("q(7:0)")) << name;
    }
}

TEST_F(Widening, MovesSlicesAndBits) {
    model_.AddSignal("Q(7:0)");
    model_.ConnectSignals("Q(3:0)", "X");
    model_.ConnectSignals("Q(5)", "X");
    model_.ConnectSignals("Q(15:0)", "X");
    EXPECT_EQ(NamesOf(GetBus("Q(15:0)").GetBusSliceIterator()),
              (Names{"Q(7:0)", "Q(3:0)", "Q(5)"}));
    EXPECT_EQ(GetSlice("Q(3:0)").GetParentBus(), Get("Q(15:0)"));
    EXPECT_EQ(dynamic_cast<BusIndex&>(*Get("Q(5)")).GetParentBus(), Get("Q(15:0)"));
    Get("Q(15:0)")->SetPortPolarity(In);
    EXPECT_EQ(Get("Q(3:0)")->GetPortPolarity(), In);
}

TEST_F(Widening, TakesAlongPinsThatTheListDoesNotShow) {
    model_.AddSignal("Q(3:0)");
    GetPin("D(3:0)")->Connect(Get("Q(3:0)"));
    model_.ConnectSignals("Q(7:0)", "X");
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), Get("Q(3:0)"));
    EXPECT_EQ(Get("Q(3:0)")->GetSignalType(), 52);
}

TEST_F(Widening, LeavesPinsThatHaveMovedOn) {
    model_.ConnectSignalToPin("Q(3:0)", "U1", "D(3:0)");
    model_.ConnectSignalToPin("other", "U1", "D(3:0)");
    model_.ConnectSignals("Q(7:0)", "X");
    EXPECT_EQ(GetPin("D(3:0)")->GetSignal(), Get("other"));
}

TEST_F(Widening, HappensForEqualWidth) {
    model_.AddSignal("Q(7:0)");
    model_.ConnectSignals("Q(0:7)", "X");
    EXPECT_EQ(Signals(), (Names{"Q(0:7)", "Q(7:0)", "X"}));
    EXPECT_EQ(Get("Q(0:7)")->GetSignalType(), 51);
    EXPECT_EQ(Get("Q(7:0)")->GetSignalType(), 52);
    EXPECT_FALSE(GetSlice("Q(7:0)").IsSameDirectionAsParent());
}

TEST_F(Widening, HappensAgainAndAgain) {
    for (const char* name : {"Q(1:0)", "Q(3:0)", "Q(7:0)", "Q(15:0)"}) {
        model_.ConnectSignals(name, "X");
    }
    EXPECT_EQ(Signals(), (Names{"X", "Q(1:0)", "Q(3:0)", "Q(15:0)", "Q(7:0)"}));
    EXPECT_EQ(Get("Q(15:0)")->GetSignalType(), 51);
    for (const char* name : {"Q(1:0)", "Q(3:0)", "Q(7:0)"}) {
        EXPECT_EQ(GetSlice(name).GetParentBus(), Get("Q(15:0)")) << name;
        EXPECT_EQ(NamesOf(Get(name)->GetSignalIterator()), Names{"X"}) << name;
    }
    EXPECT_EQ(NamesOf(GetBus("Q(15:0)").GetBusSliceIterator()),
              (Names{"Q(7:0)", "Q(3:0)", "Q(1:0)"}));
}

TEST_F(Widening, ByTheSecondSignalOfAConnectionMakesTheFirstTheSlice) {
    ExpectChange([&] { return model_.ConnectSignals("Q(3:0)", "Q(7:0)"); });
    EXPECT_EQ(Signals(), (Names{"Q(7:0)", "Q(3:0)"}));
    EXPECT_EQ(GetSlice("Q(3:0)").GetSignalIterator().GetCurrent(), Get("Q(7:0)"));
    EXPECT_EQ(NamesOf(Get("Q(7:0)")->GetSignalIterator()), Names());
}

TEST_F(Widening, ByALaterMemberOfACompoundMakesTheFirstTheSlice) {
    model_.ConnectSignals("Q(3:0),A,Q(7:0)", "X");
    const auto& compound = dynamic_cast<CompoundBus&>(*Get("Q(3:0),A,Q(7:0)"));
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"Q(3:0)", "A", "Q(7:0)"}));
    EXPECT_EQ(compound.GetAt(0), Get("Q(3:0)"));
    EXPECT_EQ(compound.GetAt(0)->GetSignalType(), 52);
    EXPECT_EQ(compound.GetAt(2)->GetSignalType(), 51);
    EXPECT_EQ(NamesOf(GetBus("Q(7:0)").GetBusSliceIterator()), Names{"Q(3:0)"});
}

TEST_F(Widening, OfABusWithADummyLeavesTheNetlistWritable) {
    model_.ConnectSignalToPin("Q(3:0)", "U1", "D(3:0)");
    Get("Q(3:0)")->SetPortPolarity(Out);
    model_.GetNetlist()->CreateVhdlDummySignals();
    ASSERT_NE(Get("Q_DUMMY(3:0)"), nullptr);
    model_.ConnectSignals("Q(7:0)", "X");
    for (int i = 0; i < 2; ++i) {
        model_.GetNetlist()->CreateVhdlDummySignals();
        model_.GetNetlist()->CreateVerilogDummySignals();
        model_.GetNetlist()->SortNetlist();
    }
    EXPECT_NE(GetPin("D(3:0)")->GetSignal(), nullptr);
}

TEST_F(ModelTest, FilesOfCommandsThatCannotBeReadAreFalse) {
    const Support::TemporaryFolder folder;
    const int before = Support::CountOpenFiles();
    EXPECT_FALSE(model_.Read((folder / "missing").c_str()));
    EXPECT_FALSE(model_.Read(folder.GetPath().c_str())) << "a folder";
    EXPECT_FALSE(model_.Read(nullptr));
    model_.SetModifiedFlag(true);
    EXPECT_FALSE(model_.Read((folder / "missing").c_str()));
    EXPECT_FALSE(model_.IsModified());
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

} // namespace
