#include "Orn_Hdl/Containers/PtrArray.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <climits>
#include <iterator>
#include <memory>
#include <new>
#include <ranges>
#include <type_traits>
#include <utility>
#include <vector>

namespace {

using Orn_Hdl::Iterator;
using Orn_Hdl::OwnPtrArray;
using Orn_Hdl::PtrArray;

using Array = PtrArray<int*>;

template <class T> std::vector<T> ElementsOf(const PtrArray<T>& array) {
    std::vector<T> elements;
    for (int i = 0; i < array.GetSize(); ++i) {
        elements.push_back(array.GetAt(i));
    }
    return elements;
}

TEST(PtrArray, StartsEmpty) {
    const Array array;
    EXPECT_EQ(array.GetSize(), 0);
    EXPECT_TRUE(array.IsEmpty());
    EXPECT_EQ(array.GetTail(), nullptr);
    EXPECT_EQ(array.GetAt(0), nullptr);
    EXPECT_EQ(array.GetAt(-1), nullptr);
    EXPECT_EQ(array.GetIndex(nullptr), -1);
}

TEST(PtrArray, AddGivesTheIndex) {
    int a = 0;
    int b = 0;
    Array array;
    EXPECT_EQ(array.Add(&a), 0);
    EXPECT_EQ(array.Add(&b), 1);
    EXPECT_EQ(array.Add(&a), 2);
    EXPECT_EQ(array.Add(nullptr), 3);
    EXPECT_EQ(array.GetTail(), nullptr);
    EXPECT_EQ(array.GetIndex(&a), 0);
    EXPECT_EQ(array.GetIndex(&b), 1);
    EXPECT_EQ(array.GetIndex(nullptr), 3);
    EXPECT_TRUE(array.Contains(&b));
    EXPECT_FALSE(array.IsEmpty());
}

TEST(PtrArray, ReadsOutOfRangeGiveNull) {
    int a = 0;
    Array array;
    array.Add(&a);
    for (const int i : {-1, INT_MIN, 1, 2, INT_MAX}) {
        EXPECT_EQ(array.GetAt(i), nullptr) << i;
    }
}

TEST(PtrArray, SetAtPastTheEndFillsWithNulls) {
    int a = 0;
    Array array;
    array.SetAt(3, &a);
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{nullptr, nullptr, nullptr, &a}));
    array.SetAt(1, &a);
    array.SetAt(4, &a);
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{nullptr, &a, nullptr, &a, &a}));
    array.SetAt(-1, &a);
    array.SetAt(INT_MIN, &a);
    EXPECT_EQ(array.GetSize(), 5);
}

TEST(PtrArray, TheLargestIndexIsBeyondEveryArray) {
    int a = 0;
    Array array;
    array.Add(&a);
    EXPECT_THROW(array.SetAt(INT_MAX, &a), std::bad_alloc);
    EXPECT_EQ(ElementsOf(array), std::vector<int*>{&a});
}

TEST(PtrArray, SetAtFillsWithNullsWhatElementsHeldBefore) {
    int a = 0;
    Array array;
    for (int i = 0; i < 8; ++i) {
        array.Add(&a);
    }
    array.Empty();
    array.SetAt(5, &a);
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(array.GetAt(i), nullptr) << i;
    }
}

TEST(PtrArray, RemoveTakesTheFirstOccurrenceOnly) {
    int a = 0;
    int b = 0;
    int c = 0;
    Array array;
    for (int* p : {&b, &a, &c, &a}) {
        array.Add(p);
    }
    EXPECT_TRUE(array.Remove(&a));
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&b, &c, &a}));
    EXPECT_TRUE(array.Remove(&a));
    EXPECT_FALSE(array.Remove(&a));
    EXPECT_FALSE(array.Remove(nullptr));
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&b, &c}));
}

