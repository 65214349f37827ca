/// \file
/// Pieces of written netlists.
#pragma once

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <algorithm>
#include <string>
#include <vector>

namespace Support {

/// The lines of a text that begin so once the blanks before them are taken off.
inline std::vector<std::string> LinesThatBegin(const std::string& text, const std::string& begin) {
    std::vector<std::string> found;
    for (const std::string& line : SplitLines(text)) {
        const std::size_t start = line.find_first_not_of(' ');
        if (start != std::string::npos && line.compare(start, begin.size(), begin) == 0) {
            found.push_back(line.substr(start));
        }
    }
    return found;
}

/// The lines of a text in sorted order: two netlists that differ in the order of their statements
/// only have the same.
inline std::vector<std::string> SortedLines(const std::string& text) {
    std::vector<std::string> lines = SplitLines(text);
    std::sort(lines.begin(), lines.end());
    return lines;
}

/// The piece of a text from one mark up to the next one; empty when either is missing.
inline std::string Between(const std::string& text, const std::string& from,
                           const std::string& to) {
    const std::size_t start = text.find(from);
    const std::size_t end = start == std::string::npos ? start : text.find(to, start + from.size());
    return end == std::string::npos ? std::string() : text.substr(start, end - start);
}

/// Commands that declare an inverter and instances of it, each given as "NAME INPUT OUTPUT".
inline std::string Inverters(const std::vector<std::string>& instances) {
    std::string lines = "ADD COMPONENT INV\nADD PIN INV I Input\nADD PIN INV O Output\n";
    for (const std::string& words : instances) {
        const Orn_Hdl::StringArray parts(words.c_str(), " ", true, nullptr);
        const std::string name(parts.GetView(0));
        lines += "ADD INSTANCE INV " + name + "\n";
        lines += "CONNECT SIGNAL " + std::string(parts.GetView(1)) + " " + name + ".I\n";
        lines += "CONNECT SIGNAL " + std::string(parts.GetView(2)) + " " + name + ".O\n";
    }
    return lines;
}

} // namespace Support
