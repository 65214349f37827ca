#include "Writers/Generics.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

namespace {

using namespace Orn_Hdl;
using namespace Orn_Hdl::Writers;
using Support::Names;
using Support::NamesOf;

/// Gives an attribute to an object.
Attribute* Add(AttributeHolder& holder, const char* name, const char* value, const char* option) {
    auto* attribute = new AttributeString(name, value);
    attribute->SetGeneric(option);
    holder.AddAttr(attribute);
    return attribute;
}

TEST(GenericAttrs, AreSplitByTheirOptionInTheirOrder) {
    AttributeHolder holder;
    Add(holder, "b", "1", "SYN");
    Add(holder, "n", "1", "NOSYN");
    Add(holder, "x", "1", "NONE");
    Add(holder, "a", "1", "SYN");
    GenericAttrs attributes(holder.GetAttrIterator());
    EXPECT_EQ(NamesOf(attributes.syn), (Names{"b", "a"}));
    EXPECT_EQ(NamesOf(attributes.nosyn), Names{"n"});
    EXPECT_FALSE(attributes.IsEmpty());
    attributes.Split(AttributeHolder().GetAttrIterator());
    EXPECT_TRUE(attributes.IsEmpty());
}

TEST(GenericAttrs, FindTheExactNameInitFirstAmongThoseForSynthesis) {
    AttributeHolder holder;
    Add(holder, "init", "1", "SYN");
    EXPECT_EQ(GenericAttrs(holder.GetAttrIterator()).FindInit(), nullptr);
    AttributeHolder other;
    Attribute* const simulated = Add(other, "INIT", "1", "NOSYN");
    EXPECT_EQ(GenericAttrs(other.GetAttrIterator()).FindInit(), simulated);
    GenericAttrs both(other.GetAttrIterator());
    AttributeString synthesised("INIT", "0");
    both.syn.Add(&synthesised);
    EXPECT_EQ(both.FindInit(), &synthesised);
}

TEST(GetEffectiveAttrs, AreTheInstancesAndThoseOfItsComponentThatItDoesNotHide) {
    const auto component = Support::MakeBuffer();
    Instance instance("U1", component.get());
    Add(*component, "A", "component", "NONE");
    Add(*component, "B", "component", "NONE");
    Add(instance, "b", "instance", "NONE");
    Add(instance, "C", "instance", "NONE");
    PtrArray<Attribute*> attributes;
    attributes.Add(nullptr);
    GetEffectiveAttrs(instance, attributes);
    EXPECT_EQ(NamesOf(attributes), (Names{"b", "C", "A"}));
    GetEffectiveAttrs(Instance("U2", nullptr), attributes);
    EXPECT_TRUE(attributes.IsEmpty());
}

TEST(PassesInit, NeedsAGenericOfThatName) {
    Netlist netlist("a_MHALVEX_b");
    EXPECT_FALSE(PassesInit(Language::Verilog, netlist));
    Attribute* const init = Add(netlist, "INIT", "1", "NONE");
    EXPECT_FALSE(PassesInit(Language::Verilog, netlist));
    init->SetGeneric("NOSYN");
    EXPECT_TRUE(PassesInit(Language::Verilog, netlist));
    EXPECT_TRUE(PassesInit(Language::Vhdl, netlist));
}

TEST(PassesInit, NeedsAMarkOfTheLanguage) {
    Netlist netlist("HHALVEX");
    Add(netlist, "INIT", "1", "SYN");
    EXPECT_TRUE(PassesInit(Language::Verilog, netlist));
    EXPECT_FALSE(PassesInit(Language::Vhdl, netlist));
    netlist.SetName("top");
    EXPECT_FALSE(PassesInit(Language::Verilog, netlist));
}

} // namespace
