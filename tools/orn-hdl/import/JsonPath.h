// Places in a JSON file, for messages, and the error that ends an import.
#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Tool::Import {

/// The file cannot be imported: `what()` names the place in the file and the reason.
class Error : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
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
