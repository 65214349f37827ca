#include "Check/Identifier.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

constexpr unsigned char Letter = 1;
constexpr unsigned char Digit = 2;
constexpr unsigned char Underscore = 4;
constexpr unsigned char Dollar = 8;
/// A letter of Latin-1, which VHDL has in identifiers and Verilog has not.
constexpr unsigned char LatinLetter = 16;

constexpr std::array<unsigned char, 256> MakeClasses() {
    std::array<unsigned char, 256> classes = {};
    for (std::size_t i = 0; i < classes.size(); ++i) {
        const char c = static_cast<char>(i);
        if (Port::IsLetter(c)) {
            classes[i] = Letter;
        } else if (Port::IsDigit(c)) {
            classes[i] = Digit;
        } else if (i >= 0xC0 && i != 0xD7 && i != 0xF7) {
            classes[i] = LatinLetter;
        }
    }
    classes['_'] = Underscore;
    classes['$'] = Dollar;
    return classes;
}

constexpr std::array<unsigned char, 256> Classes = MakeClasses();

unsigned char ClassOf(char c) noexcept {
    return Classes[static_cast<unsigned char>(c)];
}

bool IsPrintable(char c) noexcept {
    return c > ' ' && c < '\x7F';
}

/// "\" and printable characters up to a blank, which ends the name (IEEE 1364-2005, 3.7.1).
bool IsEscaped(string_view name) noexcept {
    return name.size() > 2 && name.front() == '\\' && name.back() == ' ' &&
           std::all_of(name.begin(), name.end() - 1, IsPrintable);
}

/// Graphic characters between two "\"; one within is doubled (IEEE 1076-2008, 15.4.3).
bool IsExtended(string_view name) noexcept {
    if (name.size() < 3 || name.front() != '\\' || name.back() != '\\') {
        return false;
    }
    name = name.substr(1, name.size() - 2);
    for (std::size_t i = 0; i < name.size(); ++i) {
        if (name[i] == '\\' && (++i == name.size() || name[i] != '\\')) {
            return false;
        }
        if (!IsPrintable(name[i]) && name[i] != ' ') {
            return false;
        }
    }
    return true;
}

} // namespace

Identifier::Identifier(string_view name) noexcept {
    if (name.empty() || name.front() == '\\') {
        isVerilog = IsEscaped(name);
        isVhdl = IsExtended(name);
        return;
    }
    unsigned met = 0;
    unsigned char before = Underscore;
    for (const char c : name) {
        const unsigned char kind = ClassOf(c);
        if (kind == 0) {
            isVerilog = isVhdl = false;
            return;
        }
        met |= kind;
        if (kind == Underscore && before == Underscore) {
            hasProperUnderscores = false;
        }
        before = kind;
    }
    hasProperUnderscores = hasProperUnderscores && before != Underscore;
    const unsigned char first = ClassOf(name.front());
    isVerilog = (met & LatinLetter) == 0 && (first == Letter || first == Underscore);
    isVhdl = (met & Dollar) == 0 && first != Digit && first != Dollar;
}

} // namespace Orn_Hdl::Checking