TEST(PtrArray, RemovesByIndex) {
    int a = 0;
    int b = 0;
    Array array;
    array.Add(&a);
    array.Add(&b);
    array.RemoveAt(-1);
    array.RemoveAt(2);
    EXPECT_EQ(array.GetSize(), 2);
    array.RemoveAt(0);
    EXPECT_EQ(ElementsOf(array), std::vector<int*>{&b});
    array.RemoveAt(0);
    EXPECT_TRUE(array.IsEmpty());
}

TEST(PtrArray, RemoveTailOfAnEmptyArrayIsHarmless) {
    int a = 0;
    Array array;
    array.RemoveTail();
    array.Add(&a);
    array.RemoveTail();
    array.RemoveTail();
    EXPECT_EQ(array.GetSize(), 0);
}

TEST(PtrArray, SwapOutOfRangeOrWithItselfChangesNothing) {
    int a = 0;
    int b = 0;
    Array array;
    array.Add(&a);
    array.Add(&b);
    for (const auto& [i, j] : std::vector<std::pair<int, int>>{
             {0, 0}, {1, 1}, {0, 2}, {2, 0}, {-1, 1}, {1, -1}, {5, 6}, {INT_MIN, INT_MAX}}) {
        array.Swap(i, j);
        EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&a, &b})) << i << " and " << j;
    }
    array.Swap(0, 1);
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&b, &a}));
    Array empty;
    empty.Swap(0, 0);
    EXPECT_TRUE(empty.IsEmpty());
}

TEST(PtrArrayBase, IsAnArrayOfUntypedPointers) {
    int values[4] = {0, 1, 2, 3};
    Orn_Hdl::PtrArrayBase array;
    EXPECT_EQ(array.GetAt(0), nullptr);
    EXPECT_EQ(array.GetTail(), nullptr);
    EXPECT_FALSE(array.Contains(nullptr));
    EXPECT_EQ(array.Add(&values[2]), 0);
    array.SetAt(2, &values[0]);
    EXPECT_TRUE(array.Contains(nullptr));
    array.SetAt(1, &values[1]);
    array.InsertAt(0, &values[3]);
    EXPECT_EQ(array.GetIndex(&values[1]), 2);
    EXPECT_EQ(array.GetIndex(&array), -1);
    EXPECT_TRUE(array.Contains(&values[3]));
    EXPECT_FALSE(array.Contains(nullptr));
    int calls = 0;
    array.Sort(
        [](void* a, void* b, void* context) {
            ++*static_cast<int*>(context);
            return *static_cast<int*>(a) < *static_cast<int*>(b);
        },
        &calls);
    EXPECT_GT(calls, 0);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(array.GetAt(i), &values[i]);
    }
    EXPECT_TRUE(array.Remove(&values[1]));
    EXPECT_FALSE(array.Remove(&values[1]));
    array.RemoveAt(0);
    EXPECT_EQ(array.GetSize(), 2);
    EXPECT_EQ(array.GetAt(0), &values[2]);
    EXPECT_EQ(array.GetTail(), &values[3]);
}

TEST(PtrArray, CopiesHoldTheSamePointers) {
    int a = 0;
    int b = 0;
    Array array;
    array.Add(&a);
    Array copy(array);
    copy.Add(&b);
    EXPECT_EQ(ElementsOf(array), std::vector<int*>{&a});
    array = copy;
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&a, &b}));
    Array& same = array;
    array = same;
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&a, &b}));
    array = Array();
    EXPECT_TRUE(array.IsEmpty());
    EXPECT_EQ(ElementsOf(copy), (std::vector<int*>{&a, &b}));
}

bool IsLess(int* a, int* b, void* context) {
    ++*static_cast<int*>(context);
    return *a / 10 < *b / 10;
}

RC_GTEST_PROP(PtrArray, SortsStablyWithTheCallersOrder, ()) {
    auto values =
        *rc::gen::scale(5.0, rc::gen::container<std::vector<int>>(rc::gen::inRange(0, 100)));
    Array array;
    std::vector<int*> expected;
    for (int& value : values) {
        array.Add(&value);
        expected.push_back(&value);
    }
    std::stable_sort(expected.begin(), expected.end(),
                     [](int* a, int* b) { return *a / 10 < *b / 10; });
    int calls = 0;
    array.Sort(&IsLess, &calls);
    RC_ASSERT(ElementsOf(array) == expected);
    RC_ASSERT(values.size() < 2 || calls > 0);
}

