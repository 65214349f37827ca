// The phrases of the command language and their arguments.
#pragma once

#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Containers/StringArray.h"

#include <string>
#include <string_view>
#include <vector>

namespace Tool::Explain {

/// One phrase.
struct Phrase {
    std::vector<std::string> words;
    /// As the catalogue describes them: "<signal>", "[default]", "[-TYPE=<type>]".
    std::vector<std::string> arguments;
    const Orn_Hdl::CommandInfo* info = nullptr;

    int CountWords() const noexcept { return static_cast<int>(words.size()); }
    /// The place of the argument of that description in a line without options; -1 if there is
    /// none.
    int FindArgument(std::string_view argument) const noexcept;
};

/// All phrases.
const std::vector<Phrase>& GetPhrases();
/// The longest phrase that a line begins with; null if there is none.
const Phrase* FindPhrase(const Orn_Hdl::StringArray& words);

/// "a, b or c".
std::string JoinChoices(const std::vector<std::string>& choices, std::string_view last);

} // namespace Tool::Explain
