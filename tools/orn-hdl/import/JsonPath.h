// Places in a JSON file, for messages, and the error that ends an import.
#pragma once

#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>

namespace Tool::Import {

/// A place in the text of a file.
struct TextPlace {
    /// The first line counts as 1; 0 if the place is not known.
    std::uint64_t line = 0;
    /// The text of the line.
    std::string source;
    /// The byte of the line; the first one counts as 0.
    std::size_t column = 0;
};

/// The file cannot be imported: `what()` names the path in the JSON and the reason.
class Error : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
    Error(const std::string& text, TextPlace place)
        : std::runtime_error(text), place_(std::move(place)) {}

    /// Where the text is no JSON; without a line for all other errors.
    const TextPlace& GetPlace() const noexcept { return place_; }

private:
    TextPlace place_;
};

/// A place in a JSON file, such as modules.top.cells["u.1"].connections.A[3].
class JsonPath {
public:
    JsonPath() = default;
    explicit JsonPath(std::string_view key) { AddKey(key); }

    JsonPath& AddKey(std::string_view key);
    JsonPath& AddIndex(std::size_t index);
    const std::string& GetText() const noexcept { return text_; }

private:
    std::string text_;
};

/// A place in a module whose path is only built for a message. Empty keys are omitted.
struct Place {
    std::string_view module;
    std::string_view table;
    std::string_view object;
    std::string_view part;
    std::string_view name;

    JsonPath ToPath() const;
};

/// A name for a message: between double quotes, on one line.
std::string Quote(std::string_view name);

/// Ends the import with the message "PATH: TEXT".
[[noreturn]] void Fail(const JsonPath& path, std::string_view text);

} // namespace Tool::Import
