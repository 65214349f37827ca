// Lines that begin with no phrase.
#include "explain/Failure.h"
#include "explain/FileKind.h"

#include "Port/Ascii.h"
#include "Port/File.h"
#include "diagnostics/Nearest.h"
#include "diagnostics/Words.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace Tool::Explain {

using Orn_Hdl::StringArray;
using std::string_view;

namespace {

/// More suggestions than that are no help.
constexpr std::size_t MostSuggestions = 4;

/// Words that other languages have for the same things.
struct Synonym {
    string_view words;
    string_view phrase;
};
constexpr Synonym Synonyms[] = {
    {"ADD NET", "ADD SIGNAL"},
    {"ADD WIRE", "ADD SIGNAL"},
    {"ADD BUS", "ADD SIGNAL"},
    {"ADD CELL", "ADD COMPONENT"},
    {"ADD MODULE", "ADD COMPONENT"},
    {"ADD ENTITY", "ADD COMPONENT"},
    {"ADD INST", "ADD INSTANCE"},
    {"ADD INPUT", "ADD PORT"},
    {"ADD OUTPUT", "ADD PORT"},
    {"ADD ATTR", "ADD MODULE ATTRIBUTE"},
    {"CONNECT NET", "CONNECT SIGNAL"},
    {"CONNECT WIRE", "CONNECT SIGNAL"},
    {"CONNECT PIN", "CONNECT SIGNAL"},
    {"ASSIGN SIGNAL", "CONNECT SIGNAL"},
    {"ASSIGN PIN", "ASSIGN CONSTANT"},
    {"SET TOP", "SET NETLIST NAME"},
    {"SET NAME", "SET NETLIST NAME"},
    {"WRITE NETLIST", "WRITE VERILOG"},
    {"WRITE SYSTEMVERILOG", "WRITE VERILOG"},
};

std::string ToUpper(string_view text) {
    std::string upper(text);
    std::transform(upper.begin(), upper.end(), upper.begin(), Port::ToUpper);
    return upper;
}

std::string GetText(const Phrase& phrase) {
    return phrase.info->phrase;
}

/// How many words of the line a phrase begins with.
int CountCommonWords(const StringArray& words, const Phrase& phrase) {
    int count = 0;
    while (count < phrase.CountWords() &&
           IsWord(words, count, phrase.words[static_cast<std::size_t>(count)])) {
        ++count;
    }
    return count;
}

/// How many changes make the line begin with the phrase; 0 if each word needs too many.
std::size_t GetDistance(const StringArray& words, const Phrase& phrase) {
    if (words.GetSize() < phrase.CountWords()) {
        return 0;
    }
    std::size_t distance = 0;
    for (int i = 0; i < phrase.CountWords(); ++i) {
        const std::string& meant = phrase.words[static_cast<std::size_t>(i)];
        if (!IsWord(words, i, meant)) {
            NearestWord nearest(words.GetView(i));
            nearest.Consider(meant);
            if (nearest.Get().empty()) {
                return 0;
            }
            distance += nearest.GetDistance();
        }
    }
    return distance;
}

/// The phrase whose words are all spelt nearly as those of the line; empty if there is none.
std::string FindMisspelt(const StringArray& words) {
    const Phrase* nearest = nullptr;
    std::size_t least = 0;
    for (const Phrase& phrase : GetPhrases()) {
        const std::size_t distance = GetDistance(words, phrase);
        const bool isLonger =
            nearest != nullptr && phrase.CountWords() > nearest->CountWords() && distance == least;
        if (distance != 0 && (nearest == nullptr || distance < least || isLonger)) {
            nearest = &phrase;
            least = distance;
        }
    }
    return nearest == nullptr ? std::string() : GetText(*nearest);
}

/// The phrase that the first word is with its blanks left out, or other signs in their place.
std::string FindJoined(const StringArray& words) {
    const auto isSign = [](char c) { return c == '_' || c == '-' || c == '.'; };
    std::string joined(words.GetView(0));
    joined.erase(std::remove_if(joined.begin(), joined.end(), isSign), joined.end());
    for (const Phrase& phrase : GetPhrases()) {
        std::string text = GetText(phrase);
        text.erase(std::remove(text.begin(), text.end(), ' '), text.end());
        if (Port::EqualIgnoringCase(text, joined)) {
            return GetText(phrase);
        }
    }
    return {};
}

std::string FindSynonym(const StringArray& words) {
    const std::string two = std::string(words.GetView(0)).append(" ").append(words.GetView(1));
    for (const Synonym& synonym : Synonyms) {
        if (Port::EqualIgnoringCase(two, synonym.words)) {
            return std::string(synonym.phrase);
        }
    }
    return {};
}

/// Whether the line begins with all words of a phrase but one.
bool LacksOneWord(const StringArray& words, const Phrase& phrase) {
    const int common = CountCommonWords(words, phrase);
    if (common == 0 || common == phrase.CountWords()) {
        return false;
    }
    for (int i = common + 1; i < phrase.CountWords(); ++i) {
        if (!IsWord(words, i - 1, phrase.words[static_cast<std::size_t>(i)])) {
            return false;
        }
    }
    return true;
}

/// The longest phrases of which one word is missing.
std::vector<std::string> FindIncomplete(const StringArray& words) {
    std::vector<std::string> found;
    int longest = 0;
    for (const Phrase& phrase : GetPhrases()) {
        if (!LacksOneWord(words, phrase) || phrase.CountWords() < longest) {
            continue;
        }
        if (phrase.CountWords() > longest) {
            longest = phrase.CountWords();
            found.clear();
        }
        found.push_back(GetText(phrase));
    }
    return found.size() > MostSuggestions ? std::vector<std::string>() : found;
}

std::vector<std::string> FindMeant(const StringArray& words) {
    for (const std::string& found : {FindJoined(words), FindSynonym(words), FindMisspelt(words)}) {
        if (!found.empty()) {
            return {found};
        }
    }
    return FindIncomplete(words);
}

int CountKnownWords(const StringArray& words) {
    int known = 0;
    for (const Phrase& phrase : GetPhrases()) {
        known = std::max(known, CountCommonWords(words, phrase));
    }
    return known;
}

/// The words that may stand at a place, behind words that the line has.
std::vector<std::string> GetNextWords(const StringArray& words, int place) {
    std::vector<std::string> next;
    for (const Phrase& phrase : GetPhrases()) {
        if (place < phrase.CountWords() && CountCommonWords(words, phrase) >= place) {
            const std::string word = ToUpper(phrase.words[static_cast<std::size_t>(place)]);
            if (std::find(next.begin(), next.end(), word) == next.end()) {
                next.push_back(word);
            }
        }
    }
    return next;
}

bool IsComment(string_view word) {
    constexpr std::array<string_view, 6> Starts = {"#", "//", "--", "/*", ";", "%"};
    return std::any_of(Starts.begin(), Starts.end(),
                       [&](string_view start) { return word.substr(0, start.size()) == start; });
}

/// The beginning of a file.
std::string ReadBeginning(const std::string& name) {
    constexpr std::size_t Size = 4096;
    std::string text;
    Port::File file;
    if (CanReadAgain(name) && file.open(name.c_str(), Port::File::Read, true)) {
        text.resize(Size);
        text.resize(file.read(text.data(), Size));
    }
    return text;
}

/// Says what the file is, if its first line fails.
bool ExplainFileKind(const Failure& failure, Explanation& explanation) {
    std::string beginning = ReadBeginning(failure.lines.GetName());
    if (beginning.empty() && failure.line == 1) {
        beginning = JoinWords(failure.words);
    }
    const std::size_t first = std::min(beginning.find_first_not_of(" \r\n"), beginning.size());
    const auto linesBefore =
        std::count(beginning.begin(), beginning.begin() + static_cast<std::ptrdiff_t>(first), '\n');
    if (failure.line != static_cast<std::uint64_t>(linesBefore) + 1) {
        return false;
    }
    const std::string kind = DescribeFileKind(beginning);
    if (!kind.empty()) {
        explanation.Say(kind);
    }
    return !kind.empty();
}

} // namespace

void ExplainPhrase(const Failure& failure, Explanation& explanation) {
    const StringArray& words = failure.words;
    if (ExplainFileKind(failure, explanation)) {
        return;
    }
    const int known = CountKnownWords(words);
    explanation.mark = Mark::Word(known);
    if (IsComment(words.GetView(0))) {
        explanation.Say("a comment line begins with NOOP");
        return;
    }
    if (words.GetView(0).find('\t') != string_view::npos) {
        explanation.Say("words are separated by spaces; this one has a tab in it");
        return;
    }
    const std::vector<std::string> meant = FindMeant(words);
    if (!meant.empty()) {
        explanation.Say("did you mean " + JoinChoices(meant, "or") + "?");
    } else if (known > 0) {
        std::string text;
        for (int i = 0; i < known; ++i) {
            text.append(ToUpper(words.GetView(i))).append(" ");
        }
        explanation.Say(text + "is followed by " + JoinChoices(GetNextWords(words, known), "or"));
    } else {
        explanation.Say("\"orn-hdl commands\" lists all commands");
    }
}

} // namespace Tool::Explain