RC_GTEST_PROP(PtrArray, BehavesAsAVector, (std::vector<std::pair<int, int>> calls)) {
    std::vector<int> values(8);
    Array array;
    std::vector<int*> expected;
    for (const auto& [call, raw] : calls) {
        const int index = raw % 12;
        int* p = &values[static_cast<unsigned>(raw) % 8];
        switch (static_cast<unsigned>(call) % 7) {
        case 0:
        case 1:
            array.Add(p);
            expected.push_back(p);
            break;
        case 2:
            array.SetAt(index, p);
            if (index >= 0) {
                const auto slot = static_cast<std::size_t>(index);
                expected.resize(std::max(expected.size(), slot + 1));
                expected[slot] = p;
            }
            break;
        case 3: {
            const auto found = std::find(expected.begin(), expected.end(), p);
            RC_ASSERT(array.Remove(p) == (found != expected.end()));
            if (found != expected.end()) {
                expected.erase(found);
            }
            break;
        }
        case 4:
            array.RemoveTail();
            if (!expected.empty()) {
                expected.pop_back();
            }
            break;
        case 5: {
            Array copy(array);
            array.Empty();
            RC_ASSERT(array.IsEmpty());
            array = copy;
            break;
        }
        default:
            array.Reserve(index);
            break;
        }
        RC_ASSERT(ElementsOf(array) == expected);
    }
}

/// Writes its number on a list when it ends.
class Mortal {
public:
    Mortal(int number, std::vector<int>& ended) : number_(number), ended_(ended) {}
    Mortal(const Mortal&) = delete;
    Mortal& operator=(const Mortal&) = delete;
    virtual ~Mortal() { ended_.push_back(number_); }

private:
    int number_;
    std::vector<int>& ended_;
};

class Heir : public Mortal {
public:
    using Mortal::Mortal;

private:
    std::vector<int> memory_ = std::vector<int>(100);
};

using Owner = OwnPtrArray<Mortal*>;

TEST(OwnPtrArray, DeletesItsElementsLastFirst) {
    std::vector<int> ended;
    {
        Owner owner;
        for (int i = 1; i <= 4; ++i) {
            owner.Add(new Heir(i, ended));
        }
    }
    EXPECT_EQ(ended, (std::vector<int>{4, 3, 2, 1}));
}

TEST(OwnPtrArray, SkipsNullsWhenItDeletes) {
    std::vector<int> ended;
    {
        Owner owner;
        owner.SetAt(3, new Heir(1, ended));
        EXPECT_EQ(owner.GetSize(), 4);
        EXPECT_EQ(owner.GetAt(0), nullptr);
        owner.Add(nullptr);
        owner.Add(nullptr);
    }
    EXPECT_EQ(ended, std::vector<int>{1});
}

TEST(OwnPtrArray, OnlyItsDestructorDeletes) {
    std::vector<int> ended;
    const auto a = std::make_unique<Heir>(1, ended);
    const auto b = std::make_unique<Heir>(2, ended);
    const auto c = std::make_unique<Heir>(3, ended);
    const auto d = std::make_unique<Heir>(4, ended);
    {
        Owner owner;
        for (Mortal* mortal : {a.get(), b.get(), c.get(), d.get()}) {
            owner.Add(mortal);
        }
        EXPECT_TRUE(owner.Remove(b.get()));
        owner.RemoveTail();
        owner.SetAt(0, nullptr);
        owner.RemoveAt(1);
        owner.Add(d.get());
        owner.Empty();
    }
    EXPECT_TRUE(ended.empty());
}

