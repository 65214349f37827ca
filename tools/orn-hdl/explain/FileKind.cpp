#include "explain/FileKind.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>

namespace Tool {

using std::string_view;

namespace {

struct Signature {
    string_view start;
    string_view what;
};

constexpr Signature Signatures[] = {
    {"\x1f\x8b", "this looks like a gzip file; unpack it, or let its name end in .gz"},
    {"BZh", "this looks like a bzip2 file; unpack it first"},
    {string_view("\xfd"
                 "7zXZ\0",
                 6),
     "this looks like an xz file; unpack it first"},
    {"\x28\xb5\x2f\xfd", "this looks like a Zstandard file; unpack it first"},
    {"PK\x03\x04", "this looks like a ZIP file; unpack it first"},
    {"\x7f"
     "ELF",
     "this looks like a program"},
    {"\xff\xfe", "this looks like UTF-16; save the file as UTF-8"},
    {"\xfe\xff", "this looks like UTF-16; save the file as UTF-8"},
    {"\xef\xbb\xbf", "the file begins with a byte order mark; save it without one"},
};

constexpr string_view IsVerilog =
    "this looks like Verilog; orn-hdl import --from verilog reads netlists";
constexpr string_view IsVhdl = "this looks like VHDL; orn-hdl import --from vhdl reads netlists";
constexpr string_view IsJson = "this looks like JSON; use orn-hdl import";

/// The first words of files in other languages.
constexpr Signature FirstWords[] = {
    {"module", IsVerilog},
    {"macromodule", IsVerilog},
    {"primitive", IsVerilog},
    {"`timescale", IsVerilog},
    {"`include", IsVerilog},
    {"`define", IsVerilog},
    {"`default_nettype", IsVerilog},
    {"`ifndef", IsVerilog},
    {"`ifdef", IsVerilog},
    {"(*", IsVerilog},
    {"entity", IsVhdl},
    {"architecture", IsVhdl},
    {"configuration", IsVhdl},
    {"(edif", "this looks like EDIF"},
    {".model", "this looks like BLIF"},
    {".subckt", "this looks like a SPICE netlist"},
    {"<?xml", "this looks like XML"},
    {"<", "this looks like XML"},
};

bool IsBlank(char c) {
    return c == ' ' || (c >= '\t' && c <= '\r');
}

void SkipBlanks(string_view& text) {
    while (!text.empty() && IsBlank(text.front())) {
        text.remove_prefix(1);
    }
}

bool BeginsWith(string_view text, string_view start) {
    return Port::EqualIgnoringCase(text.substr(0, start.size()), start);
}

/// Skips blanks and the comments of Verilog and VHDL.
void SkipComments(string_view& text) {
    for (SkipBlanks(text);
         BeginsWith(text, "//") || BeginsWith(text, "--") || BeginsWith(text, "/*");
         SkipBlanks(text)) {
        const bool isLong = BeginsWith(text, "/*");
        const std::size_t end = isLong ? text.find("*/", 2) : text.find('\n');
        text.remove_prefix(std::min(text.size(), end == string_view::npos ? end
                                                 : isLong                 ? end + 2
                                                                          : end + 1));
    }
}

/// The first word; brackets and signs belong to it.
string_view GetFirstWord(string_view text) {
    std::size_t end = 0;
    while (end < text.size() && !IsBlank(text[end])) {
        ++end;
    }
    return text.substr(0, end);
}

string_view GetSecondWord(string_view text) {
    text.remove_prefix(GetFirstWord(text).size());
    SkipBlanks(text);
    return GetFirstWord(text);
}

bool IsNameOf(string_view word, string_view name) {
    // "library" of VHDL is followed by a name, and of Liberty by "(".
    return Port::EqualIgnoringCase(word.substr(0, word.find('(')), name);
}

string_view DescribeWords(string_view text) {
    SkipComments(text);
    const string_view word = GetFirstWord(text);
    if (IsNameOf(word, "library")) {
        const bool isLiberty =
            word.find('(') != string_view::npos || BeginsWith(GetSecondWord(text), "(");
        return isLiberty ? string_view("this looks like a Liberty file") : IsVhdl;
    }
    for (const Signature& first : FirstWords) {
        const bool isLetter = Port::IsLetter(first.start.back());
        if (isLetter ? Port::EqualIgnoringCase(word, first.start) : BeginsWith(word, first.start)) {
            return first.what;
        }
    }
    // Braces open JSON and nothing else; "[" is also a name's first character.
    const string_view second = GetSecondWord(text);
    const bool isJson = BeginsWith(word, "{") || BeginsWith(word, "[{") ||
                        BeginsWith(word, "[\"") ||
                        (word == "[" && (BeginsWith(second, "{") || BeginsWith(second, "\"")));
    return isJson ? IsJson : string_view();
}

} // namespace

std::string DescribeFileKind(string_view beginning) {
    for (const Signature& signature : Signatures) {
        if (beginning.substr(0, signature.start.size()) == signature.start) {
            return std::string(signature.what);
        }
    }
    const string_view described = DescribeWords(beginning);
    if (described.empty() && beginning.find('\0') != string_view::npos) {
        return "this looks like a binary file";
    }
    return std::string(described);
}

} // namespace Tool
