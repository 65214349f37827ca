#include "ImportNames.h"

#include "Orn_Hdl/Engine.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <cstdint>
#include <iterator>

namespace Tool::Import {

namespace {

using Port::IsDigit;
using Port::IsLetter;

/// Words that Verilog gained after IEEE 1364-1995, SystemVerilog's included (IEEE 1800-2017, annex
/// B), and "force". A blank stands before and behind each.
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

/// Words that VHDL gained after IEEE 1076-1993, the names of types, literals and libraries that
/// written VHDL mentions, and of the architecture. Likewise; in any letter case.
constexpr std::string_view VhdlWords =
    " assume assume_guarantee behavioral bit bit_vector boolean context cover default"
    " fairness false force ieee integer kestra numeric_std parameter private property"
    " protected real release restrict restrict_guarantee sequence std std_logic"
    " std_logic_1164 std_logic_vector string strong true vcomponents view vmode vprop"
    " vunit work ";

/// A signal of this name could not be declared: ADD SIGNAL COMMENT is another command.
constexpr std::string_view CommandWord("comment");

/// Ends of names that the library makes for signals of its own.
constexpr std::string_view ReservedEnds[] = {"_dummy", "_const_signal", "_opensignal"};

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

bool HasReservedEnd(std::string_view name) {
    return std::any_of(std::begin(ReservedEnds), std::end(ReservedEnds), [&](std::string_view end) {
        return name.size() >= end.size() &&
               Port::EqualIgnoringCase(name.substr(name.size() - end.size()), end);
    });
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

/// Of one part of a made-up name, without the place in a source file that it may begin with:
/// "opt_dff.cc:744:run" gives "run", "top.v:12" nothing.
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

/// Of a name that a program made up, such as "$abc$97$auto$opt_dff.cc:744:run$12", the parts that
/// tell something: "run$12". Other names stay as they are.
std::string GetTellingPart(std::string_view name) {
    std::string result;
    if (name.empty() || name.front() != '$') {
        return result.assign(name);
    }
    std::string_view previous;
    for (std::size_t start = 1; start <= name.size();) {
        const std::size_t end = std::min(name.find('$', start), name.size());
        const std::string_view part = name.substr(start, end - start);
        const bool isRun = previous == "abc" && IsNumber(part);
        const std::string_view telling =
            isRun || part == "abc" || part == "auto" ? std::string_view() : WithoutPlace(part);
        if (!telling.empty()) {
            result.append(result.empty() ? "" : "$").append(telling);
        }
        previous = part;
        start = end + 1;
    }
    return result;
}

} // namespace

bool IsLegalName(std::string_view name) {
    return IsBasicIdentifier(name) && !IsReserved(name) && !HasReservedEnd(name);
}

std::string MakeLegalName(std::string_view name, char initial) {
    std::string result;
    for (const char c : GetTellingPart(name)) {
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

std::size_t NameTable::Hash::operator()(std::string_view name) const noexcept {
    // FNV-1a over the letters in one case.
    std::uint64_t hash = 14695981039346656037u;
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(Port::ToUpper(c))) * 1099511628211u;
    }
    return hash;
}

bool NameTable::Equal::operator()(std::string_view a, std::string_view b) const noexcept {
    return Port::EqualIgnoringCase(a, b);
}

std::string_view NameTable::Keep(std::string_view name) {
    char* copy = static_cast<char*>(memory_.allocate(name.size(), 1));
    std::copy(name.begin(), name.end(), copy);
    return std::string_view(copy, name.size());
}

bool NameTable::Claim(std::string_view name) {
    return !IsTaken(name) && taken_.insert(Keep(name)).second;
}

std::string NameTable::ClaimSimilar(std::string_view name, char initial) {
    std::string wanted = MakeLegalName(name, initial);
    if (IsLegalName(wanted) && Claim(wanted)) {
        return wanted;
    }
    auto number = numbers_.find(wanted);
    if (number == numbers_.end()) {
        number = numbers_.emplace(Keep(wanted), 0).first;
    }
    std::string numbered;
    do {
        numbered = wanted + "_" + std::to_string(++number->second);
    } while (!Claim(numbered));
    return numbered;
}

} // namespace Tool::Import
