#include "import/SignalReferences.h"

#include "import/Spelling.h"

namespace Tool::Import {

std::string GetPartName(const ImportedSignal& signal, std::uint32_t left, std::uint32_t right) {
    if (signal.IsScalar()) {
        return signal.name;
    }
    const std::int64_t leftIndex = GetIndex(signal.range, signal.width, left);
    if (left == right && signal.lowest != signal.highest) {
        return MakeBitName(signal.name, leftIndex);
    }
    return MakeBusName(signal.name, leftIndex, GetIndex(signal.range, signal.width, right));
}

bool SignalReferences::IsConstant(const Span& bits) const {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        if (IsNet(GetBit(bits, i))) {
            return false;
        }
    }
    return true;
}

std::string SignalReferences::GetDigits(const Span& bits) const {
    std::string digits;
    for (std::uint32_t i = bits.count; i-- > 0;) {
        digits += GetDigit(GetBit(bits, i));
    }
    return digits;
}

std::string SignalReferences::GetReference(const Span& bits) const {
    std::string text;
    for (std::uint32_t i = bits.count; i-- > 0;) {
        text.append(text.empty() ? "" : ",");
        const Bit bit = GetBit(bits, i);
        if (!IsNet(bit) && bit != HighImpedance) {
            const ImportedSignal* constant = owners_.GetConstant(bit);
            text += constant == nullptr ? std::string(1, GetDigit(bit)) : constant->name;
            continue;
        }
        if (!IsNet(bit) || owners_.Get(bit).signal == BitOwner::NoSignal) {
            return "-";
        }
        text += TakeRun(bits, i);
    }
    return text;
}

/// The name of the longest ascending or descending run of bits of one signal from bit `i` on.
/// \param i becomes the last bit of the run.
std::string SignalReferences::TakeRun(const Span& bits, std::uint32_t& i) const {
    const BitOwner first = owners_.Get(GetBit(bits, i));
    const ImportedSignal& signal = owners_.GetSignals()[first.signal];
    std::uint32_t last = first.position;
    std::int64_t step = 0;
    const std::uint32_t start = i;
    for (; i > 0; --i) {
        const Bit next = GetBit(bits, i - 1);
        if (!IsNet(next) || owners_.Get(next).signal != first.signal) {
            break;
        }
        const std::int64_t distance = std::int64_t(owners_.Get(next).position) - last;
        if ((distance != 1 && distance != -1) || (step != 0 && distance != step)) {
            break;
        }
        step = distance;
        last = owners_.Get(next).position;
    }
    if (step == 1 && last - first.position == signal.highest - signal.lowest) {
        // The reversed range of a whole bus would declare the bus again, so the first bit is
        // written separately.
        i = start;
        last = first.position;
    }
    return GetPartName(signal, first.position, last);
}

} // namespace Tool::Import
