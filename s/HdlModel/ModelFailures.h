// How the operations of a model fail.
#pragma once

#include "Exception/Failure.h"
#include "Port/Ascii.h"

#include <initializer_list>
#include <string_view>

namespace Orn_Hdl {

/// Throws; each "%s" of the message is replaced by the next text.
[[noreturn]] inline void FailInModel(int line, std::string_view message,
                                     std::initializer_list<std::string_view> texts = {}) {
    Fail(ModelUnit, line, message, texts);
}

/// Throws for a component, an instance or a signal that an attribute or a comment was meant for.
[[noreturn]] inline void FailNotFound(int line, const char* name) {
    FailInModel(line, "\"%s\" not found.\n", {Port::ViewOf(name)});
}

[[noreturn]] inline void FailPinNotFound(int line, std::string_view pin) {
    FailInModel(line, "Pin \"%s\" not found.\n", {pin});
}

[[noreturn]] inline void FailSignalNotFound(int line, const char* name) {
    FailInModel(line, "Signal \"%s\" not found.\n", {Port::ViewOf(name)});
}

/// Throws when there is no name at all; an empty name is one.
inline void RequireName(int line, const char* name) {
    if (name == nullptr) {
        FailInModel(line, "Invalid Name.\n");
    }
}

} // namespace Orn_Hdl
