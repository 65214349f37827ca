#include "import/JsonWalker.h"

#include "import/JsonPath.h"

namespace Tool::Import {

using Kind = JsonTokens::Kind;

JsonWalker::JsonWalker(TextSource& source) : tokens_(source), keys_(DeepestNesting + 1) {}

JsonWalker::JsonWalker(TextSource& source, const TokenBatches::Settings& settings)
    : tokens_(source, settings), keys_(DeepestNesting + 1) {}

std::string JsonWalker::GetMessage(const std::string& text) const {
    JsonPath path;
    for (std::size_t i = 0; i < steps_.size(); ++i) {
        steps_[i] == NoIndex ? path.AddKey(keys_[i]) : path.AddIndex(steps_[i]);
    }
    return path.GetText() + (steps_.empty() ? "" : ": ") + text;
}

void JsonWalker::Fail(const std::string& text) const {
    throw Error(GetMessage(text));
}

void JsonWalker::FailToScan(const JsonSyntaxError& error) {
    const std::string text = std::string("invalid JSON: ") + error.reason;
    const std::string message = error.hasPath ? GetMessage(text) : text;
    throw error.hasPlace ? Error(message, tokens_.FindPlace()) : Error(message);
}

void JsonWalker::FailAt(std::string_view field, std::string_view member, const std::string& text) {
    EnterField(field);
    EnterField(member);
    Fail(text);
}

std::string_view JsonWalker::EnterField(std::string_view key) {
    std::string& kept = keys_[steps_.size()];
    kept = key;
    Enter(NoIndex);
    return kept;
}

void JsonWalker::Enter(std::size_t index) {
    steps_.push_back(index);
    if (steps_.size() > DeepestNesting) {
        Fail("nested too deeply");
    }
}

void JsonWalker::Skip() {
    switch (tokens_.GetKind()) {
    case Kind::Object:
        ForEachField([this](std::string_view) { Skip(); });
        break;
    case Kind::Array:
        ForEachElement([this] { Skip(); });
        break;
    case Kind::Text:
        tokens_.TakeText();
        break;
    case Kind::Number:
        tokens_.TakeNumber();
        break;
    case Kind::Word:
        tokens_.TakeWord();
        break;
    }
}

std::string_view JsonWalker::ReadText() {
    Expect(Kind::Text, "a text is expected");
    return tokens_.TakeText();
}

std::int64_t JsonWalker::ReadInteger() {
    Expect(Kind::Number, "an integer is expected");
    const JsonTokens::Number number = tokens_.TakeNumber();
    if (!number.isInteger) {
        Fail("an integer is expected");
    }
    return number.value;
}

} // namespace Tool::Import