TEST(OwnPtrArray, IgnoresAPointerThatItHolds) {
    std::vector<int> ended;
    {
        Owner owner;
        Mortal* first = new Heir(1, ended);
        Mortal* second = new Heir(2, ended);
        EXPECT_EQ(owner.Add(first), 0);
        EXPECT_EQ(owner.Add(second), 1);
        EXPECT_EQ(owner.Add(first), 0);
        owner.SetAt(1, second);
        owner.SetAt(1, first);
        owner.SetAt(7, first);
        EXPECT_EQ(owner.GetIndex(first), 0);
        EXPECT_EQ(owner.GetAt(1), second);
    }
    EXPECT_EQ(ended.size(), 2u);
}

TEST(OwnPtrArray, InsertsAPointerOnlyOnce) {
    std::vector<int> ended;
    {
        Owner owner;
        Mortal* first = new Heir(1, ended);
        Mortal* second = new Heir(2, ended);
        Mortal* third = new Heir(3, ended);
        owner.InsertAt(0, third);
        owner.InsertAt(0, first);
        owner.InsertAt(1, second);
        for (int i = -1; i < 5; ++i) {
            owner.InsertAt(i, first);
            owner.InsertAt(i, third);
        }
        EXPECT_EQ(ElementsOf(owner), (std::vector<Mortal*>{first, second, third}));
        owner.InsertAt(1, nullptr);
        owner.InsertAt(1, nullptr);
        EXPECT_EQ(owner.GetSize(), 5) << "nulls are owned by nobody";
        // What it has let go of is new to it again.
        owner.RemoveAt(0);
        owner.InsertAt(4, first);
        EXPECT_EQ(ElementsOf(owner),
                  (std::vector<Mortal*>{nullptr, nullptr, second, third, first}));
        owner.SetAt(2, nullptr);
        owner.SetAt(0, second);
        EXPECT_EQ(ElementsOf(owner),
                  (std::vector<Mortal*>{second, nullptr, nullptr, third, first}));
    }
    EXPECT_EQ(ended, (std::vector<int>{1, 3, 2}));
}

TEST(OwnPtrArray, DeletesAllOnRequest) {
    std::vector<int> ended;
    Owner owner;
    owner.Add(new Heir(1, ended));
    owner.Add(nullptr);
    owner.Add(new Heir(2, ended));
    owner.DeleteAll();
    EXPECT_EQ(ended, (std::vector<int>{2, 1}));
    EXPECT_TRUE(owner.IsEmpty());
    owner.Add(new Heir(3, ended));
    EXPECT_EQ(owner.GetSize(), 1);
}

TEST(OwnPtrArray, IgnoresAPointerThatItHoldsByWhateverReferenceItIsCalled) {
    std::vector<int> ended;
    {
        Owner owner;
        PtrArray<Mortal*>& typed = owner;
        Orn_Hdl::PtrArrayBase& untyped = owner;
        Mortal* first = new Heir(1, ended);
        Mortal* second = new Heir(2, ended);
        EXPECT_EQ(typed.Add(first), 0);
        EXPECT_EQ(untyped.Add(second), 1);
        EXPECT_EQ(typed.Add(first), 0);
        EXPECT_EQ(untyped.Add(second), 1);
        for (int i = -1; i < 4; ++i) {
            typed.SetAt(i, first);
            untyped.SetAt(i, second);
            typed.InsertAt(i, first);
            untyped.InsertAt(i, second);
        }
        EXPECT_EQ(ElementsOf(owner), (std::vector<Mortal*>{first, second}));
        EXPECT_EQ(typed.Add(nullptr), 2);
        EXPECT_EQ(untyped.Add(nullptr), 3);
    }
    EXPECT_EQ(ended, (std::vector<int>{2, 1}));
}

