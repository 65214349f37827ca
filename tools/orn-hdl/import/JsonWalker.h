// Walks over a JSON text and keeps track of the place for messages.
#pragma once

#include "import/JsonScanner.h"
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
    /// \param source not owned.
    explicit JsonWalker(TextSource& source);

    /// Calls `visit` for the value that the text is. \throws Error if the text is not JSON; the
    /// message contains the place that the walk has reached.
    template <class Visit> void Walk(const Visit& visit) {
        try {
            scanner_.CheckBeginning();
            visit();
            if (!scanner_.IsAtEnd()) {
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
        Expect(JsonScanner::Kind::Object, "an object is expected");
        if (!scanner_.TakeOpening('}')) {
            return;
        }
        do {
            const std::string_view key = EnterField(scanner_.TakeKey());
            scanner_.TakeColon();
            visit(key);
            steps_.pop_back();
        } while (scanner_.TakeSeparator('}'));
    }
    /// Calls `visit` for each element of the present list. During the call, and when an error ends
    /// the walk, the present place includes the index.
    template <class Visit> void ForEachElement(const Visit& visit) {
        Expect(JsonScanner::Kind::Array, "a list is expected");
        if (!scanner_.TakeOpening(']')) {
            return;
        }
        std::size_t index = 0;
        do {
            Enter(index++);
            visit();
            steps_.pop_back();
        } while (scanner_.TakeSeparator(']'));
    }
    /// Checks that the present value is valid JSON, and ignores it.
    void Skip();

    bool IsNumber() { return scanner_.GetKind() == JsonScanner::Kind::Number; }
    /// The present value, a text. It is valid until the walk goes on.
    std::string_view ReadText();
    std::int64_t ReadInteger();
    /// Whether an integer is not 0.
    bool ReadFlag() { return ReadInteger() != 0; }

    /// How many bytes of the text were read so far.
    std::size_t GetBytesRead() const noexcept { return scanner_.GetBytesRead(); }

private:
    /// More than the depth of any netlist, and far less than would overflow the stack.
    static constexpr std::size_t DeepestNesting = 200;
    /// Stands for the index in a step to a field.
    static constexpr std::size_t NoIndex = std::numeric_limits<std::size_t>::max();

    /// The path of the present value, and a text behind it.
    std::string GetMessage(const std::string& text) const;
    [[noreturn]] void FailToScan(const JsonSyntaxError& error);
    void Expect(JsonScanner::Kind kind, const char* complaint) {
        if (scanner_.GetKind() != kind) {
            Fail(complaint);
        }
    }
    std::string_view EnterField(std::string_view key);
    void Enter(std::size_t index);

    JsonScanner scanner_;
    /// The path from the top of the text to the present value: indices, or `NoIndex` for a field.
    std::vector<std::size_t> steps_;
    /// The names of the fields, by the number of the step. The texts stay where they are.
    std::vector<std::string> keys_;
};

} // namespace Tool::Import
