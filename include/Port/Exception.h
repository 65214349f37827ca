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
    /// Null texts are read as "".
    Exception(const char* module, const char* sourceUnit, const char* revision, int line);
    Exception(const Exception&);
    Exception& operator=(const Exception&);
    ~Exception() override;

    /// Sets what happened; null is read as "".
    void setDescription(const char* description);
    /// The description alone, as it was set.
    const String& getLocalized() const noexcept { return description_; }
    /// One text with the place and the description.
    String report() const;

    /// \{
    /// Where it was raised.
    const String& GetModule() const noexcept { return module_; }
    const String& GetSourceUnit() const noexcept { return sourceUnit_; }
    const String& GetRevision() const noexcept { return revision_; }
    int GetLine() const noexcept { return line_; }
    /// \}

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