TEST(OwnPtrArray, AssignedByAReferenceTakesEachPointerOnce) {
    std::vector<int> ended;
    const auto former = std::make_unique<Heir>(3, ended);
    {
        Owner owner;
        Owner other;
        other.Add(new Heir(2, ended));
        owner.Add(former.get());
        PtrArray<Mortal*>& typed = owner;
        typed = other;
        EXPECT_EQ(ElementsOf(owner), std::vector<Mortal*>{former.get()}) << "what has an owner";
        PtrArray<Mortal*> plain;
        Mortal* first = new Heir(1, ended);
        plain.Add(first);
        plain.Add(nullptr);
        plain.Add(first);
        typed = plain;
        EXPECT_EQ(ElementsOf(owner), (std::vector<Mortal*>{first, nullptr}));
        plain = owner;
        EXPECT_EQ(plain.Add(first), 2) << "a plain array stays one";
        PtrArray<Mortal*> copy = owner;
        EXPECT_EQ(copy.Add(first), 2);
    }
    EXPECT_EQ(ended, (std::vector<int>{2, 1}));
}

/// What a predicate does at its first call, and later calls.
struct Troublemaker {
    Array* array = nullptr;
    int calls = 0;
    int throwingCall = 0;
    void (*change)(Array& array) = nullptr;
    unsigned random = 1;
};

bool MakesTrouble(int* a, int* b, void* context) {
    auto& maker = *static_cast<Troublemaker*>(context);
    if (++maker.calls == maker.throwingCall) {
        throw std::bad_alloc();
    }
    if (maker.calls == 1 && maker.change != nullptr) {
        maker.change(*maker.array);
    }
    return *a < *b;
}

TEST(PtrArray, AnExceptionOfThePredicateLeavesItAsItWas) {
    int values[9] = {5, 3, 8, 1, 9, 2, 7, 4, 6};
    Array array;
    for (int& value : values) {
        array.Add(&value);
    }
    const auto before = ElementsOf(array);
    Troublemaker maker;
    for (maker.throwingCall = 1;; ++maker.throwingCall) {
        maker.calls = 0;
        try {
            array.Sort(&MakesTrouble, &maker);
            break;
        } catch (const std::bad_alloc&) {
            ASSERT_EQ(ElementsOf(array), before);
        }
    }
    EXPECT_GT(maker.throwingCall, 9);
    EXPECT_NE(ElementsOf(array), before);
}

TEST(PtrArray, APredicateThatIsNoOrderLosesNothing) {
    std::vector<int> values(300);
    const auto always = [](int*, int*, void*) { return true; };
    const auto never = [](int*, int*, void*) { return false; };
    const auto atRandom = [](int*, int*, void* context) {
        auto& random = static_cast<Troublemaker*>(context)->random;
        random = random * 1664525 + 1013904223;
        return (random >> 16) % 2 == 0;
    };
    Troublemaker maker;
    for (bool (*less)(int*, int*, void*) : {+always, +never, +atRandom, +atRandom, +atRandom}) {
        Array array;
        std::vector<int*> expected;
        for (int& value : values) {
            array.Add(&value);
            expected.push_back(&value);
        }
        array.Sort(less, &maker);
        auto sorted = ElementsOf(array);
        std::sort(sorted.begin(), sorted.end());
        EXPECT_EQ(sorted, expected);
    }
}

TEST(PtrArray, APredicateMayChangeIt) {
    static int value = 10;
    const auto empty = [](Array& array) { array.Empty(); };
    const auto assign = [](Array& array) { array = Array(); };
    const auto shrink = [](Array& array) { array.RemoveAt(0); };
    const auto swap = [](Array& array) { array.Swap(0, 1); };
    const auto grow = [](Array& array) {
        for (int i = 0; i < 1000; ++i) {
            array.Add(&value);
        }
    };
    int values[5] = {5, 3, 4, 1, 2};
    for (void (*change)(Array&) : {+empty, +assign, +shrink, +swap, +grow}) {
        Array array;
        for (int& element : values) {
            array.Add(&element);
        }
        Array expected = array;
        change(expected);
        Troublemaker maker;
        maker.array = &array;
        maker.change = change;
        array.Sort(&MakesTrouble, &maker);
        EXPECT_EQ(ElementsOf(array), ElementsOf(expected));
    }
}

