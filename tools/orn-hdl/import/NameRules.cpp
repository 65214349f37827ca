#include "import/NameRules.h"

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <unordered_set>

namespace Tool::Import {

namespace {

using Port::IsDigit;
using Port::IsLetter;

/// Words that are looked up for every name of a design.
class WordSet {
public:
    /// \param words with blanks between them; not copied.
    explicit WordSet(std::string_view words) {
        while (!words.empty()) {
            const std::size_t size = std::min(words.find(' '), words.size());
            words_.insert(words.substr(0, size));
            words.remove_prefix(std::min(size + 1, words.size()));
        }
    }

    bool Has(std::string_view word) const { return words_.count(word) != 0; }

private:
    std::unordered_set<std::string_view> words_;
};

/// Words added to Verilog after IEEE 1364-1995, including SystemVerilog's (IEEE 1800-2017, annex
/// B), and "force".
constexpr std::string_view VerilogWordList =
    "accept_on alias always_comb always_ff always_latch assert assume automatic"
    " before bind bins binsof bit break byte cell chandle checker class clocking"
    " config const constraint context continue cover covergroup coverpoint cross"
    " design dist do endchecker endclass endclocking endconfig endgenerate endgroup"
    " endinterface endpackage endprogram endproperty endsequence enum eventually"
    " expect export extends extern final first_match force foreach forkjoin generate"
    " genvar global iff ignore_bins illegal_bins implements implies import incdir"
    " include inside instance int interconnect interface intersect join_any join_none"
    " let liblist library local localparam logic longint matches modport nettype new"
    " nexttime noshowcancelled null package packed priority program property protected"
    " pulsestyle_ondetect pulsestyle_onevent pure rand randc randcase randsequence ref"
    " reject_on restrict return s_always s_eventually s_nexttime s_until s_until_with"
    " sequence shortint shortreal showcancelled signed soft solve static std string"
    " strong struct super sync_accept_on sync_reject_on tagged this throughout"
    " timeprecision timeunit type typedef union unique unique0 unsigned until"
    " until_with untyped use uwire var virtual void wait_order weak wildcard with"
    " within";

/// The classes of SystemVerilog, which Verilator takes for types even where the name is escaped.
constexpr std::string_view VerilogClassList = "mailbox process semaphore";

/// Words added to VHDL after IEEE 1076-1993, the names of types, literals and libraries that
/// written VHDL mentions, and of the architecture, in lower case.
constexpr std::string_view VhdlWordList =
    "assume assume_guarantee behavioral bit bit_vector boolean context cover default"
    " fairness false force ieee integer kestra numeric_std parameter private property"
    " protected real release restrict restrict_guarantee sequence std std_logic"
    " std_logic_1164 std_logic_vector string strong true vcomponents view vmode vprop"
    " vunit work";

/// Names with a meaning of their own: ADD SIGNAL COMMENT and ADD INSTANCE ATTRIBUTE are other
/// commands, and the signal "open" is none.
constexpr std::string_view LibraryWordList = "attribute comment open";

/// The length of the longest reserved word.
constexpr std::size_t LongestWord = 20;

std::string ToLower(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), Port::ToLower);
    return result;
}

bool IsVerilogClass(std::string_view name) {
    static const WordSet words(VerilogClassList);
    return words.Has(name);
}

bool IsVerilogWord(std::string_view name) {
    static const WordSet words(VerilogWordList);
    return Orn_Hdl::Engine::IsVerilogKeyword(std::string(name).c_str()) || words.Has(name) ||
           IsVerilogClass(name);
}

bool IsVhdlWord(std::string_view name) {
    static const WordSet words(VhdlWordList);
    return Orn_Hdl::Engine::IsVhdlKeyword(std::string(name).c_str()) || words.Has(ToLower(name));
}

bool IsLibraryWord(std::string_view name) {
    static const WordSet words(LibraryWordList);
    return words.Has(ToLower(name));
}

/// A letter, then letters and digits with single "_" between them.
bool IsBasicIdentifier(std::string_view name) noexcept {
    if (name.empty() || !IsLetter(name.front()) || name.back() == '_') {
        return false;
    }
    char previous = '\0';
    for (const char c : name) {
        if (!IsLetter(c) && !IsDigit(c) && (c != '_' || previous == '_')) {
            return false;
        }
        previous = c;
    }
    return true;
}

