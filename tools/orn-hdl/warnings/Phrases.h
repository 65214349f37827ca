// What the warnings need to know of the phrases of the command language.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"

#include <string_view>

namespace Tool::Phrases {

/// Whether a line begins with the words of a phrase.
bool Begins(const Orn_Hdl::StringArray& words, std::string_view phrase);
/// The number of words that the longest phrase has with which a line begins; 0 if there is none.
int CountWords(const Orn_Hdl::StringArray& words);

/// The place of the word that sets or clears a flag; 0 for any other command.
int GetFlagPosition(const Orn_Hdl::StringArray& words);
/// Whether SET SYNTHESIS knows a word.
bool IsSynthesisTool(std::string_view word);
/// Whether no netlist shows what a line does that is not for an attribute.
bool IsIneffective(const Orn_Hdl::StringArray& words);

/// Whether a line adds or sets an attribute.
bool IsForAttribute(const Orn_Hdl::StringArray& words);
/// Whether no netlist shows what a line for an attribute does.
bool IsIneffectiveForAttribute(const Orn_Hdl::StringArray& words);

/// Where a line that adds an attribute, or sets its value, has the attribute's name and value.
struct AttributePlaces {
    /// 0 for any other command.
    int name = 0;
    int value = 0;
};
/// \param words a line for an attribute.
AttributePlaces FindAttribute(const Orn_Hdl::StringArray& words);
/// Whether a word has the form of an attribute's option.
bool IsAttributeOption(std::string_view word);

} // namespace Tool::Phrases
