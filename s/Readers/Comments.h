// Comments of netlists: their words, and the lines that become comments of objects.
#pragma once

#include "Readers/Place.h"

#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers {

/// A comment without its delimiters.
struct Comment {
    std::string text;
    bool isBlock = false;
    Place place;
};

/// The text without blanks and line ends at its ends.
std::string_view Trim(std::string_view text);
/// Takes the first word off a text.
std::string_view TakeWord(std::string_view& text);
/// The first words of a text, at most seven.
std::vector<std::string_view> FirstWords(std::string_view text);

/// Whether a comment hides what follows it from synthesis ("synopsys translate_off") or ends that.
/// \param isHidden becomes true or false for such a comment.
/// \param obeysAll whether the words of all dialects count, or those that the check's tools obey.
bool TakeSwitch(std::string_view text, bool& isHidden, bool obeysAll = true);

/// Adds the lines of a comment to a list; empty ones are left out.
void AddLines(const Comment& comment, std::vector<std::string>& lines);
/// Drops the banner that opens a netlist that this library has written: it begins with a divider of
/// nothing but the character and ends with the text below the line "Reference", which is indented.
void DropBanner(std::vector<std::string>& lines, char divider);

} // namespace Orn_Hdl::Readers
