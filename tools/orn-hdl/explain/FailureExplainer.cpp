#include "explain/FailureExplainer.h"

#include "explain/Failure.h"

#include "diagnostics/NameKey.h"

#include <optional>
#include <utility>

namespace Tool {

using std::string_view;
using namespace Explain;

namespace {

/// How many failures are explained with a search.
constexpr int MostSearches = 20;

bool Begins(string_view text, string_view start) {
    return text.substr(0, start.size()) == start;
}

/// The text between a beginning and an end; none if the message has others.
std::optional<string_view> Between(string_view message, string_view start, string_view end) {
    if (message.size() < start.size() + end.size() || !Begins(message, start) ||
        message.substr(message.size() - end.size()) != end) {
        return std::nullopt;
    }
    return message.substr(start.size(), message.size() - start.size() - end.size());
}

/// Explains a message that names something which does not exist, or exists already.
bool ExplainName(const Failure& failure, Explanation& explanation) {
    const string_view message = failure.message;
    if (const auto taken = Between(message, "Identifier \"", "\" already defined.")) {
        ExplainTaken(*taken, failure, explanation);
    } else if (const auto declared = Between(message, "Signal \"", "\" already declared.")) {
        ExplainTaken(*declared, failure, explanation);
    } else if (const auto component = Between(message, "Component \"", "\" not found.")) {
        ExplainComponent(*component, failure, explanation);
    } else if (Begins(message, "Component \"")) {
        ExplainTakenPin(failure, explanation);
    } else if (const auto signal = Between(message, "Signal \"", "\" not found.")) {
        ExplainSignal(*signal, failure, explanation);
    } else if (Begins(message, "Pin \"")) {
        ExplainPin(failure, explanation);
    } else if (const auto attribute = Between(message, "Attribute \"", "\" not found.")) {
        ExplainAttribute(*attribute, failure, explanation);
    } else if (const auto owner = Between(message, "\"", "\" not found.")) {
        ExplainOwner(*owner, failure, explanation);
    } else {
        return false;
    }
    return true;
}

void ExplainAny(const Failure& failure, Explanation& explanation) {
    const string_view message = failure.message;
    if (failure.phrase == nullptr) {
        ExplainPhrase(failure, explanation);
    } else if (message == std::string(failure.phrase->info->phrase) + ": Invalid Arguments.") {
        ExplainArguments(failure, explanation);
    } else if (message == "Invalid attribute type.") {
        ExplainAttributeType(failure, explanation);
    } else if (message == "Invalid generic value.") {
        ExplainAttributeOption(failure, explanation);
    } else if (!ExplainName(failure, explanation)) {
        ExplainFile(failure, explanation);
    }
}

} // namespace

FailureExplainer::FailureExplainer(Orn_Hdl::Model& model, CommandLines& lines)
    : model_(model), lines_(lines), searched_(lines.GetSystemName()),
      others_(lines.GetName(), lines.GetSystemName()) {}

Diagnostic FailureExplainer::Explain(std::uint64_t line, const Orn_Hdl::StringArray& words,
                                     string_view message) {
    while (!message.empty() && message.back() == '\n') {
        message.remove_suffix(1);
    }
    Explanation explanation;
    const Failure failure{
        model_, words, message, line, FindPhrase(words), searched_, searches_ < MostSearches};
    ++searches_;
    ExplainAny(failure, explanation);
    Diagnostic diagnostic;
    diagnostic.place = lines_.GetPlace(line, words, explanation.mark);
    diagnostic.message = message;
    for (Explanation::Elsewhere& note : explanation.elsewhere) {
        diagnostic.notes.push_back({std::move(note.text), others_.GetPlace(note.line, note.mark)});
    }
    for (Note& note : explanation.notes) {
        diagnostic.notes.push_back(std::move(note));
    }
    return diagnostic;
}

namespace Explain {

int Failure::FindArgument(string_view name) const {
    const std::string key = GetNameKey(name);
    for (int i = phrase == nullptr ? 0 : phrase->CountWords(); i < words.GetSize(); ++i) {
        if (GetNameKey(words.GetView(i)) == key) {
            return i;
        }
    }
    return -1;
}

std::string Show(string_view name) {
    constexpr std::size_t LongestName = 60;
    std::string shown(name.substr(0, LongestName));
    for (char& c : shown) {
        c = static_cast<unsigned char>(c) < ' ' || c == 0x7F ? '?' : c;
    }
    return name.size() > LongestName ? shown + "..." : shown;
}

void Suggest(const std::string& meant, Explanation& explanation) {
    if (!meant.empty()) {
        explanation.Say("did you mean " + Show(meant) + "?");
    }
}

} // namespace Explain

} // namespace Tool
