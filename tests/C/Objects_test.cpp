// A design read through the C interface: objects, lists, and handles that outlive their objects.
#include "C/Session.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

using CTests::NameOf;
using CTests::Session;
using CTests::ToString;

namespace {

class CObjects : public testing::Test {
protected:
    CObjects() { session.Run(CTests::SmallDesign); }

    /// The names of the objects in a list.
    static std::vector<std::string> Names(orn_hdl_object_t owner, int32_t list) {
        orn_hdl_cursor_t cursor;
        EXPECT_EQ(orn_hdl_object_walk(owner, list, &cursor), ORN_HDL_OK);
        std::vector<std::string> names;
        orn_hdl_object_t object;
        while (orn_hdl_cursor_next(&cursor, &object) == ORN_HDL_OK) {
            names.push_back(NameOf(object));
        }
        EXPECT_EQ(orn_hdl_cursor_next(&cursor, &object), ORN_HDL_END);
        return names;
    }
    orn_hdl_object_t GetNetlist() const {
        orn_hdl_object_t netlist = {};
        EXPECT_EQ(orn_hdl_model_get_netlist(session.model, &netlist), ORN_HDL_OK);
        return netlist;
    }
    static int32_t KindOf(orn_hdl_object_t object) {
        int32_t kind = 0;
        EXPECT_EQ(orn_hdl_object_get_kind(object, &kind), ORN_HDL_OK);
        return kind;
    }

