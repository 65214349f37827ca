#include "explain/Additions.h"

#include "explain/Syntax.h"

#include "Port/Ascii.h"
#include "diagnostics/NameKey.h"

#include <algorithm>
#include <cstddef>
#include <string>

namespace Tool::Explain {

using Orn_Hdl::StringArray;
using std::string_view;

namespace {

/// The longest run of letters, digits and underscores of a name. A line without it does not have
/// the name, however its brackets are written.
string_view GetLongestRun(string_view name) {
    const auto isPart = [](char c) { return Port::IsLetter(c) || Port::IsDigit(c) || c == '_'; };
    string_view longest;
    for (auto start = name.begin(); start != name.end();) {
        start = std::find_if(start, name.end(), isPart);
        const auto end = std::find_if_not(start, name.end(), isPart);
        if (static_cast<std::size_t>(end - start) > longest.size()) {
            longest = name.substr(static_cast<std::size_t>(start - name.begin()),
                                  static_cast<std::size_t>(end - start));
        }
        start = end;
    }
    return longest;
}

bool Contains(string_view line, string_view part) {
    return std::search(line.begin(), line.end(), part.begin(), part.end(), [](char a, char b) {
               return Port::ToUpper(a) == Port::ToUpper(b);
           }) != line.end();
}

/// Looks for one object in the lines of a file.
class Search {
public:
    Search(ObjectKind kind, string_view name, string_view owner)
        : kind_(kind), key_(GetNameKey(name)), owner_(GetNameKey(owner)),
          run_(GetLongestRun(key_)) {}

    /// Whether a line adds the object.
    bool Find(string_view line, Addition& addition);

private:
    bool IsNamed(int index) const { return GetNameKey(words_.GetView(index)) == key_; }
    /// Whether a word names the signal, on its own or in a list.
    bool HasSignal(int index) const;
    bool FindInPhrase(string_view phrase, int first, Addition& addition) const;

    const ObjectKind kind_;
    const std::string key_;
    const std::string owner_;
    const string_view run_;
    StringArray words_;
};

bool Search::HasSignal(int index) const {
    const std::string text = GetNameKey(words_.GetView(index));
    if (text == key_) {
        return true;
    }
    for (std::size_t start = 0; start < text.size();) {
        const std::size_t end = std::min(text.find_first_of(",\\", start), text.size());
        if (text.compare(start, end - start, key_) == 0) {
            return true;
        }
        start = end + 1;
    }
    return false;
}

bool Search::FindInPhrase(string_view phrase, int first, Addition& addition) const {
    const bool isWiring = phrase == "CONNECT SIGNAL" || phrase == "ASSIGN CONSTANT";
    switch (kind_) {
    case ObjectKind::Component:
        addition.mark = Mark::Word(first);
        return phrase == "ADD COMPONENT" && IsNamed(first);
    case ObjectKind::Instance:
        addition.mark = Mark::Word(first + 1);
        return phrase == "ADD INSTANCE" && IsNamed(first + 1);
    case ObjectKind::Pin:
        addition.mark = Mark::Word(first + 1);
        return phrase == "ADD PIN" && GetNameKey(words_.GetView(first)) == owner_ &&
               IsNamed(first + 1);
    case ObjectKind::Signal:
        break;
    }
    addition.isFirstUse = isWiring;
    addition.mark = Mark::Word(first);
    if ((isWiring || phrase == "ADD PORT" || phrase == "ADD SIGNAL") && HasSignal(first)) {
        return true;
    }
    addition.mark = Mark::Word(first + 1);
    return phrase == "CONNECT SIGNAL" && HasSignal(first + 1);
}

bool Search::Find(string_view line, Addition& addition) {
    line = line.substr(0, line.find('\0'));
    if (!Contains(line, run_)) {
        return false;
    }
    words_.Empty();
    words_.ParseCommandLine(line);
    const Phrase* const phrase = FindPhrase(words_);
    return phrase != nullptr && FindInPhrase(phrase->info->phrase, phrase->CountWords(), addition);
}

} // namespace

std::optional<Addition> FindAddition(SourceLines& lines, ObjectKind kind, string_view name,
                                     string_view owner) {
    Search search(kind, name, owner);
    Addition addition;
    string_view text;
    for (addition.line = 1; lines.Get(addition.line, text); ++addition.line) {
        if (search.Find(text, addition)) {
            return addition;
        }
    }
    return std::nullopt;
}

} // namespace Tool::Explain
