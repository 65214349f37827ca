#include "Port/Exception.h"

#include <string>

namespace Port {

Exception::Exception(const char* module, const char* sourceUnit, const char* revision, int line)
    : module_(module), sourceUnit_(sourceUnit), revision_(revision), line_(line) {}

Exception::Exception(const Exception&) = default;
Exception& Exception::operator=(const Exception&) = default;
Exception::~Exception() = default;

void Exception::setDescription(const char* description) {
    description_ = description;
}

String Exception::report() const {
    String text = module_;
    text += ": ";
    text += sourceUnit_;
    text += " (";
    text += revision_;
    text += "), line ";
    text += String(std::to_string(line_));
    text += ": ";
    text += description_;
    return text;
}

} // namespace Port
