// Writes JSON.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace Tool {

/// Writes one value of JSON, member by member. Commas and quoting are its business; the caller ends
/// what it begins.
class JsonWriter {
public:
    JsonWriter& BeginObject() { return Begin('{'); }
    JsonWriter& EndObject() { return End('}'); }
    JsonWriter& BeginArray() { return Begin('['); }
    JsonWriter& EndArray() { return End(']'); }
    /// The name of the member that is written next.
    JsonWriter& Key(std::string_view name);
    /// A text; bytes that are no UTF-8 are read as Latin-1.
    JsonWriter& Text(std::string_view text);
    JsonWriter& Number(std::uint64_t number);
    /// The text, with a line end.
    std::string Take();

private:
    JsonWriter& Begin(char bracket);
    JsonWriter& End(char bracket);
    void Separate();
    void Quote(std::string_view text);

    std::string text_;
    bool needsComma_ = false;
};

} // namespace Tool
