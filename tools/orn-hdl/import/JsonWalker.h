// Walks over a JSON text and keeps track of the place for messages.
#pragma once

#include <simdjson.h>

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

using JsonValue = simdjson::ondemand::value;

class JsonWalker {
public:
    /// Parses a text and calls `visit` with its value. \throws Error if the text is not JSON; the
    /// message contains the place that the walk has reached.
    template <class Visit> void Walk(std::string text, Visit visit) {
        const std::size_t size = text.size();
        text.resize(size + simdjson::SIMDJSON_PADDING);
        // The parser owns the keys of the path in a message, so it outlives the try block.
        simdjson::ondemand::parser parser;
        simdjson::ondemand::document document;
        const std::string_view json = std::string_view(text).substr(0, size);
        bool isOpen = false;
        try {
            document = parser.iterate(text.data(), size, text.size());
            isOpen = true;
            JsonValue root = document.get_value();
            visit(root);
            if (document.current_location().error() != simdjson::OUT_OF_BOUNDS) {
                Fail("nothing may follow the netlist");
            }
        } catch (const simdjson::simdjson_error& error) {
            FailToParse(error.error(), json, isOpen ? &document : nullptr);
        }
    }

    /// Ends the import with a message about the present place.
    [[noreturn]] void Fail(const std::string& text) const;
    /// Ends the import with a message about a member of a field of the present value.
    [[noreturn]] void FailAt(std::string_view field, std::string_view member,
                             const std::string& text);

    /// Calls `visit` with the name and value of each field. During the call, and when an error ends
    /// the walk, the present place includes the field.
    template <class Visit> void ForEachField(JsonValue& value, Visit visit) {
        if (value.type() != simdjson::ondemand::json_type::object) {
            Fail("an object is expected");
        }
        for (auto field : value.get_object()) {
            const std::string_view key = field.unescaped_key();
            Enter(Step{key, NoIndex});
            JsonValue member = field.value();
            visit(key, member);
            steps_.pop_back();
        }
    }
    /// Calls `visit` with each element of a list. During the call, and when an error ends the walk,
    /// the present place includes the index.
    template <class Visit> void ForEachElement(JsonValue& value, Visit visit) {
        if (value.type() != simdjson::ondemand::json_type::array) {
            Fail("a list is expected");
        }
        std::size_t index = 0;
        for (auto element : value.get_array()) {
            Enter(Step{std::string_view(), index++});
            JsonValue member = element.value();
            visit(member);
            steps_.pop_back();
        }
    }
    /// Checks that a value is valid JSON, and ignores it.
    void Skip(JsonValue& value);

    std::string_view ReadText(JsonValue& value) const;
    std::int64_t ReadInteger(JsonValue& value) const;
    /// Whether an integer is not 0.
    bool ReadFlag(JsonValue& value) const { return ReadInteger(value) != 0; }

private:
    /// A step on the path from the top of the file to the present value: a key, or an index.
    struct Step {
        std::string_view key;
        std::size_t index;
    };
    static constexpr std::size_t NoIndex = std::numeric_limits<std::size_t>::max();

    /// The path of the present value, and a text behind it.
    std::string GetMessage(const std::string& text) const;
    /// \param document null if parsing could not even begin.
    [[noreturn]] void FailToParse(simdjson::error_code error, std::string_view text,
                                  simdjson::ondemand::document* document) const;
    void Enter(Step step);

    std::vector<Step> steps_;
};

} // namespace Tool::Import
