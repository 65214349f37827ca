#include "import/JsonWalker.h"

#include "import/JsonPath.h"

namespace Tool::Import {

using Kind = JsonScanner::Kind;

JsonWalker::JsonWalker(TextSource& source) : scanner_(source), keys_(DeepestNesting + 1) {}

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
    throw error.hasPlace ? Error(message, scanner_.FindPlace()) : Error(message);
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
    switch (scanner_.GetKind()) {
    case Kind::Object:
        ForEachField([this](std::string_view) { Skip(); });
        break;
    case Kind::Array:
        ForEachElement([this] { Skip(); });
        break;
    case Kind::Text:
        scanner_.TakeText();
        break;
    case Kind::Number:
        scanner_.TakeNumber();
        break;
    case Kind::Word:
        scanner_.TakeWord();
        break;
    }
}

std::string_view JsonWalker::ReadText() {
    Expect(Kind::Text, "a text is expected");
    return scanner_.TakeText();
}

std::int64_t JsonWalker::ReadInteger() {
    Expect(Kind::Number, "an integer is expected");
    const JsonScanner::Number number = scanner_.TakeNumber();
    if (!number.isInteger) {
        Fail("an integer is expected");
    }
    return number.value;
}

} // namespace Tool::Import
