// What goes wrong becomes an exception of Python. The package makes it, so that all classes of
// exceptions stand there.
#pragma once

#include "Ref.h"

#include "Orn_Hdl/Proof.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Python {

/// Something that the package has an exception for.
struct Failure {
    /// What the package calls it, such as "gone".
    const char* kind = "";
    /// The text, as the library has it.
    std::string text;
    /// The file concerned; empty for none.
    std::string file = {};
    /// The line in the file, from 1; 0 for none.
    std::uint64_t line = 0;
    /// The command that failed; empty for none.
    std::string command = {};
};

/// A list of tuples: the message, the line, the column and the source of each difference.
Ref MakeDifferences(const std::vector<Orn_Hdl::Proof::Difference>& differences);

/// Remembers the function of the package that makes exceptions; none for null.
void SetErrorMaker(PyObject* maker) noexcept;

/// Called while an exception of C++ is handled: sets the exception of Python for it.
void SetError() noexcept;

/// Raises what the exception of the library at hand says about a line of commands.
[[noreturn]] void RethrowForCommand(std::string command, std::string file, std::uint64_t line);

} // namespace Python
