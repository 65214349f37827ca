#include "explain/Syntax.h"

#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <algorithm>
#include <cstddef>

namespace Tool::Explain {

using Orn_Hdl::StringArray;
using std::string_view;

namespace {

/// Splits a description at the blanks outside of brackets.
std::vector<std::string> SplitArguments(string_view text) {
    std::vector<std::string> arguments;
    int depth = 0;
    bool isNew = true;
    for (const char c : text) {
        depth += c == '<' || c == '[' ? 1 : c == '>' || c == ']' ? -1 : 0;
        if (c == ' ' && depth == 0) {
            isNew = true;
            continue;
        }
        if (isNew) {
            arguments.emplace_back();
            isNew = false;
        }
        arguments.back() += c;
    }
    return arguments;
}

Phrase MakePhrase(const Orn_Hdl::CommandInfo& info) {
    Phrase phrase;
    const StringArray words(info.phrase, " ", true, nullptr);
    for (const string_view word : words) {
        phrase.words.emplace_back(word);
    }
    phrase.arguments = SplitArguments(info.arguments);
    phrase.info = &info;
    return phrase;
}

bool BeginsWith(const StringArray& words, const Phrase& phrase) {
    for (int i = 0; i < phrase.CountWords(); ++i) {
        if (!IsWord(words, i, phrase.words[static_cast<std::size_t>(i)])) {
            return false;
        }
    }
    return true;
}

} // namespace

int Phrase::FindArgument(string_view argument) const noexcept {
    const auto found = std::find(arguments.begin(), arguments.end(), argument);
    return found == arguments.end() ? -1
                                    : CountWords() + static_cast<int>(found - arguments.begin());
}

const std::vector<Phrase>& GetPhrases() {
    static const std::vector<Phrase> phrases = [] {
        std::vector<Phrase> all;
        for (const Orn_Hdl::CommandInfo& info : Orn_Hdl::CommandFactory::GetCatalogue()) {
            all.push_back(MakePhrase(info));
        }
        return all;
    }();
    return phrases;
}

const Phrase* FindPhrase(const StringArray& words) {
    const Phrase* longest = nullptr;
    for (const Phrase& phrase : GetPhrases()) {
        if (BeginsWith(words, phrase) &&
            (longest == nullptr || phrase.CountWords() > longest->CountWords())) {
            longest = &phrase;
        }
    }
    return longest;
}

std::string JoinChoices(const std::vector<std::string>& choices, string_view last) {
    std::string text;
    for (std::size_t i = 0; i < choices.size(); ++i) {
        if (i > 0) {
            text.append(i + 1 == choices.size() ? " " + std::string(last) + " " : ", ");
        }
        text.append(choices[i]);
    }
    return text;
}

} // namespace Tool::Explain
