// The classes of characters in Verilog source text.
#pragma once

#include <array>
#include <string_view>

namespace Orn_Hdl::Readers {

class Characters {
public:
    /// A letter, a digit, "_" or "$".
    static bool IsInName(char c) noexcept { return Has(c, NamePart); }
    /// A letter or "_".
    static bool BeginsName(char c) noexcept { return Has(c, NameBegin); }
    static bool IsDigit(char c) noexcept { return Has(c, Digit); }
    /// A blank, tab or the end of a line.
    static bool IsBlank(char c) noexcept { return Has(c, Blank); }
    /// A character in a statement that is nothing but one, whatever stands around it.
    static bool IsPlain(char c) noexcept { return !Has(c, Special); }
    /// A character of the digits of a based number.
    static bool IsInNumber(char c) noexcept { return Has(c, NumberPart); }

    /// Whether a name needs no backslash and has no "$".
    static bool IsSimple(std::string_view name) noexcept {
        if (name.empty() || !BeginsName(name.front())) {
            return false;
        }
        for (const char c : name) {
            if (!IsInName(c) || c == '$') {
                return false;
            }
        }
        return true;
    }

private:
    static constexpr unsigned char NamePart = 1;
    static constexpr unsigned char NameBegin = 2;
    static constexpr unsigned char Digit = 4;
    static constexpr unsigned char Blank = 8;
    static constexpr unsigned char NumberPart = 16;
    static constexpr unsigned char Special = 32;

    static constexpr std::array<unsigned char, 256> MakeTable() {
        std::array<unsigned char, 256> table{};
        for (const char letter : std::string_view("abcdefghijklmnopqrstuvwxyz")) {
            table[static_cast<unsigned char>(letter)] = NamePart | NameBegin;
            table[static_cast<unsigned char>(letter - 'a' + 'A')] = NamePart | NameBegin;
        }
        for (const char digit : std::string_view("0123456789")) {
            table[static_cast<unsigned char>(digit)] = NamePart | Digit | NumberPart;
        }
        for (const char digit : std::string_view("abcdefxzABCDEFXZ")) {
            table[static_cast<unsigned char>(digit)] |= NumberPart;
        }
        table['?'] = NumberPart;
        table['_'] = NamePart | NameBegin | NumberPart;
        table['$'] = NamePart;
        for (const char blank : std::string_view(" \t\r\n\f\v")) {
            table[static_cast<unsigned char>(blank)] = Blank;
        }
        for (const char special : std::string_view("\0\n;/`\"\\", 7)) {
            table[static_cast<unsigned char>(special)] |= Special;
        }
        return table;
    }

    static bool Has(char c, unsigned char property) noexcept {
        static constexpr std::array<unsigned char, 256> Table = MakeTable();
        return (Table[static_cast<unsigned char>(c)] & property) != 0;
    }
};

} // namespace Orn_Hdl::Readers
