// The input is a few names: every rule that reads a name is asked about them and compared with an
// obvious second implementation.

#include "Bytes.h"
#include "Check.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <regex>
#include <vector>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;

/// Regular expressions of the standard library recurse; longer names are not given to them.
constexpr std::size_t LongestMatched = 200;

void CheckShape(const std::string& name) {
    if (name.size() > LongestMatched) {
        return;
    }
    static const std::string base = "[A-Za-z'_][A-Za-z0-9_]*";
    static const std::string index = "[+-]?[0-9]+";
    static const std::regex busPattern(base + "\\(" + index + ":" + index + "\\)");
    static const std::regex bitPattern(base + "\\(" + index + "\\)");
    static const std::regex basePattern(base);
    static const std::regex indexPattern(index);
    const char* const text = name.c_str();
    Check(Bus::IsBusName(text) == std::regex_match(name, busPattern), "bus names");
    Check(BusIndex::IsBusIndexName(text) == std::regex_match(name, bitPattern), "bit names");
    Check(Object::IsValidBaseName(text) == std::regex_match(name, basePattern), "base names");
    Check(Object::IsValidIntegerString(name) == std::regex_match(name, indexPattern), "integers");
}

void CheckBus(const char* name, bool isNormalized) {
    Port::String base;
    Port::String left;
    Port::String right;
    int first = 0;
    int last = 0;
    const bool isBus = Bus::IsBusName(name);
    Check(Bus::ParseBusName(name, base, left, right) == isBus, "a bus name parses");
    Check(Bus::ParseBusName(name, base, first, last) == isBus, "a bus name parses to numbers");
    if (!isNormalized) {
        return;
    }
    const Bus bus(name);
    Check((bus.GetWidth() > 0) == isBus, "a bus name has a width");
    StringArray bits;
    const bool isExpanded = bus.GetWidth() <= 4096 && Bus::ParseBusName(name, bits);
    if (isBus) {
        Check(base + "(" + left + ":" + right + ")" == Port::String(name), "a bus name's parts");
        Check(!isExpanded || bits.GetSize() == bus.GetWidth(), "a bus name has its bits");
        Check(bus.IsDownTo() == (first > last), "a bus name's direction");
    }
    for (int i = 0; i < bits.GetSize(); ++i) {
        Check(BusIndex::IsBusIndexName(bits[i].CStr()), "a bus's bits are bit names");
    }
    Bus::GetBusSliceName(name, 1, 2);
}

void CheckCompound(const char* name) {
    StringArray names;
    CompoundBus::ParseCompoundBusName(name, names, false);
    if (CompoundBus::IsCompoundBusName(name)) {
        Check(names.GetSize() > 1, "a compound has members");
        for (int i = 0; i < names.GetSize(); ++i) {
            const Port::String member = names[i];
            Check(Object::IsValidBaseName(member.CStr()) || Bus::IsBusName(member.CStr()) ||
                      BusIndex::IsBusIndexName(member.CStr()),
                  "a compound's members have shapes");
        }
    }
}

void CheckName(const std::string& text) {
    Port::String normalized(text);
    Object::NormalizeName(normalized);
    Port::String again = normalized;
    Object::NormalizeName(again);
    Check(again == normalized && normalized.GetLength() == text.size(), "normalising happens once");
    Check(normalized.GetView().find_first_of("[]{}<>-") == std::string_view::npos,
          "a normalised name has parentheses and colons only");
    Check(Object::GetBaseName(text.c_str()) == Object::GetBaseName(normalized.CStr()),
          "a base name is a normalised name's");
    CheckShape(text);
    CheckShape(std::string(normalized.GetView()));
    CheckBus(text.c_str(), false);
    CheckBus(normalized.CStr(), true);
    CheckCompound(text.c_str());
    CheckCompound(normalized.CStr());
}

std::vector<std::string> SortedNames(const std::vector<std::string>& names) {
    Netlist netlist;
    for (const std::string& name : names) {
        netlist.Add(new Component(name.c_str()));
    }
    netlist.SortNetlist();
    std::vector<std::string> sorted;
    for (const Component* component : netlist.GetComponentIterator()) {
        std::string name(component->GetNameView());
        std::transform(name.begin(), name.end(), name.begin(), Port::ToUpper);
        sorted.push_back(name);
    }
    return sorted;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    std::vector<std::string> names;
    while (!bytes.IsAtEnd() && names.size() < 16) {
        // A name ends at its first NUL.
        names.emplace_back(bytes.Text(64).c_str());
        CheckName(names.back());
    }
    const std::vector<std::string> sorted = SortedNames(names);
    std::reverse(names.begin(), names.end());
    Check(SortedNames(names) == sorted, "a sorted order does not depend on the former one");
    return 0;
}
