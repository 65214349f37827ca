// The lists of a netlist's objects under removal in any order: what they hold, and its order.
#include "HdlModel/Netlist/ObjectList.h"

#include "Orn_Hdl/Model.h"
#include "Support/Names.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Names;
using Support::NamesOf;

using List = ObjectList<Object>;
using Objects = std::vector<Object*>;

std::unique_ptr<Object> MakeObject(std::size_t number) {
    return std::make_unique<Instance>(std::to_string(number).c_str(), nullptr);
}

Objects ElementsOf(const List& list) {
    const Iterator<Object*> objects = list.GetIterator();
    return {objects.begin(), objects.end()};
}

/// The same walk without range-based loops.
Objects StepsOf(const List& list) {
    Objects objects;
    for (Iterator<Object*> at = list.GetIterator(); !at.IsAtEnd(); at.Next()) {
        objects.push_back(at.GetCurrent());
    }
    return objects;
}

/// Takes an object out and destroys it.
void Drop(List& list, Objects& expected, std::size_t which) {
    Object* const object = expected[which];
    const int place = list.Find(object);
    ASSERT_GE(place, 0);
    list.TakeOut(place);
    expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(which));
    EXPECT_EQ(list.Find(object), -1);
    delete object;
}

void Append(List& list, Objects& expected, std::size_t number) {
    expected.push_back(MakeObject(number).release());
    list.Add(expected.back());
}

/// Large enough for a table of places, which the searches of some hundred removals cause.
constexpr std::size_t Large = 3000;

struct LargeList {
    List list;
    Objects expected;

    LargeList() {
        for (std::size_t number = 0; number < Large; ++number) {
            Append(list, expected, number);
        }
    }
};

TEST(ObjectList, KeepsItsOrderWhateverIsTakenOutAndAdded) {
    LargeList large;
    std::mt19937 random(1);
    for (std::size_t step = 0; step < 4 * Large; ++step) {
        // At first the list shrinks to a third, then it keeps its size.
        if (step > Large && step % 2 == 0) {
            Append(large.list, large.expected, step);
        } else if (large.expected.size() > Large / 3 || step > Large) {
            Drop(large.list, large.expected, random() % large.expected.size());
        }
        if (step % 100 == 0) {
            ASSERT_EQ(ElementsOf(large.list), large.expected) << step;
            ASSERT_EQ(StepsOf(large.list), large.expected) << step;
        }
    }
    EXPECT_EQ(ElementsOf(large.list), large.expected);
}

TEST(ObjectList, IsSortedWithoutHoles) {
    LargeList large;
    std::mt19937 random(2);
    for (std::size_t count = 0; count < Large / 2; ++count) {
        Drop(large.list, large.expected, random() % large.expected.size());
    }
    large.list.SortBy([&](PtrArray<Object*>& objects) {
        ASSERT_EQ(objects.GetSize(), static_cast<int>(large.expected.size()));
        for (int i = 0, j = objects.GetSize() - 1; i < j; ++i, --j) {
            objects.Swap(i, j);
        }
    });
    std::reverse(large.expected.begin(), large.expected.end());
    EXPECT_EQ(ElementsOf(large.list), large.expected);
    while (!large.expected.empty()) {
        Drop(large.list, large.expected, random() % large.expected.size());
    }
    EXPECT_TRUE(large.list.GetIterator().IsAtEnd());
    EXPECT_EQ(large.list.TakeOutLast(), nullptr);
}

TEST(ObjectList, FindsNothingThatItDoesNotHold) {
    LargeList large;
    const std::unique_ptr<Object> other = MakeObject(0);
    for (int count = 0; count < 200; ++count) {
        ASSERT_EQ(large.list.Find(other.get()), -1);
    }
    EXPECT_EQ(large.list.Find(large.expected[Large / 2]), static_cast<int>(Large / 2));
    EXPECT_EQ(List().Find(other.get()), -1);
}

