// Whichever allocation of a whole run, or of making one object, fails: what comes out is
// std::bad_alloc or a message, nothing leaks, and the engine can be used on and ends.
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/Sanitized.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <memory>
#include <new>
#include <string>
#include <sys/mman.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace {

/// How many allocations succeed before one fails; below zero none fails (any more).
std::atomic<long> allowed{-1};
/// Blocks taken and not given back yet.
std::atomic<long> alive{0};

/// Whether the present allocation is the one that fails. Only one fails.
bool Fails() noexcept {
    return allowed.load() >= 0 && allowed.fetch_sub(1) == 0;
}

void* Allocate(std::size_t size, std::size_t alignment) {
    if (Fails()) {
        throw std::bad_alloc();
    }
    const std::size_t rounded = (size + alignment - 1) / alignment * alignment;
    void* const memory = std::aligned_alloc(alignment, rounded == 0 ? alignment : rounded);
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    ++alive;
    return memory;
}

void Release(void* memory) noexcept {
    if (memory != nullptr) {
        --alive;
        std::free(memory);
    }
}

constexpr std::size_t Usual = alignof(std::max_align_t);

} // namespace

void* operator new(std::size_t size) {
    return Allocate(size, Usual);
}
void* operator new[](std::size_t size) {
    return Allocate(size, Usual);
}
void* operator new(std::size_t size, std::align_val_t alignment) {
    return Allocate(size, static_cast<std::size_t>(alignment));
}
void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    try {
        return Allocate(size, Usual);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}
