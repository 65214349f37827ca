#include "import/JsonWalker.h"

#include "import/JsonErrors.h"
#include "import/JsonPath.h"

#include <algorithm>
#include <tuple>

namespace Tool::Import {

namespace {

using simdjson::ondemand::json_type;

/// More than the depth of any netlist, and far less than would overflow the stack.
constexpr std::size_t DeepestNesting = 200;

constexpr std::string_view Blanks = " \t\r\n";

} // namespace

std::string JsonWalker::GetMessage(const std::string& text) const {
    JsonPath path;
    for (const Step& step : steps_) {
        step.index == NoIndex ? path.AddKey(step.key) : path.AddIndex(step.index);
    }
    return path.GetText() + (steps_.empty() ? "" : ": ") + text;
}

void JsonWalker::Fail(const std::string& text) const {
    throw Error(GetMessage(text));
}

void JsonWalker::FailToParse(simdjson::error_code error, std::string_view text,
                             simdjson::ondemand::document* document) const {
    const std::string_view read = text.substr(0, text.find_last_not_of(Blanks) + 1);
    std::size_t byte = read.size();
    const char* location = nullptr;
    if (error == simdjson::UTF8_ERROR) {
        byte = FindBadUtf8(text);
    } else if (error == simdjson::SCALAR_DOCUMENT_AS_VALUE) {
        byte = text.find_first_not_of(Blanks);
    } else if (document != nullptr &&
               document->current_location().get(location) == simdjson::SUCCESS) {
        byte = std::min(static_cast<std::size_t>(location - text.data()), read.size());
    }
    // What is found at the end of a file is that it ends.
    const bool isCut = document != nullptr && byte == read.size();
    const std::string reason = isCut ? "the file ends too early" : DescribeJsonError(error);
    const std::string message = GetMessage("invalid JSON: " + reason);
    const bool isKnown = isCut || byte < read.size();
    throw isKnown ? Error(message, FindPlace(read, byte)) : Error(message);
}

void JsonWalker::FailAt(std::string_view field, std::string_view member, const std::string& text) {
    steps_.push_back(Step{field, NoIndex});
    steps_.push_back(Step{member, NoIndex});
    Fail(text);
}

void JsonWalker::Enter(Step step) {
    steps_.push_back(step);
    if (steps_.size() > DeepestNesting) {
        Fail("nested too deeply");
    }
}

void JsonWalker::Skip(JsonValue& value) {
    switch (value.type()) {
    case json_type::object:
        ForEachField(value, [this](std::string_view, JsonValue& member) { Skip(member); });
        break;
    case json_type::array:
        ForEachElement(value, [this](JsonValue& member) { Skip(member); });
        break;
    case json_type::string:
        std::ignore = std::string_view(value.get_string());
        break;
    case json_type::number:
        std::ignore = double(value.get_double());
        break;
    case json_type::boolean:
        std::ignore = bool(value.get_bool());
        break;
    case json_type::null:
        if (!value.is_null()) {
            Fail("invalid JSON");
        }
        break;
    }
}

std::string_view JsonWalker::ReadText(JsonValue& value) const {
    if (value.type() != json_type::string) {
        Fail("a text is expected");
    }
    return value.get_string();
}

std::int64_t JsonWalker::ReadInteger(JsonValue& value) const {
    std::int64_t number = 0;
    if (value.type() != json_type::number || value.get_int64().get(number)) {
        Fail("an integer is expected");
    }
    return number;
}

} // namespace Tool::Import
