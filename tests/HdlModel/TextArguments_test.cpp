// Operations take a text in every form, and a null pointer stays one.
#include "Port/TextArgument.h"

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Streams.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace {

using namespace Orn_Hdl;
using Port::TextArgument;

const char* AddressOf(const TextArgument& text) {
    return text;
}

/// A text that a pointer stands for.
struct Named {
    operator const char*() const { return "named"; }
};

TEST(TextArgument, DoesNotCopyATextThatEndsInNul) {
    const char* const literal = "literal";
    const std::string standard(100, 's');
    const Port::String own("own");
    EXPECT_EQ(AddressOf(literal), literal);
    EXPECT_EQ(AddressOf(standard), standard.c_str());
    EXPECT_EQ(AddressOf(own), own.CStr());
}

TEST(TextArgument, CopiesAViewAndEndsIt) {
    const std::string_view whole = "D(3)rest";
    EXPECT_STREQ(TextArgument(whole.substr(0, 4)), "D(3)");
    EXPECT_STREQ(TextArgument(Port::TextView(whole.substr(0, 4))), "D(3)");
    EXPECT_STREQ(TextArgument(std::string_view("a\0b", 3)), "a");
}

TEST(TextArgument, ReadsAPointerThatAClassStandsFor) {
    EXPECT_STREQ(TextArgument(Named()), "named");
    char buffer[] = "buffer";
    char* const pointer = buffer;
    EXPECT_STREQ(TextArgument(pointer), "buffer");
    EXPECT_STREQ(TextArgument(buffer), "buffer");
}

TEST(TextArgument, TellsNullFromTheEmptyText) {
    EXPECT_EQ(TextArgument(nullptr).Get(), nullptr);
    EXPECT_EQ(TextArgument(static_cast<const char*>(nullptr)).Get(), nullptr);
    EXPECT_EQ(TextArgument(nullptr).GetView(), "");
    EXPECT_STREQ(TextArgument(std::string_view()), "");
    EXPECT_STREQ(TextArgument(""), "");
}

TEST(TextArguments, AModelTakesEveryForm) {
    Model model(nullptr);
    const std::string component = "INV";
    const std::string_view pin = "I";
    const Port::String instance("U1");
    model.AddComponent(component);
    model.AddPin(pin, Polarity(Polarity::Input), component, nullptr);
    model.AddInstance(instance, component);
    model.AddSignal(std::string_view("A"));
    model.ConnectSignalToPin(std::string("A"), instance, pin);
    EXPECT_EQ(model.GetPin(pin, model.GetInstance(instance))->GetSignal(), model.GetSignal("A"));
    EXPECT_EQ(model.GetPin(pin, nullptr), nullptr);
    model.AddInstanceAttr(instance, pin, component, nullptr);
    EXPECT_EQ(model.GetAttr(pin, model.GetInstance(instance))->GetValueString(), "INV");
    model.AddNotes(std::string("note"));
    EXPECT_EQ(model.GetNetlist()->GetComment(), "note\n");
    EXPECT_THROW(model.AddSignal(nullptr), Exception);
    EXPECT_TRUE(model.AddSignal(std::string_view()));
}

TEST(TextArguments, AnEngineTakesEveryForm) {
    Engine engine;
    EXPECT_TRUE(engine.CreateAndAddModel(std::string("top"), nullptr));
    EXPECT_TRUE(engine.UseModel(std::string_view("top")));
    engine.Execute(std::string("ADD SIGNAL A"));
    engine.Execute(Port::String("top"), std::string_view("ADD SIGNAL Bx").substr(0, 12));
    Model& model = *engine.GetModel(Port::String("top"));
    EXPECT_TRUE(model.Execute(std::string("ADD SIGNAL C")));
    EXPECT_TRUE(model.Execute(std::string_view("ADD SIGNAL Dx").substr(0, 12)));
    EXPECT_TRUE(model.Execute(nullptr));
    for (const char* name : {"A", "B", "C", "D"}) {
        EXPECT_NE(model.GetSignal(name), nullptr) << name;
    }
}

TEST(TextArguments, ObjectsTakeEveryForm) {
    const std::string standard = "standard";
    const std::string_view view = "viewed";
    const Port::String own("own");
    Netlist netlist(standard);
    EXPECT_EQ(netlist.GetName(), standard);
    EXPECT_EQ(Netlist().GetName(), "hdlNetlist");
    EXPECT_EQ(Netlist(nullptr).GetName(), "hdlNetlist");
    auto* const component = new Component(view);
    netlist.Add(component);
    component->AddPin(own, Polarity::Input, standard);
    component->AddPin("O", Polarity::Output, nullptr);
    Pin* const pin = component->GetPin(own);
    ASSERT_NE(pin, nullptr);
    EXPECT_EQ(pin->GetDefaultValue().GetValue(), standard);
    netlist.Add(new Instance(own, component));
    auto* const bus = new Bus(std::string("D(7:0)"));
    netlist.Add(bus);
    netlist.Add(new BusIndex(std::string("D(1)"), bus));
    netlist.Add(new BusSlice(std::string_view("D(3:2)"), bus));
    auto* const signal = new ScalarSignal(Port::String("A"));
    netlist.Add(signal);
    netlist.Add(new CompoundBus(std::string("A,D(7:0)")));
    EXPECT_NE(netlist.GetSignal("D(3:2)"), nullptr);

    pin->SetName(standard);
    EXPECT_EQ(component->GetPin(standard), pin);
    signal->SetName(view.substr(0, 4));
    EXPECT_EQ(signal->GetName(), "view");
    netlist.SetName(own);
    EXPECT_EQ(netlist.GetName(), "own");
    netlist.SetName(nullptr);
    EXPECT_EQ(netlist.GetName(), "");

    signal->AddAttr(new AttributeString("KEEP", "1"));
    EXPECT_NE(signal->GetAttr(std::string("keep")), nullptr);
    EXPECT_NE(signal->GetAttr(Port::String("keep")), nullptr);
    EXPECT_NE(signal->GetAttr(std::string_view("keepx").substr(0, 4)), nullptr);
    EXPECT_EQ(signal->GetAttr(nullptr), nullptr);
}

TEST(TextArguments, StreamsTakeEveryForm) {
    const Support::TemporaryFolder folder;
    const std::string name = folder / "out.txt";
    TextFileOutStream fromStandard(name, false);
    EXPECT_TRUE(fromStandard.IsOpen());
    EXPECT_TRUE(fromStandard.Open(Port::String(name), TextFileOutStream::Overwrite));
    EXPECT_TRUE(fromStandard.Open(std::string_view(name), true));
    EXPECT_EQ(TextMemOutStream(name).GetValue(), name);
    EXPECT_EQ(TextMemOutStream(Port::String(name)).GetValue(), name);
    EXPECT_EQ(TextMemOutStream(std::string_view(name)).GetValue(), name);
    EXPECT_EQ(TextMemOutStream(nullptr).GetValue(), "");
}

} // namespace
