// Renaming components, instances and signals by `Model`.
#include "Orn_Hdl/Orn_Hdl.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::Names;
using Support::NamesOf;

template <class Work> std::string Message(Work work) {
    try {
        work();
    } catch (const Exception& exception) {
        return exception.what();
    }
    return "";
}

TEST(Renaming, AComponentAndAnInstanceAreFoundByTheNewName) {
    Model model(nullptr);
    model.AddComponent("C");
    model.AddPin("I", In, "C", "");
    model.AddInstance("U1", "C");
    model.AddSignal("N");
    model.SetModifiedFlag(false);
    EXPECT_TRUE(model.RenameComponent("c", "D"));
    EXPECT_TRUE(model.IsModified());
    EXPECT_EQ(model.GetComponent("C"), nullptr);
    ASSERT_NE(model.GetComponent("D"), nullptr);
    EXPECT_EQ(model.GetInstance("U1")->GetComponentName(), "D");
    EXPECT_TRUE(model.RenameInstance("U1", "a_name_that_is_far_longer_than_most"));
    EXPECT_EQ(model.GetInstance("U1"), nullptr);
    ASSERT_NE(model.GetInstance("A_NAME_THAT_IS_FAR_LONGER_THAN_MOST"), nullptr);
    model.AddComponent("C");
    EXPECT_TRUE(model.RenameComponent("D", "d"));
    EXPECT_EQ(model.GetComponent("D")->GetName(), "d");
    EXPECT_EQ(Message([&] { model.RenameComponent("D", "n"); }),
              "Identifier \"n\" already defined.\n");
    EXPECT_EQ(Message([&] { model.RenameComponent("D", nullptr); }), "Invalid Name.\n");
    EXPECT_EQ(Message([&] { model.RenameComponent("X", "Y"); }), "Component \"X\" not found.\n");
    EXPECT_EQ(Message([&] { model.RenameInstance("X", "Y"); }), "\"X\" not found.\n");
    EXPECT_EQ(Message([&] { model.RenameSignal("X", "Y"); }), "Signal \"X\" not found.\n");
    EXPECT_EQ(Message([&] { model.RenameSignal("N", "Y(3:0)"); }), "Invalid Name.\n");
}

TEST(Renaming, ABusTakesItsPartsAndCompoundsAlong) {
    Model model(nullptr);
    model.AddComponent("C");
    for (const char* pin : {"I", "J", "K"}) {
        model.AddPin(pin, In, "C", "");
    }
    model.AddInstance("U", "C");
    model.AddSignal("A");
    model.AddSignal("D[7-0]");
    model.AddSignal("F(7:0)");
    model.ConnectSignalToPin("D(3:0)", "U", "I");
    model.ConnectSignalToPin("A,D(3:0),d(5)", "U", "J");
    EXPECT_EQ(Message([&] { model.RenameSignal("D(7:0)", "E(15:0)"); }), "Invalid Name.\n");
    EXPECT_EQ(Message([&] { model.RenameSignal("D(3:0)", "E(3:0)"); }), "Invalid Name.\n");
    EXPECT_EQ(Message([&] { model.RenameSignal("D(7:0)", "f[7:0]"); }),
              "Signal \"f[7:0]\" already declared.\n");
    EXPECT_EQ(Message([&] { model.RenameSignal("D(7:0)", "F(7:0)"); }),
              "Signal \"F(7:0)\" already declared.\n");
    Signal* const compound = model.GetSignal("A,D(3:0),D(5)");
    EXPECT_TRUE(model.RenameSignal("D(7:0)", "E[7-0]"));
    EXPECT_EQ(NamesOf(model.GetNetlist()->GetSignalIterator()),
              Names({"A", "E(7:0)", "F(7:0)", "E(3:0)", "E(5)", "A,E(3:0),E(5)"}));
    EXPECT_TRUE(model.RenameSignal("A", "B"));
    EXPECT_EQ(model.GetSignal("B,E(3:0),E(5)"), compound);
    EXPECT_EQ(model.GetNetlist()->GetParentBus("D"), nullptr);
    ASSERT_NE(model.GetNetlist()->GetParentBus("E"), nullptr);
    // All former names are free.
    model.AddSignal("A");
    model.AddSignal("D(7:0)");
    model.ConnectSignalToPin("A,D(3:0),D(5)", "U", "K");
    EXPECT_NE(model.GetSignal("A,D(3:0),D(5)"), compound);
    delete compound;
    EXPECT_EQ(model.GetSignal("B,E(3:0),E(5)"), nullptr);
}

TEST(Renaming, APartOfATakenNameKeepsTheBusAsItIs) {
    Model model(nullptr);
    model.AddSignal("D(7:0)");
    model.AddSignal("E(5)");
    model.AssignConstantToSignal("D(4)", "1");
    model.AssignConstantToSignal("D(5)", "1");
    EXPECT_EQ(Message([&] { model.RenameSignal("D(7:0)", "E(7:0)"); }),
              "Identifier \"E(5)\" already defined.\n");
    EXPECT_NE(model.GetSignal("D(4)"), nullptr);
    EXPECT_NE(model.GetNetlist()->GetParentBus("D"), nullptr);
}

} // namespace
