/// \file
/// `Port::Exception`, the base of the library's exception: where it was raised, and what happened.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <exception>

namespace Port {

/// Carries the module, source unit, revision and line that raised it, and a description.
class ORN_HDL_API Exception : public std::exception {
public:
    /// An exception without a description. The texts are copied; null is read as "".
    Exception(const char* module, const char* sourceUnit, const char* revision, int line);
    /// An independent copy.
    Exception(const Exception&);
    /// Copies place and description.
    Exception& operator=(const Exception&);
    /// Invalidates the texts that were returned without a copy.
    ~Exception() override;

    /// Sets the description. The text is copied; null is read as "".
    void setDescription(const char* description);
    /// The description alone, as it was set, valid as long as the exception is.
    const String& getLocalized() const noexcept { return description_; }
    /// One text with the place and the description.
    String report() const;

    /// The module that raised it, valid as long as the exception is.
    const String& GetModule() const noexcept { return module_; }
    /// The source unit that raised it, valid as long as the exception is.
    const String& GetSourceUnit() const noexcept { return sourceUnit_; }
    /// The revision of that source unit, valid as long as the exception is.
    const String& GetRevision() const noexcept { return revision_; }
    /// The line that raised it.
    int GetLine() const noexcept { return line_; }

    /// The description, valid as long as the exception is.
    const char* what() const noexcept override { return description_.CStr(); }

private:
    String module_;
    String sourceUnit_;
    String revision_;
    int line_;
    String description_;
};

} // namespace Port