void operator delete(void* memory) noexcept {
    Release(memory);
}
void operator delete(void* memory, const std::nothrow_t&) noexcept {
    Release(memory);
}
void operator delete[](void* memory) noexcept {
    Release(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
    Release(memory);
}
void operator delete[](void* memory, std::size_t) noexcept {
    Release(memory);
}
void operator delete(void* memory, std::align_val_t) noexcept {
    Release(memory);
}
void operator delete(void* memory, std::size_t, std::align_val_t) noexcept {
    Release(memory);
}

#if !defined(ORN_HDL_SANITIZED)
// The library's other two ways to memory; the sanitizers keep these for themselves.
extern "C" void* __libc_realloc(void* memory, std::size_t size);

extern "C" void* realloc(void* memory, std::size_t size) noexcept {
    if (Fails()) {
        errno = ENOMEM;
        return nullptr;
    }
    return __libc_realloc(memory, size);
}

extern "C" void* mmap(void* address, std::size_t size, int protection, int flags, int file,
                      off_t offset) noexcept {
    if (Fails()) {
        errno = ENOMEM;
        return MAP_FAILED;
    }
    return reinterpret_cast<void*>(
        syscall(SYS_mmap, address, size, protection, flags, file, offset));
}
#endif

namespace {

const std::vector<std::string> Lines = Support::SplitLines(Robustness::MidSizedDesign());

/// Carries out what it can of the design, and writes it in both languages.
void BuildAndWrite(Orn_Hdl::Model& model, const std::string& file) {
    std::vector<std::string> lines = Lines;
    lines.push_back("WRITE VERILOG " + file);
    lines.push_back("WRITE VHDL " + file);
    for (const std::string& line : lines) {
        try {
            model.ExecuteLine(line);
        } catch (const Orn_Hdl::Exception&) {
            // What failed before may be missed now.
        }
    }
}

/// Builds and writes the design in an engine of its own, and once more when an allocation fails.
/// \return whether one failed.
bool RunOnce(const std::string& file, long allocations) {
    allowed = allocations;
    bool failed = false;
    try {
        Orn_Hdl::Engine engine;
        engine.CreateAndAddModel("top", "");
        Orn_Hdl::Model& model = *engine.GetModel("top");
        try {
            BuildAndWrite(model, file);
        } catch (const std::bad_alloc&) {
            failed = true;
            BuildAndWrite(model, file);
        }
    } catch (const std::bad_alloc&) {
        failed = true;
    }
    allowed = -1;
    return failed;
}

/// Carries out an action again and again, its first allocation failing, then its second, and so on,
/// until none is left that could fail.
template <class Action> void FailInTurn(const Action& action) {
    bool failed = true;
    for (long count = 0; failed; ++count) {
        const long before = alive;
        allowed = count;
        try {
            action();
            failed = false;
        } catch (const std::bad_alloc&) {
            // Whatever it left behind is counted below.
        }
        allowed = -1;
        ASSERT_EQ(alive, before) << "allocation " << count << " failed, and something leaked";
        ASSERT_TRUE(failed || count > 0) << "the action makes some allocations";
    }
}

constexpr const char* LongName = "a name that is too long for the object that bears it";
constexpr const char* LongSignalName = "a_name_that_is_too_long_for_the_object_that_bears_it";

TEST(FailingAllocation, AComponentThatIsNotMadeLeavesNothingBehind) {
    FailInTurn([] { const Orn_Hdl::Component component(LongName); });
}

TEST(FailingAllocation, ACompoundThatIsNotMadeIsForgottenByItsMembers) {
    Orn_Hdl::PtrArray<Orn_Hdl::Signal*> members;
    FailInTurn([&] {
        // These end after the compound that could not be made.
        const auto first = std::make_unique<Orn_Hdl::ScalarSignal>("A");
        const auto second = std::make_unique<Orn_Hdl::ScalarSignal>("B");
        members.Empty();
        members.Add(first.get());
        members.Add(second.get());
        const auto compound = std::make_unique<Orn_Hdl::CompoundBus>("A,B", members);
    });
    members.Empty();
}

TEST(FailingAllocation, ASetThatIsNotCopiedLeavesNothingBehind) {
    Orn_Hdl::StringSet set;
    for (const char* name : {"A", "b", LongName}) {
        set.Add(name);
    }
    FailInTurn([&] { const Orn_Hdl::StringSet copy(set); });
}

TEST(FailingAllocation, ATextThatFindsNoRoomLeavesTheListAsItWas) {
    Orn_Hdl::StringArray texts;
    texts.Add("first");
    texts.Add("second");
    const Port::String longer(std::string(1000, 'x'));
    FailInTurn([&] {
        Orn_Hdl::StringArray copy = texts;
        try {
            copy.SetAt(0, longer);
        } catch (const std::bad_alloc&) {
            EXPECT_EQ(copy.GetView(0), "first");
            EXPECT_EQ(copy.GetView(1), "second");
            throw;
        }
    });
}

TEST(FailingAllocation, ANameThatFindsNoPlaceIsNotInTheMap) {
    int object = 0;
    Orn_Hdl::IStringPtrMap<int*> names;
    // As many as have places before there must be more of them.
    for (int i = 0; i < 16; ++i) {
        names.Add(("N" + std::to_string(i)).c_str(), &object);
    }
    FailInTurn([&] {
        Orn_Hdl::IStringPtrMap<int*> copy(names);
        try {
            copy.Add(LongName, &object);
        } catch (const std::bad_alloc&) {
            copy.Add(LongName, &object);
            copy.Remove(LongName);
            EXPECT_FALSE(copy.Contains(LongName));
            throw;
        }
    });
}

TEST(FailingAllocation, WhatANetlistHoldsIsFound) {
    FailInTurn([] {
        Orn_Hdl::Netlist netlist;
        try {
            for (int i = 0; i < 40; ++i) {
                const std::string number = std::to_string(i);
                netlist.Add(new Orn_Hdl::Component(("C" + number).c_str()));
                netlist.Add(new Orn_Hdl::Bus(("B" + number + "(3:0)").c_str()));
            }
        } catch (const std::bad_alloc&) {
            for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
                EXPECT_EQ(netlist.GetComponent(component->GetNameView()), component);
            }
            for (const Orn_Hdl::Signal* bus : netlist.GetSignalIterator()) {
                EXPECT_EQ(netlist.GetSignal(bus->GetNameView()), bus);
                EXPECT_EQ(netlist.GetParentBus(bus->GetName().CStr()), bus);
            }
            throw;
        }
    });
}

/// A model with a bus, its parts, a scalar and compounds of them, one of which names another. As
/// many further instances as asked for fill the netlist's index to different degrees.
std::unique_ptr<Orn_Hdl::Engine> MakeModelToRename(int furtherInstances) {
    auto engine = std::make_unique<Orn_Hdl::Engine>();
    engine->CreateAndAddModel("top", "");
    Orn_Hdl::Model* const model = engine->GetModel("top");
    for (const char* line : {"ADD COMPONENT C", "ADD PIN C I(3:0) INPUT", "ADD PIN C J(2:0) INPUT",
                             "ADD INSTANCE C U1", "ADD SIGNAL D(7:0)", "ADD SIGNAL s",
                             "CONNECT SIGNAL D(3:0) U1.I(3:0)", "ADD INSTANCE C U2",
                             "CONNECT SIGNAL D(7:6),s,D(0) U2.I(3:0)",
                             "CONNECT SIGNAL s,D(5:4) U1.J(2:0)", "CONNECT SIGNAL D(1) s"}) {
        model->ExecuteLine(line);
    }
    // The netlist finds these instead of two parts of the bus, which need a place in the index
    // then.
    model->GetNetlist()->Add(new Orn_Hdl::ScalarSignal("D(0)"));
    model->GetNetlist()->Add(new Orn_Hdl::ScalarSignal("D(5:4)"));
    for (int i = 0; i < furtherInstances; ++i) {
        model->AddInstance(("F" + std::to_string(i)).c_str(), "C");
    }
    model->SetModifiedFlag(false);
    return engine;
}

template <class T> void TellEach(std::string& text, const Orn_Hdl::Iterator<T*>& objects) {
    for (const T* object : objects) {
        text.append(object->GetNameView()).append(" ");
    }
    text += "\n";
}

/// All names of a model and what its signals are connected to. An object may be
/// found by its name, or another one, or none.
std::string Tell(Orn_Hdl::Model& model) {
    const Orn_Hdl::Netlist& netlist = *model.GetNetlist();
    std::string text = model.IsModified() ? "modified\n" : "";
    TellEach(text, netlist.GetSignalIterator());
    TellEach(text, netlist.GetInstanceIterator());
    TellEach(text, netlist.GetComponentIterator());
    for (const Orn_Hdl::Signal* signal : netlist.GetSignalIterator()) {
        const Orn_Hdl::Signal* const found = netlist.GetSignal(signal->GetNameView());
        text += found == signal ? "+" : found == nullptr ? "-" : "=";
        TellEach(text, signal->GetSignalIterator());
        TellEach(text, signal->GetPinIterator());
    }
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        EXPECT_EQ(netlist.GetInstance(instance->GetNameView()), instance);
    }
    for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
        EXPECT_EQ(netlist.GetComponent(component->GetNameView()), component);
    }
    return text;
}

