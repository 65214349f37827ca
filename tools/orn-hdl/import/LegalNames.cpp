#include "import/LegalNames.h"

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"

#include <algorithm>

namespace Tool::Import {

namespace {

using Port::IsDigit;
using Port::IsLetter;

/// Words added to Verilog after IEEE 1364-1995, including SystemVerilog's (IEEE 1800-2017, annex
/// B), and "force". Each has a blank before and after it.
constexpr std::string_view VerilogWords =
    " accept_on alias always_comb always_ff always_latch assert assume automatic"
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
    " within ";

/// Words added to VHDL after IEEE 1076-1993, the names of types, literals and libraries that
/// written VHDL mentions, and of the architecture, in lower case. Each has a blank before and
/// after it.
constexpr std::string_view VhdlWords =
    " assume assume_guarantee behavioral bit bit_vector boolean context cover default"
    " fairness false force ieee integer kestra numeric_std parameter private property"
    " protected real release restrict restrict_guarantee sequence std std_logic"
    " std_logic_1164 std_logic_vector string strong true vcomponents view vmode vprop"
    " vunit work ";

/// A signal of this name could not be declared: ADD SIGNAL COMMENT is another command.
constexpr std::string_view CommandWord("comment");

std::string ToLower(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), Port::ToLower);
    return result;
}

bool IsListed(std::string_view words, std::string_view word) {
    return words.find(std::string(" ").append(word).append(" ")) != std::string_view::npos;
}

bool IsReserved(std::string_view name) {
    constexpr std::size_t LongestWord = 20;
    if (name.size() > LongestWord) {
        return false;
    }
    const std::string text(name);
    const std::string lower = ToLower(name);
    return lower == CommandWord || Orn_Hdl::Engine::IsVhdlKeyword(text.c_str()) ||
           Orn_Hdl::Engine::IsVerilogKeyword(text.c_str()) || IsListed(VerilogWords, name) ||
           IsListed(VhdlWords, lower);
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

bool IsLegalName(std::string_view name) {
    return IsBasicIdentifier(name) && !IsReserved(name) &&
           !Orn_Hdl::HdlUtilities::IsGeneratedName(std::string(name).c_str());
}

std::string MakeLegalName(std::string_view name, char initial) {
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
