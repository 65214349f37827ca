// References to bits: by the name of a signal, of a part of one, or of a compound.
#pragma once

#include "import/BitOwners.h"
#include "import/ImportedDesign.h"
#include "import/UnknownValues.h"

#include <cstdint>
#include <string>

namespace Tool::Import {

/// The bits of a signal between two positions, counted from the right.
std::string GetPartName(const ImportedSignal& signal, std::uint32_t left, std::uint32_t right);

/// The name of a signal with its range, if it has one.
inline std::string GetFullName(const ImportedSignal& signal) {
    return GetPartName(signal, signal.highest, signal.lowest);
}

class SignalReferences {
public:
    /// \param owners not owned; it must outlive this object.
    SignalReferences(const Module& top, const BitOwners& owners,
                     const UnknownValues& unknown) noexcept
        : top_(top), owners_(owners), unknown_(unknown) {}

    /// A bit, with x and z replaced.
    Bit GetBit(const Span& bits, std::uint32_t i) const {
        return unknown_.Replace(top_.GetBit(bits, i));
    }
    bool IsConstant(const Span& bits) const;
    /// The digits of bits that are all constants, leftmost first.
    std::string GetDigits(const Span& bits) const;
    /// The name of all bits together; "-" if a bit has no owner.
    std::string GetReference(const Span& bits) const;

private:
    std::string TakeRun(const Span& bits, std::uint32_t& i) const;

    const Module& top_;
    const BitOwners& owners_;
    UnknownValues unknown_;
};

} // namespace Tool::Import