TEST(PtrArray, ANullPredicateChangesNothing) {
    int values[2] = {2, 1};
    Array array;
    array.Add(&values[0]);
    array.Add(&values[1]);
    array.Sort(nullptr, nullptr);
    static_cast<Orn_Hdl::PtrArrayBase&>(array).Sort(nullptr, nullptr);
    EXPECT_EQ(ElementsOf(array), (std::vector<int*>{&values[0], &values[1]}));
}

/// Makes its array on first use.
struct LateOwner {
    std::unique_ptr<Array> array;

    Iterator<int*> GetIterator() const {
        return Iterator<int*>(this, [](const void* owner) -> const Array* {
            return static_cast<const LateOwner*>(owner)->array.get();
        });
    }
};

TEST(Iterator, SeesAnArrayThatItsOwnerMakesLater) {
    int a = 0;
    int b = 0;
    LateOwner owner;
    Iterator<int*> at = owner.GetIterator();
    const Iterator<int*> start = at;
    auto cursor = at.begin();
    EXPECT_TRUE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), nullptr);
    EXPECT_EQ(cursor, at.end());
    EXPECT_EQ(*cursor, nullptr);
    owner.array = std::make_unique<Array>();
    owner.array->Add(&a);
    EXPECT_FALSE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), &a);
    EXPECT_NE(cursor, at.end());
    EXPECT_EQ(*cursor, &a);
    at.Next();
    EXPECT_TRUE(at.IsAtEnd());
    owner.array = std::make_unique<Array>();
    owner.array->Add(&b);
    owner.array->Add(&a);
    EXPECT_EQ(at.GetCurrent(), &a);
    EXPECT_EQ(std::vector<int*>(start.begin(), start.end()), (std::vector<int*>{&b, &a}));
    owner.array.reset();
    EXPECT_TRUE(at.IsAtEnd());
}

static_assert(std::forward_iterator<Iterator<int*>::Cursor>);
static_assert(std::ranges::forward_range<Iterator<int*>>);
static_assert(std::ranges::common_range<const Iterator<int*>>);
static_assert(std::ranges::viewable_range<Iterator<int*>>);

TEST(Iterator, WorksInAlgorithmsAndRanges) {
    int values[4] = {3, 1, 4, 1};
    Array array;
    for (int& value : values) {
        array.Add(&value);
    }
    const Iterator<int*> list(&array);
    const auto isOne = [](const int* value) { return *value == 1; };
    EXPECT_EQ(std::count_if(list.begin(), list.end(), isOne), 2);
    EXPECT_EQ(std::ranges::count_if(list, isOne), 2);
    EXPECT_EQ(*std::ranges::find_if(list, isOne), &values[1]);
    EXPECT_EQ(std::ranges::max(list, {}, [](const int* value) { return *value; }), &values[2]);
#if !defined(__clang__) || __clang_major__ >= 16
    // Earlier versions of Clang cannot compile the views of GCC's library.
    std::vector<int> ones;
    for (const int* value : Iterator<int*>(&array) | std::views::filter(isOne)) {
        ones.push_back(*value);
    }
    EXPECT_EQ(ones, (std::vector<int>{1, 1}));
#endif
    auto cursor = list.begin();
    EXPECT_EQ(*cursor++, &values[0]);
    EXPECT_EQ(*cursor, &values[1]);
    EXPECT_NE(cursor, list.begin());
    EXPECT_EQ(cursor, std::next(list.begin()));
    EXPECT_EQ(std::distance(cursor, list.end()), 3);
}

TEST(OwnPtrArray, CannotBeCopied) {
    EXPECT_FALSE(std::is_copy_constructible_v<Owner>);
    EXPECT_FALSE(std::is_copy_assignable_v<Owner>);
    EXPECT_TRUE(std::is_copy_constructible_v<Array>);
}

TEST(Iterator, OverNoArrayYieldsNothing) {
    for (Iterator<int*> iterator : {Iterator<int*>(), Iterator<int*>(nullptr)}) {
        EXPECT_TRUE(iterator.IsAtEnd());
        EXPECT_EQ(iterator.GetCurrent(), nullptr);
        iterator.Next();
        EXPECT_TRUE(iterator.IsAtEnd());
        for ([[maybe_unused]] int* element : iterator) {
            ADD_FAILURE() << "it yields something";
        }
    }
}

