#include "Writers/SignalLists.h"

#include "Support/Names.h"
#include "Support/Parts.h"
#include "Writers/NetlistPass.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <vector>

namespace {

using namespace Orn_Hdl;
using namespace Orn_Hdl::Writers;
using Support::Names;

Names NamesOf(const std::vector<Signal*>& signals) {
    Names names;
    for (const Signal* signal : signals) {
        names.push_back(Support::Text(signal->GetName()));
    }
    return names;
}

template <class T> T* Added(Netlist& netlist, T* object) {
    netlist.Add(object);
    return object;
}

TEST(SignalLists, HoldEachSignalWhereItIsWritten) {
    Netlist netlist;
    Added(netlist, new ScalarSignal("port"))->SetPortPolarity(Support::In);
    Signal* const net = Added(netlist, new ScalarSignal("net"));
    // VHDL has no signal of this name.
    Added(netlist, new ScalarSignal("open"))->AssignConstantValue("1");
    Bus* const bus = Added(netlist, new Bus("b(1:0)"));
    Signal* const bit = Added(netlist, new BusIndex("b(0)", bus));
    bit->AssignConstantValue("1");
    net->Connect(bit);
    const SignalLists lists(netlist, Language::Vhdl);
    EXPECT_EQ(NamesOf(lists.ports), Names{"port"});
    EXPECT_EQ(NamesOf(lists.internals), (Names{"net", "b(1:0)"})) << "a bit comes with its bus";
    EXPECT_EQ(NamesOf(lists.constants), Names{"b(0)"});
    EXPECT_EQ(NamesOf(lists.aliased), Names{"net"});
}

/// Gives a holder an attribute of that name.
template <class Holder> void AddAttr(Holder& holder, const char* name) {
    holder.AddAttr(new AttributeString(name, "value"));
}

TEST(SignalLists, MeasureAllNamesAndHoldInternalSignalsWithAttributes) {
    Netlist netlist;
    ScalarSignal* const port = Added(netlist, new ScalarSignal("port"));
    port->SetPortPolarity(Support::In);
    AddAttr(*port, "ofPort");
    Bus* const portBus = Added(netlist, new Bus("p(9:8)"));
    portBus->SetPortPolarity(Support::Out);
    BusSlice* const slice = Added(netlist, new BusSlice("p(00009:8)", portBus));
    AddAttr(*slice, "ofAPart");
    AddAttr(*Added(netlist, new ScalarSignal("long_net")), "net");
    Added(netlist, new ScalarSignal("plain"));
    const SignalLists lists(netlist, Language::Vhdl);
    EXPECT_EQ(NamesOf(lists.attributed), Names{"long_net"});
    EXPECT_EQ(lists.longestPort, Netlist::GetLongestPortName(netlist.GetSignalIterator()));
    EXPECT_EQ(lists.longestDeclared, 8) << "long_net";
    EXPECT_EQ(lists.longestAttr, 7) << "ofAPart";
}

TEST(SignalLists, MeasureSignalsThatCannotBeWritten) {
    Netlist netlist;
    ScalarSignal* const open = Added(netlist, new ScalarSignal("open"));
    AddAttr(*open, "attribute");
    Added(netlist, new ScalarSignal("a"));
    const SignalLists lists(netlist, Language::Vhdl);
    EXPECT_TRUE(lists.attributed.empty());
    EXPECT_EQ(lists.longestPort, 0);
    EXPECT_EQ(lists.longestDeclared, 4);
    EXPECT_EQ(lists.longestAttr, 9);
    open->SetPortPolarity(Support::In);
    EXPECT_EQ(SignalLists(netlist, Language::Vhdl).longestPort, 4);
}

TEST(RunsAgainstParent, OnlyOfASliceOfSeveralBits) {
    Bus descending("d(3:0)");
    Bus ascending("a(0:3)");
    EXPECT_FALSE(RunsAgainstParent(BusSlice("d(2:1)", &descending)));
    EXPECT_TRUE(RunsAgainstParent(BusSlice("d(1:2)", &descending)));
    EXPECT_FALSE(RunsAgainstParent(BusSlice("a(1:2)", &ascending)));
    EXPECT_TRUE(RunsAgainstParent(BusSlice("a(2:1)", &ascending)));
    EXPECT_FALSE(RunsAgainstParent(BusSlice("a(1:1)", &ascending)));
    EXPECT_FALSE(RunsAgainstParent(descending));
}

/// Opens what the netlisters derive from.
class Pass : public NetlistPass {
public:
    Pass(OutStream& out, Netlist& netlist, const HdlOptions& options)
        : NetlistPass(Language::Verilog, out, netlist, options) {}
    using NetlistPass::WriteEachInstance;
};

TEST(WriteEachInstance, VisitsEachOnceInOrderInDesignsOfAnySize) {
    for (const int count : {0, 1, 3, 4, 5, 12, 13, 40}) {
        Netlist netlist;
        Component* const component = Support::MakeBuffer().release();
        netlist.Add(component);
        Names expected;
        for (int i = 0; i < count; ++i) {
            expected.push_back("U" + std::to_string(i));
            netlist.Add(new Instance(expected.back().c_str(), component));
        }
        Names visited;
        TextMemOutStream out;
        const HdlOptions options;
        Pass(out, netlist, options).WriteEachInstance([&](OutStream&) {
            return [&](const Instance& instance) {
                visited.push_back(Support::Text(instance.GetName()));
            };
        });
        EXPECT_EQ(visited, expected);
    }
}

} // namespace
