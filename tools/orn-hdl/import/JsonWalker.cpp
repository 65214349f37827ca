#include "import/JsonWalker.h"

#include "import/JsonPath.h"

#include <tuple>

namespace Tool::Import {

namespace {

using simdjson::ondemand::json_type;

/// More than the depth of any netlist, and far less than would overflow the stack.
constexpr std::size_t DeepestNesting = 200;

} // namespace

void JsonWalker::Fail(const std::string& text) const {
    JsonPath path;
    for (const Step& step : steps_) {
        step.index == NoIndex ? path.AddKey(step.key) : path.AddIndex(step.index);
    }
    throw Error(path.GetText() + (steps_.empty() ? "" : ": ") + text);
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