TEST(Iterator, YieldsStoredNullsLikeAnyElement) {
    int a = 0;
    Array array;
    array.SetAt(2, &a);
    array.Add(nullptr);
    std::vector<int*> seen;
    for (int* element : Iterator<int*>(&array)) {
        seen.push_back(element);
    }
    EXPECT_EQ(seen, (std::vector<int*>{nullptr, nullptr, &a, nullptr}));
    seen.clear();
    for (Iterator<int*> at(&array); !at.IsAtEnd(); at.Next()) {
        seen.push_back(at.GetCurrent());
    }
    EXPECT_EQ(seen, (std::vector<int*>{nullptr, nullptr, &a, nullptr}));
}

TEST(Iterator, ReadsTheSizeAfreshAtEachStep) {
    int a = 0;
    Array array;
    array.Add(&a);
    int steps = 0;
    for ([[maybe_unused]] int* element : Iterator<int*>(&array)) {
        if (++steps < 1000) {
            array.Add(&a);
        }
    }
    EXPECT_EQ(steps, 1000);

    Iterator<int*> at(&array);
    at.Next();
    array.Empty();
    EXPECT_TRUE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), nullptr);
    at.Next();
    array.Add(&a);
    array.Add(&a);
    EXPECT_FALSE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), &a);
}

TEST(Iterator, CopiesGoOnFromWhereTheyAre) {
    int a = 0;
    int b = 0;
    Array array;
    array.Add(&a);
    array.Add(&b);
    Iterator<int*> at(&array);
    at.Next();
    Iterator<int*> copy(at);
    EXPECT_EQ(copy.GetCurrent(), &b);
    at.Next();
    EXPECT_FALSE(copy.IsAtEnd());
    copy = Iterator<int*>(&array);
    EXPECT_EQ(copy.GetCurrent(), &a);
    std::vector<int*> rest;
    copy.Next();
    for (int* element : copy) {
        rest.push_back(element);
    }
    EXPECT_EQ(rest, std::vector<int*>{&b});
    EXPECT_EQ(copy.GetCurrent(), &b) << "a loop over it does not move it";
}

/// Elements are put to and taken from any place of a large array, mostly its ends.
RC_GTEST_PROP(PtrArray, LargeArraysKeepTheirOrder, ()) {
    int things[4];
    std::vector<int*> expected;
    PtrArray<int*> array;
    const int start = *rc::gen::inRange(0, 1300);
    for (int i = 0; i < start; ++i) {
        array.Add(&things[i % 4]);
        expected.push_back(&things[i % 4]);
    }
    const int rounds = *rc::gen::inRange(1, 30);
    for (int round = 0; round < rounds; ++round) {
        const int operation = *rc::gen::inRange(0, 4);
        const int place = *rc::gen::inRange(0, 4) == 0 ? *rc::gen::inRange(0, 1500) : 0;
        const int times = *rc::gen::inRange(1, 300);
        for (int i = 0; i < times; ++i) {
            int* const thing = &things[(round + i) % 4];
            const int size = array.GetSize();
            if (operation == 0) {
                array.Add(thing);
                expected.push_back(thing);
            } else if (operation == 1 && place < size) {
                array.RemoveAt(place);
                expected.erase(expected.begin() + place);
            } else if (operation == 2 && place <= size) {
                array.InsertAt(place, thing);
                expected.insert(expected.begin() + place, thing);
            } else if (operation == 3 && i == 0) {
                array.Reserve(size + place);
            }
        }
    }
    RC_ASSERT(array.GetSize() == static_cast<int>(expected.size()));
    for (int i = 0; i < array.GetSize(); ++i) {
        RC_ASSERT(array.GetAt(i) == expected[static_cast<std::size_t>(i)]);
    }
}

} // namespace
