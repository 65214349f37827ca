#include "HdlCmd/Script/Lines.h"

#include "Exception/Failure.h"
#include "Port/Ascii.h"

#include <algorithm>

namespace Orn_Hdl::Script {

namespace {

constexpr char Quote = '"';
constexpr char Backslash = '\\';

bool NeedsQuotes(std::string_view word, bool isLast) noexcept {
    return word.empty() || word.front() == Quote || word.front() == '\'' ||
           word.find(' ') != std::string_view::npos ||
           // It would be taken for a part of the line's end.
           (isLast && word.back() == '\r');
}

bool IsEnded(std::string_view text) noexcept {
    return text.find('\n') != std::string_view::npos || text.find('\0') != std::string_view::npos;
}

} // namespace

void FailToExpress(std::string_view kind, std::string_view name, std::string_view reason) {
    Fail(CommandUnit, __LINE__, "No command can express %s \"%s\": %s.\n", {kind, name, reason});
}

bool SpellsAnother(const Phrase& phrase, std::initializer_list<std::string_view> words) {
    if (phrase.continuations.empty()) {
        return false;
    }
    std::string spelt;
    for (const std::string_view word : words) {
        spelt.append(spelt.empty() ? "" : " ").append(word);
        const auto isSpelt = [&spelt](std::string_view continuation) {
            return Port::EqualIgnoringCase(continuation, spelt);
        };
        if (std::any_of(phrase.continuations.begin(), phrase.continuations.end(), isSpelt)) {
            return true;
        }
    }
    return false;
}

void Lines::Write(const Phrase& phrase, std::initializer_list<std::string_view> words) {
    line_ = phrase.text;
    for (const std::string_view& word : words) {
        AppendWord(word, &word + 1 == words.end());
    }
    if (out_ != nullptr) {
        line_ += '\n';
        *out_ << line_;
    } else if (SpellsAnother(phrase, words)) {
        FailToExpress("the line", line_, "its words begin another command");
    }
}

void Lines::AppendWord(std::string_view word, bool isLast) {
    if (IsEnded(word)) {
        FailToExpress("the line", line_, "the text behind it contains a line feed or a NUL");
    }
    line_ += ' ';
    if (!NeedsQuotes(word, isLast)) {
        line_ += word;
        return;
    }
    line_ += Quote;
    for (const char c : word) {
        if (c == Quote) {
            line_ += Backslash;
        }
        line_ += c;
    }
    if (!word.empty() && word.back() == Backslash) {
        // The backslash would escape the closing quote, which the end of a line does not need.
        if (!isLast) {
            FailToExpress("the line", line_, "a quoted word ends in a backslash");
        }
        return;
    }
    line_ += Quote;
    if (word.empty() && isLast) {
        // An empty word counts only if something follows it.
        line_ += " \"\"";
    }
}

} // namespace Orn_Hdl::Script
