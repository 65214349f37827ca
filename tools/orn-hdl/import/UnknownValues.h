// The values x and z, which a netlist contains as don't cares alone.
#pragma once

#include "import/ImportedDesign.h"

#include <optional>

namespace Tool::Import {

/// The user's choice for x and z.
class UnknownValues {
public:
    /// \param replacement `Zero`, `One`, or `Unknown` for don't cares; without one, x and z are
    ///        rejected.
    explicit UnknownValues(std::optional<Bit> replacement) noexcept : replacement_(replacement) {}

    bool HasReplacement() const noexcept { return replacement_.has_value(); }
    bool AreDontCares() const noexcept { return replacement_ == Unknown; }
    /// Whether 0 or 1 was chosen, which parameters can have too.
    bool HasDigit() const noexcept { return HasReplacement() && !AreDontCares(); }
    /// The bit itself, or the replacement of x or z.
    Bit Replace(Bit bit) const noexcept {
        return bit >= Unknown && replacement_ ? *replacement_ : bit;
    }
    bool IsRefused(Bit bit) const noexcept { return bit >= Unknown && !replacement_; }
    /// Ends the import because of an x or z at `path`.
    [[noreturn]] static void Refuse(Bit bit, const JsonPath& path) {
        Fail(path, bit == Unknown
                       ? "the value x cannot be written; choose another one with --x-as"
                       : "the value z cannot be written; choose another one with --x-as");
    }

private:
    std::optional<Bit> replacement_;
};

} // namespace Tool::Import