/// Renames an object of a model while one allocation after the other fails: nothing has changed
/// then, and renaming it once more succeeds.
template <class Rename>
void FailToRename(const Rename& rename, int leastInstances = 0, int mostInstances = 16) {
    for (int furtherInstances = leastInstances; furtherInstances <= mostInstances;
         ++furtherInstances) {
        const auto first = MakeModelToRename(furtherInstances);
        Orn_Hdl::Model& renamed = *first->GetModel("top");
        const std::string before = Tell(renamed);
        rename(renamed);
        const std::string after = Tell(renamed);
        ASSERT_NE(after, before);
        FailInTurn([&] {
            const long count = allowed.exchange(-1);
            const auto engine = MakeModelToRename(furtherInstances);
            Orn_Hdl::Model& model = *engine->GetModel("top");
            try {
                allowed = count;
                rename(model);
                allowed = -1;
            } catch (const std::bad_alloc&) {
                allowed = -1;
                EXPECT_EQ(Tell(model), before) << "allocation " << count;
                rename(model);
                EXPECT_EQ(Tell(model), after) << "allocation " << count;
                throw;
            }
            EXPECT_EQ(Tell(model), after);
        });
    }
}

TEST(FailingAllocation, ASignalThatIsNotRenamedIsWhatItWas) {
    FailToRename([](Orn_Hdl::Model& model) { model.RenameSignal("s", LongSignalName); });
    FailToRename([](Orn_Hdl::Model& model) { model.RenameSignal("s", "t"); });
}

TEST(FailingAllocation, ABusThatIsNotRenamedKeepsItsPartsAndCompounds) {
    const std::string name = std::string(LongSignalName) + "(7:0)";
    FailToRename([&](Orn_Hdl::Model& model) { model.RenameSignal("D(7:0)", name.c_str()); });
    FailToRename([](Orn_Hdl::Model& model) { model.RenameSignal("D(7:0)", "E(7:0)"); });
}

TEST(FailingAllocation, NoneOfTheNamesOfABusIsExchanged) {
    // With so many objects the index needs memory from the system for one more: it has room for
    // that of one of the two hidden parts.
    constexpr int Fullest = 11'688;
    const auto engine = MakeModelToRename(0);
    const Orn_Hdl::Netlist& netlist = *engine->GetModel("top")->GetNetlist();
    const auto countOf = [](const auto& objects) {
        return static_cast<int>(std::distance(objects.begin(), objects.end()));
    };
    constexpr int Hidden = 2;
    const int found = countOf(netlist.GetSignalIterator()) +
                      countOf(netlist.GetInstanceIterator()) +
                      countOf(netlist.GetComponentIterator()) - Hidden;
    FailToRename([](Orn_Hdl::Model& model) { model.RenameSignal("D(7:0)", "E(7:0)"); },
                 Fullest - found - 1, Fullest - found);
}

TEST(FailingAllocation, AnInstanceOrComponentThatIsNotRenamedIsWhatItWas) {
    FailToRename([](Orn_Hdl::Model& model) { model.RenameInstance("U1", LongSignalName); });
    FailToRename([](Orn_Hdl::Model& model) { model.RenameInstance("U1", "V1"); });
    FailToRename([](Orn_Hdl::Model& model) { model.RenameComponent("C", LongSignalName); });
}

