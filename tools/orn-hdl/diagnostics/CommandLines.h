// The lines of a command file that messages are about.
#pragma once

#include "diagnostics/Diagnostic.h"
#include "diagnostics/SourceLines.h"
#include "diagnostics/WordPlaces.h"

#include "Orn_Hdl/Containers/StringArray.h"

#include <cstdint>
#include <optional>
#include <string>

namespace Tool {

/// Makes the places of messages about a command file that is being replayed. The file is read again
/// when the first place is made; a line of a pipe is put together from its words.
class CommandLines {
public:
    /// \param file the file, as the user named it.
    /// \param systemName the name under which the system opens it.
    CommandLines(const std::string& file, const std::string& systemName)
        : file_(file), lines_(systemName) {}

    /// The place of a line that was split into these words.
    Place GetPlace(std::uint64_t line, const Orn_Hdl::StringArray& words,
                   const std::optional<Mark>& mark = {});
    /// The place of a line whose words are not known.
    Place GetPlace(std::uint64_t line, const std::optional<Mark>& mark = {});

    /// The file, as the user named it.
    const std::string& GetName() const noexcept { return file_; }
    /// The absolute name of the file, for reading it again.
    const std::string& GetSystemName() const noexcept { return lines_.GetName(); }

private:
    const std::string file_;
    SourceLines lines_;
};

} // namespace Tool
