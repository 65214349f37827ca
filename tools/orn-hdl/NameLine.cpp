#include "NameLine.h"

#include "Port/File.h"

namespace Tool {

namespace {

/// A field of the table; characters that separate fields and lines are written as \t and \n, a
/// backslash as \\.
std::string Escape(std::string_view text) {
    std::string result;
    for (const char c : text) {
        switch (c) {
        case '\t':
            result += "\\t";
            break;
        case '\n':
            result += "\\n";
            break;
        case '\\':
            result += "\\\\";
            break;
        default:
            result += c;
        }
    }
    return result;
}

} // namespace

void WriteNameLine(Port::Stream& out, std::string_view kind, std::string_view oldName,
                   std::string_view newName) {
    out << kind << "\t" << Escape(oldName) << "\t" << newName << "\n";
}

std::string JoinNames(std::string_view owner, std::string_view name) {
    return std::string(owner).append(".").append(name);
}

} // namespace Tool