/// Letters, digits and "_", without a digit at the start. The library takes "$" for no part of
/// the name of a bus.
bool IsVerilogBase(std::string_view name) noexcept {
    return !name.empty() && !IsDigit(name.front()) &&
           std::all_of(name.begin(), name.end(),
                       [](char c) { return IsLetter(c) || IsDigit(c) || c == '_'; });
}

bool IsGenerated(std::string_view name) {
    return Orn_Hdl::HdlUtilities::IsGeneratedName(std::string(name).c_str());
}

bool IsNumber(std::string_view text) noexcept {
    return !text.empty() && std::all_of(text.begin(), text.end(), IsDigit);
}

/// A part of a generated name without the source location at its start: "opt_dff.cc:744:run"
/// becomes "run", and "top.v:12" becomes empty.
std::string_view WithoutPlace(std::string_view part) {
    const std::size_t line = part.find(':');
    if (line == std::string_view::npos) {
        return part;
    }
    const std::size_t end = std::min(part.find(':', line + 1), part.size());
    if (!IsNumber(part.substr(line + 1, end - line - 1))) {
        return part;
    }
    return end == part.size() ? std::string_view() : part.substr(end + 1);
}

/// The meaningful parts of a name: "run$12" for the generated name
/// "$abc$97$auto$opt_dff.cc:744:run$12". A name that no program generated stays whole.
std::string GetMeaningfulParts(std::string_view name) {
    std::string result;
    if (name.empty() || name.front() != '$') {
        return result.assign(name);
    }
    std::string_view previous;
    for (std::size_t start = 1; start <= name.size();) {
        const std::size_t end = std::min(name.find('$', start), name.size());
        const std::string_view part = name.substr(start, end - start);
        const bool isRun = previous == "abc" && IsNumber(part);
        const std::string_view kept =
            isRun || part == "abc" || part == "auto" ? std::string_view() : WithoutPlace(part);
        if (!kept.empty()) {
            result.append(result.empty() ? "" : "$").append(kept);
        }
        previous = part;
        start = end + 1;
    }
    return result;
}

} // namespace

bool NameRules::IsLegal(std::string_view name) const {
    const bool isIdentifier =
        languages_ == NameLanguages::Verilog ? IsVerilogBase(name) : IsBasicIdentifier(name);
    return isIdentifier && !IsReserved(name) && !IsGenerated(name);
}

bool NameRules::IsReserved(std::string_view name) const {
    return name.size() <= LongestWord &&
           (IsLibraryWord(name) || (languages_ != NameLanguages::Vhdl && IsVerilogWord(name)) ||
            (languages_ != NameLanguages::Verilog && IsVhdlWord(name)));
}

const char* NameRules::GetComplaint() const noexcept {
    switch (languages_) {
    case NameLanguages::Verilog:
        return " cannot be kept as a name in Verilog";
    case NameLanguages::Vhdl:
        return " is not a legal name in VHDL";
    default:
        return " is not a legal name in Verilog and VHDL";
    }
}

bool NameRules::IsEscapable(std::string_view name) const {
    // The library would change brackets, "-" and ":", and split a name at "," and "\". Quotes,
    // "`" and the marks of comments would confuse what reads the netlist.
    const auto isAllowed = [](char c) {
        return c > ' ' && c <= '~' &&
               std::string_view("()[]<>{}-:,\\\"'`").find(c) == std::string_view::npos;
    };
    // In a command, a period stands between an instance and its pin.
    return !name.empty() && std::all_of(name.begin(), name.end(), isAllowed) &&
           !IsVerilogClass(name) && (!forCommands_ || name.find('.') == std::string_view::npos) &&
           name.find("//") == std::string_view::npos && name.find("/*") == std::string_view::npos &&
           name.find("*/") == std::string_view::npos && !IsGenerated(name);
}

std::string NameRules::Escape(std::string_view name, std::size_t blanks) {
    return std::string("\\").append(name).append(blanks, ' ');
}

std::string_view NameRules::WithoutEscape(std::string_view name) noexcept {
    return IsEscaped(name) ? name.substr(1, name.find(' ') - 1) : name;
}

std::string MakeSimilarName(std::string_view name, char initial) {
    std::string result;
    for (const char c : GetMeaningfulParts(name)) {
        if (IsLetter(c) || IsDigit(c)) {
            result += c;
        } else if (!result.empty() && result.back() != '_') {
            result += '_';
        }
    }
    if (!result.empty() && result.back() == '_') {
        result.pop_back();
    }
    if (result.empty() || IsDigit(result.front())) {
        result.insert(result.begin(), initial);
    }
    return result;
}

} // namespace Tool::Import
