// The first half of the input is a byte of rules, a byte that says what the other half is, and
// choices of commands and arguments for a design. The other half makes a second design: by such
// choices, or by leaving out or doubling lines of the first one. Each design is equal to itself,
// and what is added in one direction is removed in the other.

#include "Bytes.h"
#include "Check.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Scripts.h"
#include "diff/Compare.h"
#include "diff/Spelling.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;
namespace Diff = Tool::Diff;

/// Runs the lines of a script that do not fail; nothing is written.
void Run(const Fuzz::Script& script, Model& model) {
    for (const std::string& line : script) {
        StringArray words;
        words.ParseCommandLine(line);
        if (words.GetSize() > 0 && Port::EqualIgnoringCase(words.GetView(0), "WRITE")) {
            continue;
        }
        try {
            model.ExecuteLine(line);
        } catch (const Exception&) {
            // A line that fails changes nothing that matters here.
        }
    }
}

/// Buses of a few bits show all that wide ones do.
bool IsSmall(const Model& model) {
    constexpr std::int64_t MostBits = 4096;
    std::int64_t bits = 0;
    for (const Signal* signal : model.GetNetlist()->GetSignalIterator()) {
        bits += signal->GetWidth();
    }
    for (const Instance* instance : model.GetNetlist()->GetInstanceIterator()) {
        for (const Pin* pin : instance->GetPinIterator()) {
            const auto* const bus = dynamic_cast<const BusPin*>(pin);
            bits += bus != nullptr ? bus->GetWidth() : 1;
        }
    }
    return bits <= MostBits;
}

Diff::Rules MakeRules(Fuzz::Bytes& bytes) {
    const int choice = bytes.Choose(256);
    Diff::Rules rules;
    rules.names = (choice & 1) == 0;
    rules.attributes = (choice & 2) == 0;
    rules.comments = (choice & 4) == 0;
    rules.order = (choice & 8) == 0;
    rules.mergesNets = (choice & 16) != 0;
    rules.hasExactAttributes = (choice & 32) == 0;
    rules.hasUnusedParts = (choice & 64) == 0;
    rules.hasPinRanges = (choice & 128) == 0;
    return rules;
}

/// The lines of a script, some of them left out or said twice.
Fuzz::Script Change(const Fuzz::Script& script, Fuzz::Bytes& bytes) {
    Fuzz::Script changed;
    for (const std::string& line : script) {
        const int choice = bytes.Choose(16);
        for (int i = choice == 1 ? 0 : choice == 2 ? 2 : 1; i > 0; --i) {
            changed.push_back(line);
        }
    }
    return changed;
}

void CheckCounts(const Diff::Differences& there, const Diff::Differences& back) {
    using Diff::Change;
    Check(there.GetCount(Change::Added) == back.GetCount(Change::Removed),
          "what is added is removed in the other direction");
    Check(there.GetCount(Change::Removed) == back.GetCount(Change::Added),
          "what is removed is added in the other direction");
    for (const Change change :
         {Change::Renamed, Change::Rewired, Change::Retied, Change::Changed}) {
        Check(there.GetCount(change) == back.GetCount(change),
              "what differs differs in the other direction");
    }
}

void CheckEqual(const Model& model, const Diff::Rules& rules) {
    const Diff::Differences found =
        Diff::Compare(*model.GetNetlist(), *model.GetNetlist(), rules, 1);
    Check(found.GetTotal() == 0, "a design is equal to itself");
}

void CheckSpelling(Diff::Differences& found) {
    const std::size_t total = found.GetTotal();
    const std::vector<Diff::Difference> shown = found.Take();
    Check(shown.size() == total, "every difference is told");
    const Diff::Report report{"a", "b", found, shown};
    Check(SpellAsText(report).back() == '\n', "the text ends in a line end");
    Check(SpellAsJson(report).front() == '{', "the JSON is an object");
}

/// \param bytes, others the choices for the first design, and for the second.
void Compare(Fuzz::Bytes bytes, Fuzz::Bytes others) {
    const Fuzz::MemoryFiles files;
    const Diff::Rules rules = MakeRules(bytes);
    const bool isChanged = bytes.Choose(2) == 0;
    const Fuzz::Script first = Fuzz::MakeScript(bytes);
    const Fuzz::Script second = isChanged ? Change(first, others) : Fuzz::MakeScript(others);
    Engine engine;
    engine.CreateAndAddModel("a", "a");
    engine.CreateAndAddModel("b", "b");
    Model& a = *engine.GetModel("a");
    Model& b = *engine.GetModel("b");
    Run(first, a);
    Run(second, b);
    if (!IsSmall(a) || !IsSmall(b)) {
        return;
    }
    CheckEqual(a, rules);
    CheckEqual(b, rules);
    Diff::Differences there = Diff::Compare(*a.GetNetlist(), *b.GetNetlist(), rules, 0);
    const Diff::Differences back = Diff::Compare(*b.GetNetlist(), *a.GetNetlist(), rules, 0);
    CheckCounts(there, back);
    CheckSpelling(there);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::size_t half = size / 2;
    Compare(Fuzz::Bytes(data, half), Fuzz::Bytes(data + half, size - half));
    return 0;
}
