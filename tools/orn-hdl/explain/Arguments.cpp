// Lines whose arguments are missing or wrong.
#include "explain/Failure.h"

#include "Orn_Hdl/Model/Pins.h"
#include "Port/Ascii.h"
#include "diagnostics/Nearest.h"

#include <algorithm>
#include <cstddef>

namespace Tool::Explain {

using Orn_Hdl::StringArray;
using std::string_view;

namespace {

constexpr string_view TypeOption = "-TYPE=";

bool IsOption(string_view word, string_view option) {
    return Port::EqualIgnoringCase(word.substr(0, option.size()), option);
}

bool IsRequired(const std::string& argument) {
    return argument.front() == '<';
}

bool IsPinPath(const std::string& argument) {
    return argument.find(".pin>") != std::string::npos && argument.find('|') == std::string::npos;
}

/// The phrase with its arguments, as "orn-hdl commands" shows it.
std::string GetSynopsis(const Phrase& phrase) {
    return std::string(phrase.info->phrase) + " " + phrase.info->arguments;
}

/// The required arguments, each with its place in a line. An option that is given takes a place.
struct Required {
    const std::string* argument;
    int place;
};

std::vector<Required> GetRequired(const Phrase& phrase, const StringArray& words) {
    std::vector<Required> required;
    int place = phrase.CountWords();
    for (const std::string& argument : phrase.arguments) {
        const bool isType = argument.find(TypeOption) != std::string::npos;
        if (IsRequired(argument)) {
            required.push_back({&argument, place++});
        } else if (isType && IsOption(words.GetView(place), TypeOption)) {
            ++place;
        }
    }
    return required;
}

/// Says which required argument is missing, or else, if `mayBeEmpty` is false, which is empty.
/// \return whether there is one.
bool ExplainMissing(const Failure& failure, bool mayBeEmpty, Explanation& explanation) {
    const StringArray& words = failure.words;
    for (const auto& [argument, place] : GetRequired(*failure.phrase, words)) {
        const bool isMissing = place >= words.GetSize();
        if (isMissing || (!mayBeEmpty && words.GetView(place).empty())) {
            explanation.mark = Mark::Word(place);
            explanation.Say(*argument + (isMissing ? " is missing: " : " is empty: ") +
                            GetSynopsis(*failure.phrase));
            return true;
        }
    }
    return false;
}

bool IsDirection(string_view text) {
    return Orn_Hdl::Polarity(std::string(text).c_str()).IsValid();
}

std::string GetMeantDirection(string_view word) {
    if (Port::EqualIgnoringCase(word, "inout") || Port::EqualIgnoringCase(word, "io")) {
        return "bidirectional";
    }
    return GetNearest(word, {"input", "output", "bidirectional"});
}

bool ExplainDirection(const Failure& failure, Explanation& explanation) {
    const Phrase& phrase = *failure.phrase;
    const int place =
        std::max(phrase.FindArgument("<direction>"), phrase.FindArgument("[direction]"));
    if (place < 0 || place >= failure.words.GetSize()) {
        return false;
    }
    const string_view word = failure.GetWord(place);
    explanation.mark = Mark::Word(place);
    explanation.Say("a direction is input, output or bidirectional");
    if (IsDirection(failure.GetWord(place - 1))) {
        explanation.Say("the order is " + GetSynopsis(phrase));
    } else {
        Suggest(GetMeantDirection(word), explanation);
    }
    return true;
}

/// "a|b|c" as a list.
std::vector<std::string> SplitChoices(string_view text) {
    std::vector<std::string> choices;
    for (std::size_t start = 0; start <= text.size();) {
        const std::size_t end = std::min(text.find('|', start), text.size());
        choices.emplace_back(text.substr(start, end - start));
        start = end + 1;
    }
    return choices;
}

/// UPPERCASE and LOWERCASE.
bool ExplainCase(const Failure& failure, Explanation& explanation) {
    const Phrase& phrase = *failure.phrase;
    if (phrase.CountWords() != 1 || phrase.arguments.empty()) {
        return false;
    }
    const std::string& argument = phrase.arguments.front();
    const int place = phrase.CountWords();
    const std::vector<std::string> choices =
        SplitChoices(string_view(argument).substr(1, argument.size() - 2));
    const std::string meant = GetNearest(failure.GetWord(place), choices);
    explanation.mark = Mark::Word(place);
    explanation.Say("the word is " + JoinChoices(choices, "or"));
    if (Port::EqualIgnoringCase(failure.GetWord(place), "signal")) {
        explanation.Say("did you mean siganl? It is spelt so in this command");
    } else {
        Suggest(meant, explanation);
    }
    return true;
}

/// A word without "." in the place of component.pin or instance.pin.
bool ExplainPinPath(const Failure& failure, Explanation& explanation) {
    const Phrase& phrase = *failure.phrase;
    for (std::size_t i = 0; i < phrase.arguments.size(); ++i) {
        const int place = phrase.CountWords() + static_cast<int>(i);
        if (IsPinPath(phrase.arguments[i]) &&
            failure.GetWord(place).find('.') == string_view::npos) {
            explanation.mark = Mark::Word(place);
            explanation.Say("a pin is written as " + phrase.arguments[i]);
            return true;
        }
    }
    return false;
}

/// The options of an attribute.
bool ExplainOption(const Failure& failure, Explanation& explanation) {
    const int first = failure.phrase->FindArgument("<option>");
    for (int place = first; first > 0 && place < failure.words.GetSize(); ++place) {
        const string_view word = failure.GetWord(place);
        if (!IsOption(word, "-GENERIC=") && !IsOption(word, "-SYNATTR=")) {
            explanation.mark = Mark::Word(place);
            explanation.Say("an option is -GENERIC=NONE, SYN or NOSYN, or "
                            "-SYNATTR=NONE, ASSIGN or ASSIGNNODEC");
            return true;
        }
    }
    return false;
}

} // namespace

void ExplainArguments(const Failure& failure, Explanation& explanation) {
    const bool isExplained =
        ExplainMissing(failure, true, explanation) || ExplainDirection(failure, explanation) ||
        ExplainCase(failure, explanation) || ExplainPinPath(failure, explanation) ||
        ExplainOption(failure, explanation) || ExplainMissing(failure, false, explanation);
    if (!isExplained) {
        explanation.Say("the arguments are " + GetSynopsis(*failure.phrase));
    }
}

} // namespace Tool::Explain