TEST(FailingAllocation, ADoneCommandThatIsNotKeptEnds) {
    int ended = 0;
    struct Done final : Orn_Hdl::Command {
        explicit Done(int& count) noexcept : Command(nullptr), ended(count) {}
        ~Done() override { ++ended; }
        bool Parse(const Orn_Hdl::StringArray& /*tokens*/) override { return true; }
        void Execute() override {}
        const char* GetName() const override { return "DONE"; }
        int& ended;
    };
    int made = 0;
    FailInTurn([&] {
        Orn_Hdl::CommandManager manager;
        auto* const done = new Done(ended);
        ++made;
        manager.AddDoneCommand(done);
    });
    EXPECT_EQ(ended, made);
}

TEST(FailingAllocation, AModelThatIsNotReadStaysAsItWas) {
    const Support::TemporaryFolder folder;
    const std::string file = folder / "top.v";
    Support::WriteWholeFile(
        file, "`define W [3:0]\nmodule INV #(parameter P = 8'h00)(input I, output O); endmodule\n"
              "// a comment\nmodule top(input a, output `W y); wire `W \\w.x , W, w;\n"
              "(* LOC = \"P1\" *) INV #(.P(1)) u(.I(1'b0), .O(y[0])), \\u.1 (y[0], W[0]);\n"
              "assign {y[3], y[2:1]} = {w[0], 2'b10}; defparam u.P = 8'h0F;\n"
              "// synthesis attribute P of u is \"0F\"\nendmodule\n");
    const int openFiles = Support::CountOpenFiles();
    Orn_Hdl::CommandFactory factory;
    FailInTurn([&] {
        Orn_Hdl::Model model(&factory);
        model.AddSignal("former");
        Orn_Hdl::VerilogReader reader;
        reader.KeepComments(true);
        reader.SetTop("top");
        try {
            reader.Read(file.c_str(), model);
        } catch (const std::bad_alloc&) {
            EXPECT_NE(model.GetSignal("former"), nullptr);
            throw;
        }
        EXPECT_EQ(model.GetSignal("former"), nullptr);
        EXPECT_NE(model.GetInstance("u_1"), nullptr);
    });
    EXPECT_EQ(Support::CountOpenFiles(), openFiles);
}

/// Reads numbered lines; after some allocations one fails, and reading goes on. \return whether one
/// did fail.
bool ReadOn(Orn_Hdl::Model& model, const std::string& file, int lines, long allocations) {
    int failed = 0;
    int last = -1;
    int given = 0;
    Orn_Hdl::CommandReader reader(model);
    EXPECT_TRUE(reader.Open(file.c_str()));
    allowed = allocations;
    for (bool more = true; more;) {
        try {
            const Orn_Hdl::StringArray* const words = reader.Next();
            more = words != nullptr;
            if (more) {
                const int number = std::atoi(std::string(words->GetView(1)).c_str());
                EXPECT_GT(number, last);
                last = number;
                ++given;
            }
        } catch (const std::bad_alloc&) {
            ++failed;
        }
    }
    allowed = -1;
    EXPECT_LE(failed, 1);
    EXPECT_GE(given, lines - failed);
    EXPECT_EQ(reader.GetError(), 0);
    return failed > 0;
}

TEST(FailingAllocation, AFileThatIsReadOnTwoProcessorsGoesOn) {
    constexpr int Count = 10000;
    const Support::TemporaryFolder folder;
    const std::string file = folder / "lines.cmd";
    std::string text;
    for (int i = 0; i < Count; ++i) {
        text += "NOOP " + std::to_string(i) + " a name that finds no room in a small string\n";
    }
    Support::WriteWholeFile(file, text);
    Orn_Hdl::CommandFactory factory;
    Orn_Hdl::Model model(&factory);
    model.GetOptions()->threads = 2;
    // Each of the first, and some of the thousands that the lines need.
    bool failed = true;
    for (long count = 0; failed; count += count < 150 ? 1 : 501) {
        const long before = alive;
        failed = ReadOn(model, file, Count, count);
        ASSERT_EQ(alive, before) << "allocation " << count << " failed, and something leaked";
    }
}

TEST(FailingAllocation, AnyOneMayFail) {
    const Support::TemporaryFolder folder;
    const std::string file = folder / "netlist";
    // The tables that the process keeps are filled first.
    ASSERT_FALSE(RunOnce(file, -1));
    ASSERT_FALSE(RunOnce(file, -1));
    const int openFiles = Support::CountOpenFiles();
    long count = 0;
    for (bool failed = true; failed; ++count) {
        const long before = alive;
        failed = RunOnce(file, count);
        ASSERT_EQ(alive, before) << "allocation " << count << " failed, and something leaked";
        ASSERT_TRUE(!std::filesystem::is_empty(folder.GetPath()));
    }
    EXPECT_GT(count, 200) << "the run makes some allocations";
    EXPECT_EQ(Support::CountOpenFiles(), openFiles);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.GetPath()),
                            std::filesystem::directory_iterator()),
              1)
        << "no temporary file stays behind";
}

} // namespace