TEST(ObjectList, GivesItsObjectsUpFromTheLastOn) {
    LargeList large;
    std::mt19937 random(3);
    for (std::size_t count = 0; count < Large / 2; ++count) {
        Drop(large.list, large.expected, random() % large.expected.size());
    }
    while (Object* const last = large.list.TakeOutLast()) {
        ASSERT_EQ(last, large.expected.back());
        large.expected.pop_back();
        delete last;
    }
    EXPECT_TRUE(large.expected.empty());
}

/// A list of any size, down to the smallest, with the same effect as on a plain array.
RC_GTEST_PROP(ObjectList, BehavesLikeAnArray, ()) {
    List list;
    Objects expected;
    const auto steps = *rc::gen::container<std::vector<unsigned>>(rc::gen::arbitrary<unsigned>());
    for (std::size_t number = 0; number < steps.size(); ++number) {
        if (steps[number] % 3 == 0 || expected.empty()) {
            Append(list, expected, number);
        } else {
            Drop(list, expected, steps[number] % expected.size());
        }
        RC_ASSERT(ElementsOf(list) == expected);
        RC_ASSERT(StepsOf(list) == expected);
    }
}

struct Netlists {
    Netlist netlist;

    explicit Netlists(int count) {
        for (int i = 0; i < count; ++i) {
            netlist.Add(new Instance(std::to_string(i).c_str(), nullptr));
        }
    }
};

Names Numbers(int first, int count, int step) {
    Names names;
    for (int i = first; i < count; i += step) {
        names.push_back(std::to_string(i));
    }
    return names;
}

/// Of lists of every length, a walk that removes the present element goes on with the next one.
TEST(NetlistWalk, GoesOnWithTheNextElementWhenThePresentOneIsRemoved) {
    for (const int count : {1, 2, 3, 10, 1000}) {
        Netlists lists(count);
        Iterator<Instance*> at = lists.netlist.GetInstanceIterator();
        Names met;
        for (int i = 0; !at.IsAtEnd(); ++i) {
            Instance* const instance = at.GetCurrent();
            met.emplace_back(instance->GetNameView());
            if (i % 3 == 0) {
                at.Next();
            } else {
                lists.netlist.Remove(instance);
            }
        }
        EXPECT_EQ(met, Numbers(0, count, 1));
        EXPECT_EQ(NamesOf(lists.netlist.GetInstanceIterator()), Numbers(0, count, 3));
    }
}

TEST(NetlistWalk, EndsWhenAllThatIsLeftIsRemoved) {
    Netlists lists(5);
    Iterator<Instance*> at = lists.netlist.GetInstanceIterator();
    at.Next();
    const auto cursor = at.begin();
    for (const char* name : {"3", "4", "2", "1"}) {
        lists.netlist.Remove(lists.netlist.GetInstance(name));
    }
    EXPECT_TRUE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), nullptr);
    EXPECT_EQ(*cursor, nullptr);
    EXPECT_TRUE(cursor == at.end());
    at.Next();
    lists.netlist.Remove(lists.netlist.GetInstance("0"));
    EXPECT_TRUE(lists.netlist.GetInstanceIterator().IsAtEnd());
    lists.netlist.Add(new Instance("5", nullptr));
    EXPECT_EQ(NamesOf(lists.netlist.GetInstanceIterator()), Names{"5"});
}

TEST(NetlistWalk, PositionsBeforeAndAtAnElementAreEqualOnceNothingIsBetweenThem) {
    Netlists lists(4);
    const Iterator<Instance*> instances = lists.netlist.GetInstanceIterator();
    auto second = instances.begin();
    ++second;
    auto third = second;
    ++third;
    EXPECT_FALSE(second == third);
    lists.netlist.Remove(*second);
    EXPECT_TRUE(second == third);
    EXPECT_EQ((*second)->GetNameView(), "2");
    EXPECT_EQ((*++second)->GetNameView(), "3");
}

} // namespace
