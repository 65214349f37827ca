#include "warnings/Phrases.h"

#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <algorithm>
#include <array>
#include <iterator>
#include <string>

namespace Tool::Phrases {

namespace {

using Orn_Hdl::StringArray;
using std::string_view;

/// The commands whose last word is a flag.
constexpr std::array<string_view, 5> Flags = {"FLATTEN BUS", "SUPPRESS CONFIGURATION",
                                              "SUPPRESS COMPONENT", "USE DEFAULT LIBRARY",
                                              "SET OPEN PIN"};

/// The commands that change nothing in any output, but for those for attributes.
constexpr std::array<string_view, 5> Ineffective = {
    "FLATTEN BUS", "SET SOURCE FILE", "SET PORT ONEPERLINE", "ADD COMPONENT PIN COMMENT",
    "ADD INSTANCE PIN COMMENT"};

/// The place of the word ATTRIBUTE: behind the kind of its owner.
int GetAttributeWord(const StringArray& words) {
    return IsWord(words, 2, "PIN") ? 3 : 2;
}

bool BeginsWith(string_view word, string_view start) {
    return Port::EqualIgnoringCase(word.substr(0, start.size()), start);
}

/// Whether each option of a command, one or two, begins so.
bool SetsOnly(const StringArray& words, int first, string_view option) {
    for (int i = first; i < std::min(words.GetSize(), first + 2); ++i) {
        if (!BeginsWith(words.GetView(i), option)) {
            return false;
        }
    }
    return words.GetSize() > first;
}

} // namespace

bool Begins(const StringArray& words, string_view phrase) {
    int index = 0;
    while (!phrase.empty()) {
        const std::size_t end = std::min(phrase.find(' '), phrase.size());
        if (!Port::EqualIgnoringCase(words.GetView(index++), phrase.substr(0, end))) {
            return false;
        }
        phrase.remove_prefix(std::min(end + 1, phrase.size()));
    }
    return true;
}

int CountWords(const StringArray& words) {
    std::ptrdiff_t longest = 0;
    for (const Orn_Hdl::CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
        const string_view phrase = command.phrase;
        if (Begins(words, phrase)) {
            longest = std::max(longest, std::count(phrase.begin(), phrase.end(), ' ') + 1);
        }
    }
    return static_cast<int>(longest);
}

int GetFlagPosition(const StringArray& words) {
    const auto* const flag = std::find_if(
        Flags.begin(), Flags.end(), [&](string_view phrase) { return Begins(words, phrase); });
    return flag == Flags.end() ? 0
                               : static_cast<int>(std::count(flag->begin(), flag->end(), ' ')) + 1;
}

bool IsSynthesisTool(string_view word) {
    using Options = Orn_Hdl::HdlOptions::VerilogOption;
    Options options;
    options.SetSynthesisType(std::string(word).c_str());
    return options.synthesisType != Options::QSN || Port::EqualIgnoringCase(word, "QSN");
}

bool IsIneffective(const StringArray& words) {
    return std::any_of(Ineffective.begin(), Ineffective.end(),
                       [&](string_view phrase) { return Begins(words, phrase); });
}

bool IsForAttribute(const StringArray& words) {
    return IsWord(words, GetAttributeWord(words), "ATTRIBUTE") &&
           (IsWord(words, 0, "SET") || IsWord(words, 0, "ADD"));
}

bool IsIneffectiveForAttribute(const StringArray& words) {
    constexpr int Operation = 3;
    if (IsWord(words, 2, "PIN")) {
        return true;
    }
    if (!IsWord(words, Operation, "OPTION") || !IsWord(words, 0, "SET")) {
        return false;
    }
    // Neither language writes the module's attributes by their synthesis option, nor those of
    // signals by their generic option.
    return (IsWord(words, 1, "MODULE") && SetsOnly(words, Operation + 2, "-SYNATTR=")) ||
           (IsWord(words, 1, "SIGNAL") && SetsOnly(words, Operation + 3, "-GENERIC="));
}

AttributePlaces FindAttribute(const StringArray& words) {
    const bool isSet = IsWord(words, 0, "SET");
    const int attribute = GetAttributeWord(words);
    if (isSet && !IsWord(words, attribute + 1, "VALUE")) {
        return {};
    }
    int name = attribute + (isSet ? 2 : 1) + (IsWord(words, 1, "MODULE") ? 0 : 1);
    if (!isSet && BeginsWith(words.GetView(name), "-TYPE=")) {
        ++name;
    }
    return {name, name + 1};
}

bool IsAttributeOption(string_view word) {
    return BeginsWith(word, "-TYPE=") || BeginsWith(word, "-GENERIC=") ||
           BeginsWith(word, "-SYNATTR=");
}

} // namespace Tool::Phrases