    const Session session;
};

using TextList = std::vector<std::string>;

TEST_F(CObjects, AreListedInTheirOrder) {
    const orn_hdl_object_t netlist = GetNetlist();
    EXPECT_EQ(Names(netlist, ORN_HDL_COMPONENTS), (TextList{"INV", "ROM"}));
    EXPECT_EQ(Names(netlist, ORN_HDL_INSTANCES), (TextList{"U1", "U2"}));
    EXPECT_EQ(Names(session.GetInstance("U1"), ORN_HDL_PINS), (TextList{"I", "O"}));
    EXPECT_EQ(Names(session.GetSignal("Y"), ORN_HDL_ATTRIBUTES), (TextList{"LOC"}));
    EXPECT_EQ(Names(session.GetSignal("Y"), ORN_HDL_PINS), (TextList{"O"}));
    EXPECT_EQ(Names(session.GetSignal("D(7:6),D(1:0)"), ORN_HDL_MEMBERS),
              (TextList{"D(7:6)", "D(1:0)"}));
    EXPECT_EQ(Names(session.GetSignal("D(7:0)"), ORN_HDL_PARTS),
              (TextList{"D(2)", "D(7:6)", "D(1:0)"}));
    EXPECT_EQ(Names(session.GetSignal("Y"), ORN_HDL_ALIASES), TextList());
}

TEST_F(CObjects, HaveNoListsOfOtherKinds) {
    orn_hdl_cursor_t cursor;
    EXPECT_EQ(orn_hdl_object_walk(session.GetSignal("Y"), ORN_HDL_PARTS, &cursor),
              ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_object_walk(session.GetSignal("Y"), ORN_HDL_COMPONENTS, &cursor),
              ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_object_walk(session.GetSignal("Y"), 99, &cursor), ORN_HDL_INVALID_ARGUMENT);
    EXPECT_EQ(orn_hdl_object_walk({}, ORN_HDL_PARTS, &cursor), ORN_HDL_NULL_HANDLE);
    EXPECT_EQ(orn_hdl_object_walk(GetNetlist(), ORN_HDL_SIGNALS, nullptr),
              ORN_HDL_INVALID_ARGUMENT);
}

TEST_F(CObjects, ComeSeveralAtATime) {
    session.Run("ADD INSTANCE INV U3\nADD INSTANCE INV U4\nADD INSTANCE INV U5\n");
    orn_hdl_cursor_t cursor;
    ASSERT_EQ(orn_hdl_object_walk(GetNetlist(), ORN_HDL_INSTANCES, &cursor), ORN_HDL_OK);
    orn_hdl_object_t objects[3];
    size_t count = 0;
    ASSERT_EQ(orn_hdl_cursor_next_many(&cursor, objects, 3, &count), ORN_HDL_OK);
    EXPECT_EQ(count, 3U);
    EXPECT_EQ(NameOf(objects[2]), "U3");
    // What is added in the meantime is visited.
    session.Run("ADD INSTANCE INV U6\n");
    ASSERT_EQ(orn_hdl_cursor_next_many(&cursor, objects, 3, &count), ORN_HDL_OK);
    EXPECT_EQ(count, 3U);
    EXPECT_EQ(NameOf(objects[2]), "U6");
    EXPECT_EQ(orn_hdl_cursor_next_many(&cursor, objects, 3, &count), ORN_HDL_END);
}

TEST_F(CObjects, TellTheirShape) {
    const orn_hdl_object_t bus = session.GetSignal("D(7:0)");
    EXPECT_EQ(KindOf(bus), ORN_HDL_KIND_BUS);
    EXPECT_EQ(KindOf(session.GetSignal("D(2)")), ORN_HDL_KIND_BIT);
    EXPECT_EQ(KindOf(session.GetSignal("D(7:6)")), ORN_HDL_KIND_SLICE);
    EXPECT_EQ(KindOf(session.GetSignal("D(7:6),D(1:0)")), ORN_HDL_KIND_COMPOUND);
    EXPECT_EQ(KindOf(session.GetSignal("Y")), ORN_HDL_KIND_SCALAR);
    EXPECT_EQ(KindOf(GetNetlist()), ORN_HDL_KIND_NETLIST);
    int32_t number = 0;
    EXPECT_EQ(orn_hdl_object_get_width(bus, &number), ORN_HDL_OK);
    EXPECT_EQ(number, 8);
    EXPECT_EQ(orn_hdl_object_get_direction(bus, &number), ORN_HDL_OK);
    EXPECT_EQ(number, ORN_HDL_INPUT);
    EXPECT_EQ(orn_hdl_object_get_direction(session.GetSignal("N"), &number), ORN_HDL_OK);
    EXPECT_EQ(number, ORN_HDL_NO_DIRECTION);
    orn_hdl_text_t base;
    int32_t left = 0;
    int32_t right = 0;
    EXPECT_EQ(orn_hdl_object_get_range(bus, &base, &left, &right), ORN_HDL_OK);
    EXPECT_EQ(ToString(base), "D");
    EXPECT_EQ(left, 7);
    EXPECT_EQ(right, 0);
    EXPECT_EQ(orn_hdl_object_get_range(session.GetSignal("D(2)"), nullptr, &left, &right),
              ORN_HDL_OK);
    EXPECT_EQ(left, 2);
    EXPECT_EQ(right, 2);
    EXPECT_EQ(orn_hdl_object_get_range(session.GetSignal("Y"), nullptr, &left, &right),
              ORN_HDL_WRONG_KIND);
}

TEST_F(CObjects, LeadToOneAnother) {
    const orn_hdl_object_t instance = session.GetInstance("U1");
    orn_hdl_object_t found;
    ASSERT_EQ(orn_hdl_instance_get_component(instance, &found), ORN_HDL_OK);
    EXPECT_EQ(NameOf(found), "INV");
    orn_hdl_object_t pin;
    ASSERT_EQ(orn_hdl_object_get_pin(instance, "i", &pin), ORN_HDL_OK);
    EXPECT_EQ(KindOf(pin), ORN_HDL_KIND_SCALAR_PIN);
    ASSERT_EQ(orn_hdl_pin_get_signal(pin, &found), ORN_HDL_OK);
    EXPECT_EQ(NameOf(found), "D(2)");
    ASSERT_EQ(orn_hdl_part_get_bus(found, &found), ORN_HDL_OK);
    EXPECT_EQ(NameOf(found), "D(7:0)");
    EXPECT_EQ(orn_hdl_object_get_pin(instance, "Z", &pin), ORN_HDL_NOT_FOUND);
    EXPECT_EQ(orn_hdl_pin_get_signal(instance, &found), ORN_HDL_WRONG_KIND);
    orn_hdl_constant_t constant;
    ASSERT_EQ(orn_hdl_model_get_component(session.model, "ROM", &found), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_object_get_pin(found, "A(3:0)", &pin), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_object_get_constant(pin, &constant), ORN_HDL_OK);
    EXPECT_EQ(ToString(constant.digits), "A");
    EXPECT_EQ(constant.base, 16);
    EXPECT_EQ(constant.length, 4);
    ASSERT_EQ(orn_hdl_object_get_constant(session.GetSignal("N"), &constant), ORN_HDL_OK);
    EXPECT_EQ(ToString(constant.digits), "1");
    EXPECT_EQ(constant.isSized, 0);
    orn_hdl_text_t comment;
    ASSERT_EQ(orn_hdl_object_get_comment(instance, &comment), ORN_HDL_OK);
    EXPECT_EQ(ToString(comment), "first\n");
}

TEST_F(CObjects, TellTheirAttributes) {
    orn_hdl_object_t found;
    ASSERT_EQ(orn_hdl_object_get_attribute(session.GetSignal("Y"), "loc", &found), ORN_HDL_OK);
    orn_hdl_attribute_t attribute;
    ASSERT_EQ(orn_hdl_attribute_get(found, &attribute), ORN_HDL_OK);
    EXPECT_EQ(ToString(attribute.name), "LOC");
    EXPECT_EQ(ToString(attribute.type), "String");
    EXPECT_EQ(ToString(attribute.value), "P4");
    EXPECT_EQ(ToString(attribute.generic), "NONE");
    EXPECT_EQ(ToString(attribute.userType), "");
    ASSERT_EQ(orn_hdl_model_add_attribute(session.model, ORN_HDL_OF_INSTANCE_PIN, "U1", "I", "INIT",
                                          "8:H:A5", "BitVector"),
              ORN_HDL_OK);
    orn_hdl_object_t pin;
    ASSERT_EQ(orn_hdl_object_get_pin(session.GetInstance("U1"), "I", &pin), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_object_get_attribute(pin, "INIT", &found), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_attribute_get(found, &attribute), ORN_HDL_OK);
    EXPECT_EQ(ToString(attribute.constant.digits), "A5");
    EXPECT_EQ(attribute.constant.length, 8);
    EXPECT_EQ(orn_hdl_attribute_get(pin, &attribute), ORN_HDL_WRONG_KIND);
    EXPECT_EQ(orn_hdl_object_get_attribute(found, "INIT", &found), ORN_HDL_WRONG_KIND);
}

TEST_F(CObjects, GiveAllWiresInOneCall) {
    orn_hdl_wire_t wires[2];
    size_t count = 0;
    ASSERT_EQ(orn_hdl_instance_get_wires(session.GetInstance("U1"), wires, 2, &count), ORN_HDL_OK);
    ASSERT_EQ(count, 2U);
    EXPECT_EQ(ToString(wires[0].pin), "I");
    EXPECT_EQ(ToString(wires[0].signal), "D(2)");
    EXPECT_EQ(wires[0].direction, ORN_HDL_INPUT);
    EXPECT_EQ(ToString(wires[1].signal), "Y");
    EXPECT_EQ(orn_hdl_instance_get_wires(session.GetInstance("U1"), nullptr, 0, &count),
              ORN_HDL_OK);
    EXPECT_EQ(count, 2U);
    EXPECT_EQ(orn_hdl_instance_get_wires(session.GetInstance("U1"), nullptr, 1, &count),
              ORN_HDL_INVALID_ARGUMENT);
}

struct Visited {
    orn_hdl_model_t model;
    std::string text;
    int answer = 0;
};

int OnWire(void* user, const orn_hdl_text_t* instance, const orn_hdl_wire_t* wire) {
    Visited& visited = *static_cast<Visited*>(user);
    visited.text +=
        ToString(*instance) + "." + ToString(wire->pin) + "=" + ToString(wire->signal) + "\n";
    EXPECT_EQ(orn_hdl_model_add_component(visited.model, "NEW"), ORN_HDL_BUSY);
    return visited.answer;
}

TEST_F(CObjects, AreVisitedWithTheirWires) {
    Visited visited{session.model, "", 0};
    EXPECT_EQ(orn_hdl_model_visit_wires(session.model, &OnWire, &visited), ORN_HDL_OK);
    EXPECT_EQ(visited.text, "U1.I=D(2)\nU1.O=Y\nU2.A(3:0)=D(7:6),D(1:0)\n");
    visited.answer = 1;
    EXPECT_EQ(orn_hdl_model_visit_wires(session.model, &OnWire, &visited), ORN_HDL_STOPPED);
    EXPECT_EQ(orn_hdl_model_add_component(session.model, "NEW"), ORN_HDL_OK);
}

TEST_F(CObjects, HandlesOutliveAdditionsAndWrites) {
    const orn_hdl_object_t instance = session.GetInstance("U2");
    for (int i = 0; i < 1000; ++i) {
        EXPECT_EQ(
            orn_hdl_model_add_instance(session.model, ("X" + std::to_string(i)).c_str(), "INV"),
            ORN_HDL_OK);
    }
    CTests::TextOf(session.model, ORN_HDL_VHDL);
    EXPECT_EQ(orn_hdl_model_rename_instance(session.model, "U2", "V2"), ORN_HDL_OK);
    EXPECT_EQ(NameOf(instance), "V2");
}

TEST_F(CObjects, HandlesAreDeadOnceSomethingIsDestroyed) {
    const orn_hdl_object_t instance = session.GetInstance("U1");
    orn_hdl_object_t pin;
    ASSERT_EQ(orn_hdl_object_get_pin(instance, "I", &pin), ORN_HDL_OK);
    orn_hdl_cursor_t cursor;
    ASSERT_EQ(orn_hdl_object_walk(instance, ORN_HDL_PINS, &cursor), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_object_remove(instance), ORN_HDL_OK);
    orn_hdl_object_t object;
    orn_hdl_text_t text;
    EXPECT_EQ(orn_hdl_object_get_name(instance, &text), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_object_get_name(pin, &text), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_cursor_next(&cursor, &object), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_object_remove(instance), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(orn_hdl_model_get_instance(session.model, "U1", &object), ORN_HDL_NOT_FOUND);
    // Another one in the place of the first, which may have its address.
    session.Run("ADD INSTANCE INV U1\n");
    EXPECT_EQ(orn_hdl_object_get_name(instance, &text), ORN_HDL_DEAD_HANDLE);
}

TEST_F(CObjects, ABusThatIsWidenedIsAnotherOne) {
    session.Run("ADD COMPONENT WIDE\nADD PIN WIDE A(7:0) input\nADD INSTANCE WIDE U9\n"
                "CONNECT SIGNAL W(3:0) U2.A(3:0)\n");
    const orn_hdl_object_t narrow = session.GetSignal("W(3:0)");
    session.Run("CONNECT SIGNAL W(7:0) U9.A(7:0)\n");
    orn_hdl_text_t text;
    EXPECT_EQ(orn_hdl_object_get_name(narrow, &text), ORN_HDL_DEAD_HANDLE);
    EXPECT_EQ(KindOf(session.GetSignal("W(7:0)")), ORN_HDL_KIND_BUS);
}

TEST_F(CObjects, EveryKindIsRemoved) {
    orn_hdl_object_t object;
    ASSERT_EQ(orn_hdl_object_get_attribute(session.GetSignal("Y"), "LOC", &object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_object_remove(object), ORN_HDL_OK);
    EXPECT_EQ(Names(session.GetSignal("Y"), ORN_HDL_ATTRIBUTES), TextList());
    ASSERT_EQ(orn_hdl_object_get_pin(session.GetInstance("U1"), "O", &object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_object_remove(object), ORN_HDL_OK);
    EXPECT_EQ(Names(session.GetInstance("U1"), ORN_HDL_PINS), (TextList{"I"}));
    ASSERT_EQ(orn_hdl_model_get_component(session.model, "INV", &object), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_object_get_pin(object, "I", &object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_object_remove(object), ORN_HDL_OK);
    EXPECT_EQ(Names(session.GetInstance("U1"), ORN_HDL_PINS), TextList());
    EXPECT_EQ(orn_hdl_object_remove(session.GetSignal("D(7:0)")), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_part_get_bus(session.GetSignal("D(2)"), &object), ORN_HDL_NOT_FOUND);
    ASSERT_EQ(orn_hdl_model_get_component(session.model, "INV", &object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_object_remove(object), ORN_HDL_OK);
    EXPECT_EQ(orn_hdl_instance_get_component(session.GetInstance("U1"), &object),
              ORN_HDL_NOT_FOUND);
    EXPECT_EQ(orn_hdl_object_remove(GetNetlist()), ORN_HDL_WRONG_KIND);
}

TEST_F(CObjects, MemoryThatWasNeverSetIsNoHandle) {
    orn_hdl_object_t object = session.GetInstance("U1");
    object.place += 8;
    orn_hdl_text_t text;
    EXPECT_EQ(orn_hdl_object_get_name(object, &text), ORN_HDL_DEAD_HANDLE);
}

TEST_F(CObjects, TheBitOfABusIsMade) {
    orn_hdl_object_t bit;
    ASSERT_EQ(orn_hdl_model_bit(session.model, "D", 5, &bit), ORN_HDL_OK);
    EXPECT_EQ(NameOf(bit), "D(5)");
    EXPECT_EQ(orn_hdl_model_bit(session.model, "D", 8, &bit), ORN_HDL_FAILED);
    EXPECT_EQ(session.GetError(), "Signal \"D(8)\" not found.\n");
}

TEST_F(CObjects, DummySignalsAreFound) {
    session.Run("ADD INSTANCE INV U3\nCONNECT SIGNAL Y U3.I\nCONNECT SIGNAL N U3.O\n");
    CTests::TextOf(session.model, ORN_HDL_VHDL);
    orn_hdl_object_t dummy;
    ASSERT_EQ(orn_hdl_signal_get_dummy(session.GetSignal("Y"), &dummy), ORN_HDL_OK);
    EXPECT_EQ(NameOf(dummy), "Y_DUMMY");
    EXPECT_EQ(orn_hdl_signal_get_dummy(session.GetSignal("N"), &dummy), ORN_HDL_NOT_FOUND);
}

} // namespace
