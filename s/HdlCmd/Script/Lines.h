// The lines of a script: words are quoted so that the command line's rule reads them back.
#pragma once

#include "HdlCmd/Script/Phrases.h"
#include "Orn_Hdl/Streams.h"

#include <initializer_list>
#include <string>
#include <string_view>

namespace Orn_Hdl::Script {

/// Throws: an object of the design is such as no command can make it.
/// \param reason a clause about the object.
[[noreturn]] void FailToExpress(std::string_view kind, std::string_view name,
                                std::string_view reason);

/// Whether words behind a phrase spell a longer phrase, so that the line is another command.
bool SpellsAnother(const Phrase& phrase, std::initializer_list<std::string_view> words);

/// Takes the lines of a script one after the other.
class Lines {
public:
    /// \param out where the lines go, not owned; null for a trial, which only finds out whether
    ///        every line can be written.
    explicit Lines(OutStream* out) noexcept : out_(out) {}
    Lines(const Lines&) = delete;
    Lines& operator=(const Lines&) = delete;

    bool IsTrial() const noexcept { return out_ == nullptr; }
    /// Writes a command. Throws if the command language has no such line.
    void Write(const Phrase& phrase, std::initializer_list<std::string_view> words);

private:
    void AppendWord(std::string_view word, bool isLast);

    OutStream* const out_;
    /// The line in hand, kept for its memory.
    std::string line_;
};

} // namespace Orn_Hdl::Script
