// Places in the files that are read, and errors at them.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers {

/// A character of a file. Lines and columns count from 1; a column is a byte. Line 0 is the file as
/// a whole.
struct Place {
    std::uint32_t file = 0;
    std::uint32_t line = 0;
    std::uint32_t column = 0;
};

/// The files of one `Read`, to which places refer.
class Files {
public:
    std::uint32_t Add(std::string name);
    const std::string& GetName(std::uint32_t file) const { return names_[file]; }

private:
    std::vector<std::string> names_;
};

/// "FILE:LINE:COLUMN", for messages that mention a second place.
std::string TextOf(const Files& files, const Place& place);

/// Throws an Orn_Hdl::Exception: the place, the text, the line of the file and a caret.
[[noreturn]] void FailAt(const Files& files, const Place& place, std::string_view text);

/// A name as messages show it, in double quotes and shortened when it is very long.
std::string Quoted(std::string_view name);

} // namespace Orn_Hdl::Readers
