// Walks over a JSON text and keeps track of the place for messages.
#pragma once

#include "import/JsonTokens.h"
#include "import/TextSource.h"

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

/// A visit of a value takes this value, by one of the functions below, exactly once.
class JsonWalker {
public:
    /// \param source not owned. Nobody else may use it as long as this object exists.
    explicit JsonWalker(TextSource& source);
    /// Has the text scanned ahead on another processor. The walk is the same.
    JsonWalker(TextSource& source, const TokenBatches::Settings& settings);

    /// Calls `visit` for the value that the text is. \throws Error if the text is not JSON; the
    /// message contains the place that the walk has reached.
    template <class Visit> void Walk(const Visit& visit) {
        try {
            tokens_.CheckBeginning();
            visit();
            if (!tokens_.IsAtEnd()) {
                Fail("nothing may follow the netlist");
            }
        } catch (const JsonSyntaxError& error) {
            FailToScan(error);
        }
    }

    /// Ends the import with a message about the present place.
    [[noreturn]] void Fail(const std::string& text) const;
    /// Ends the import with a message about a member of a field of the present value.
    [[noreturn]] void FailAt(std::string_view field, std::string_view member,
                             const std::string& text);

    /// Calls `visit` with the name of each field of the present object. During the call, and when
    /// an error ends the walk, the present place includes the field. The name is valid during the
    /// call.
    template <class Visit> void ForEachField(const Visit& visit) {
        Expect(JsonTokens::Kind::Object, "an object is expected");
        if (!tokens_.TakeOpening('}')) {
            return;
        }
        do {
            const std::string_view key = EnterField(tokens_.TakeKey());
            tokens_.TakeColon();
            visit(key);
            steps_.pop_back();
        } while (tokens_.TakeSeparator('}'));
    }
    /// Calls `visit` for each element of the present list. During the call, and when an error ends
    /// the walk, the present place includes the index.
    template <class Visit> void ForEachElement(const Visit& visit) {
        Expect(JsonTokens::Kind::Array, "a list is expected");
        if (!tokens_.TakeOpening(']')) {
            return;
        }
        std::size_t index = 0;
        do {
            Enter(index++);
            visit();
            steps_.pop_back();
        } while (tokens_.TakeSeparator(']'));
    }
    /// Checks that the present value is valid JSON, and ignores it.
    void Skip();

    bool IsNumber() { return tokens_.GetKind() == JsonTokens::Kind::Number; }
    /// The present value, a text. It is valid until the walk goes on.
    std::string_view ReadText();
    std::int64_t ReadInteger();
    /// Whether an integer is not 0.
    bool ReadFlag() { return ReadInteger() != 0; }

    /// How many bytes of the text were read so far; they can be more than were walked over.
    std::size_t GetBytesRead() const noexcept { return tokens_.GetBytesRead(); }

private:
    /// More than the depth of any netlist, and far less than would overflow the stack.
    static constexpr std::size_t DeepestNesting = 200;
    /// Stands for the index in a step to a field.
    static constexpr std::size_t NoIndex = std::numeric_limits<std::size_t>::max();

    /// The path of the present value, and a text behind it.
    std::string GetMessage(const std::string& text) const;
    [[noreturn]] void FailToScan(const JsonSyntaxError& error);
    void Expect(JsonTokens::Kind kind, const char* complaint) {
        if (tokens_.GetKind() != kind) {
            Fail(complaint);
        }
    }
    std::string_view EnterField(std::string_view key);
    void Enter(std::size_t index);

    JsonTokens tokens_;
    /// The path from the top of the text to the present value: indices, or `NoIndex` for a field.
    std::vector<std::size_t> steps_;
    /// The names of the fields, by the number of the step. The texts stay where they are.
    std::vector<std::string> keys_;
};

} // namespace Tool::Import
