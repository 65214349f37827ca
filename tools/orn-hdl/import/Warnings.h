// The warnings of one import.
#pragma once

#include "import/JsonPath.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// Collects warnings. A text that applies to many places is printed once, with the first place and
/// the number of further ones.
class Warnings {
public:
    void Add(const JsonPath& path, std::string_view text);
    /// One line for each different text, in the order in which they were first added.
    std::vector<std::string> GetLines() const;

private:
    struct Warning {
        std::string path;
        std::string text;
        std::size_t count = 0;
    };

    std::vector<Warning> warnings_;
    std::unordered_map<std::string, std::size_t> index_;
};

} // namespace Tool::Import
