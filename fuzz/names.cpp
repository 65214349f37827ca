// The input is a few names: every rule that reads a name is asked about them and compared with a
// second implementation that is plain to see.

#include "Bytes.h"
#include "Check.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "Sampling.h"

#include <algorithm>
#include <regex>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Fuzz::Check;
using Fuzz::Checks;
using namespace Orn_Hdl;

/// One input in so many is also compared with regular expressions, sorted, and has wide buses
/// expanded, which would take most of the time.
constexpr std::size_t InputsPerFullCheck = 16;
/// Regular expressions of the standard library recurse; longer names are not given to them.
constexpr std::size_t LongestMatched = 200;

constexpr std::string_view Digits = "0123456789";
constexpr std::string_view BaseStart = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz'_";
constexpr std::string_view BaseRest =
    "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789_";

/// Reads a name from left to right. Each step tells whether the name goes on with that part.
class ShapeReader {
public:
    explicit ShapeReader(std::string_view name) : rest_(name) {}

    bool IsAtEnd() const { return rest_.empty(); }

    bool ReadOne(std::string_view characters) {
        if (rest_.empty() || characters.find(rest_.front()) == std::string_view::npos) {
            return false;
        }
        rest_.remove_prefix(1);
        return true;
    }

    bool ReadBase() { return ReadOne(BaseStart) && ReadMany(BaseRest); }

    bool ReadInteger() {
        ReadOne("+-");
        return ReadOne(Digits) && ReadMany(Digits);
    }

private:
    /// There may be none.
    bool ReadMany(std::string_view characters) {
        while (ReadOne(characters)) {
        }
        return true;
    }

    std::string_view rest_;
};

bool IsBus(ShapeReader name) {
    return name.ReadBase() && name.ReadOne("(") && name.ReadInteger() && name.ReadOne(":") &&
           name.ReadInteger() && name.ReadOne(")") && name.IsAtEnd();
}

bool IsBit(ShapeReader name) {
    return name.ReadBase() && name.ReadOne("(") && name.ReadInteger() && name.ReadOne(")") &&
           name.IsAtEnd();
}

bool IsBase(ShapeReader name) {
    return name.ReadBase() && name.IsAtEnd();
}

bool IsInteger(ShapeReader name) {
    return name.ReadInteger() && name.IsAtEnd();
}

void CheckShape(const std::string& name) {
    const char* const text = name.c_str();
    const ShapeReader reader(name);
    Check(Bus::IsBusName(text) == IsBus(reader), "bus names");
    Check(BusIndex::IsBusIndexName(text) == IsBit(reader), "bit names");
    Check(Object::IsValidBaseName(text) == IsBase(reader), "base names");
    Check(Object::IsValidIntegerString(name) == IsInteger(reader), "integers");
}

void CheckAgainstExpressions(const std::string& name) {
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
    Check(Bus::IsBusName(text) == std::regex_match(name, busPattern), "bus names, by expression");
    Check(BusIndex::IsBusIndexName(text) == std::regex_match(name, bitPattern),
          "bit names, by expression");
    Check(Object::IsValidBaseName(text) == std::regex_match(name, basePattern),
          "base names, by expression");
    Check(Object::IsValidIntegerString(name) == std::regex_match(name, indexPattern),
          "integers, by expression");
}

void CheckBus(const char* name, bool isNormalized, Checks checks) {
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
    const int widest = checks == Checks::All ? 4096 : 64;
    const bool isExpanded = bus.GetWidth() <= widest && Bus::ParseBusName(name, bits);
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

void CheckReading(const std::string& name, bool isNormalized, Checks checks) {
    CheckShape(name);
    if (checks == Checks::All) {
        CheckAgainstExpressions(name);
    }
    CheckBus(name.c_str(), isNormalized, checks);
    CheckCompound(name.c_str());
}

void CheckName(const std::string& text, Checks checks) {
    Port::String normalized(text);
    Object::NormalizeName(normalized);
    Port::String again = normalized;
    Object::NormalizeName(again);
    Check(again == normalized && normalized.GetLength() == text.size(), "normalising happens once");
    Check(normalized.GetView().find_first_of("[]{}<>-") == std::string_view::npos,
          "a normalised name has parentheses and colons only");
    Check(Object::GetBaseName(text.c_str()) == Object::GetBaseName(normalized.CStr()),
          "a base name is a normalised name's");
    const std::string normalizedText(normalized.GetView());
    CheckReading(normalizedText, true, checks);
    if (text != normalizedText) {
        CheckReading(text, false, checks);
    }
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

void Run(Fuzz::Bytes bytes, Checks checks) {
    std::vector<std::string> names;
    while (!bytes.IsAtEnd() && names.size() < 16) {
        // A name ends at its first NUL.
        names.emplace_back(bytes.Text(64).c_str());
        CheckName(names.back(), checks);
    }
    if (checks == Checks::Few) {
        return;
    }
    const std::vector<std::string> sorted = SortedNames(names);
    std::reverse(names.begin(), names.end());
    Check(SortedNames(names) == sorted, "a sorted order does not depend on the former one");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    for (const Checks checks : Fuzz::ChooseChecks(data, size, InputsPerFullCheck)) {
        Run(Fuzz::Bytes(data, size), checks);
    }
    return 0;
}
