#include "Legal/Identifiers.h"

#include "Check/Context.h"
#include "Check/Identifier.h"
#include "Check/ReservedWords.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl::Legal {

using std::string_view;

namespace {

/// Types, literals, libraries and packages that written VHDL mentions, its architecture, and the
/// word that means no signal.
constexpr string_view Mentioned[] = {"behavioral",
                                     "bit",
                                     "bit_vector",
                                     "boolean",
                                     "character",
                                     "false",
                                     "ieee",
                                     "integer",
                                     "kestra",
                                     "natural",
                                     "note",
                                     "numeric_std",
                                     "open",
                                     "positive",
                                     "real",
                                     "std",
                                     "std_logic",
                                     "std_logic_1164",
                                     "std_logic_vector",
                                     "string",
                                     "time",
                                     "true",
                                     "vcomponents",
                                     "work"};

bool IsMentioned(string_view name) {
    return std::any_of(std::begin(Mentioned), std::end(Mentioned),
                       [name](string_view word) { return Port::EqualIgnoringCase(word, name); });
}

bool IsReserved(string_view name) {
    const std::string small = Checking::Lower(name);
    return !(Checking::FindReserved(small, small) == Check::Verdicts());
}

bool IsGraphic(char c) noexcept {
    return c > ' ' && c < '\x7F';
}

} // namespace

bool IsLegal(string_view name) {
    const Checking::Identifier form(name);
    return form.isVerilog && form.isVhdl && form.hasProperUnderscores && name.front() != '\\' &&
           !IsReserved(name) && !IsMentioned(name);
}

std::string MakeSimilar(string_view name, char initial, std::size_t longest) {
    std::string result;
    for (const char c : name) {
        if (Port::IsLetter(c) || Port::IsDigit(c)) {
            result += c;
        } else if (!result.empty() && result.back() != '_') {
            result += '_';
        }
    }
    if (result.empty() || Port::IsDigit(result.front())) {
        result.insert(result.begin(), initial);
    }
    result.resize(std::min(result.size(), longest));
    if (result.back() == '_') {
        result.pop_back();
    }
    return result;
}

bool Escape(string_view name, std::string& verilog, std::string& vhdl) {
    if (name.empty() || name.size() > LongestName ||
        !std::all_of(name.begin(), name.end(), IsGraphic)) {
        return false;
    }
    verilog.assign("\\").append(name).append(" ");
    vhdl = "\\";
    for (const char c : name) {
        vhdl.append(c == '\\' ? 2 : 1, c);
    }
    vhdl += '\\';
    return true;
}

} // namespace Orn_Hdl::Legal
