// The scanners for names. All of them take views and run in one pass without recursion, so names of
// any length are safe.
#pragma once

#include "Containers/EightBytes.h"
#include "HdlModel/Names/GeneratedNames.h"
#include "HdlModel/Names/Range.h"
#include "Port/Ascii.h"
#include "Port/String.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace Orn_Hdl::Names {

/// One character of a name in its normalised form.
constexpr char Normalized(char c) noexcept {
    switch (c) {
    case '[':
    case '{':
    case '<':
        return '(';
    case ']':
    case '}':
    case '>':
        return ')';
    case '-':
        return ':';
    default:
        return c;
    }
}

/// Not 0 if there are characters that normalisation changes: square brackets, braces, angle
/// brackets or the minus. Few names contain any. Some other rare characters count, too.
inline std::uint64_t MarkUnusual(std::uint64_t eight) noexcept {
    using namespace EightBytes;
    // All but the minus are from 0x1B to 0x1E in their five lower bits.
    return MarkRange(eight & Each(0x1F), '[' & 0x1F, '>' & 0x1F) | MarkRange(eight, '-', '-');
}

bool IsNormalized(std::string_view name) noexcept;
void Normalize(std::string& name) noexcept;

/// A normalised view of a text, copied only when the text is not normalised already.
class NormalizedText {
public:
    /// \param text must outlive this object.
    explicit NormalizedText(std::string_view text);
    NormalizedText(const NormalizedText&) = delete;
    NormalizedText& operator=(const NormalizedText&) = delete;
    std::string_view GetView() const noexcept { return view_; }

private:
    std::string copy_;
    std::string_view view_;
};

bool IsBase(std::string_view text) noexcept;
bool IsInteger(std::string_view text) noexcept;

/// The range of a bus name such as D(7:0), and its texts, which are views of the name.
struct BusName : Range {
    std::string_view base;
    std::string_view left;
    std::string_view right;
};

/// The index of a bit name such as D(3), saturated to 32 bits, and its texts, which are views of
/// the name.
struct BitName {
    std::string_view base;
    std::string_view index;
    int value = 0;
};

/// Reads a normalised bus name. \return false, `parsed` unchanged, for a name of another form.
bool ParseBus(std::string_view name, BusName& parsed) noexcept;
/// Reads a normalised bit name. \return false, `parsed` unchanged, for a name of another form.
bool ParseBit(std::string_view name, BitName& parsed) noexcept;

/// The number of bits of a bus name, at most INT_MAX; 0 for a name of another form.
int GetWidth(std::string_view name) noexcept;
/// Whether a name is a bus name with a descending range.
bool IsDownTo(std::string_view name) noexcept;
/// Copies the texts of a bus name's indices. \return false, both unchanged, for a name of another
/// form.
bool GetIndexTexts(std::string_view name, Port::StringBase<char>& left,
                   Port::StringBase<char>& right);

/// Whether a normalised name is two or more base, bus or bit names separated by "," or "\".
bool IsCompound(std::string_view name) noexcept;

/// Steps through the pieces of a compound name; empty pieces are skipped.
class CompoundPieces {
public:
    explicit CompoundPieces(std::string_view name) noexcept : rest_(name) {}
    /// \return false if there is no further piece.
    bool Next(std::string_view& piece) noexcept;

private:
    std::string_view rest_;
};

/// The part of a normalised name before its first "(" if it contains "(" and ")" and no ",",
/// otherwise the whole name.
std::string_view BaseName(std::string_view name) noexcept;
/// The part of a name before its first "(", or the whole name.
std::string_view BeforeParenthesis(std::string_view name) noexcept;

/// Text of a name with an index or a range in parentheses.
std::string WithIndex(std::string_view base, std::string_view index);
std::string WithIndex(std::string_view base, int index);
std::string WithRange(std::string_view base, std::string_view left, std::string_view right);
std::string WithRange(std::string_view base, int left, int right);

/// Whether a base name ends in the suffix of dummy signals, letter case ignored.
bool IsDummy(std::string_view base) noexcept;
/// The name of the dummy signal of a scalar signal.
std::string DummyOf(std::string_view base);
/// The name of the dummy signal of a bus or a part of one, with its range or index at the end.
std::string DummyOfPart(std::string_view name);

inline bool IsNamed(std::string_view name, std::string_view other) noexcept {
    return Port::EqualIgnoringCase(name, other);
}

/// Below, at or above zero in natural order: letter case ignored, runs of digits by their value, a
/// digit after every other character, the end of a name before any character.
int CompareNatural(std::string_view a, std::string_view b) noexcept;

/// How many characters both names begin with, letter case ignored, that tell nothing of their
/// natural order: what follows them in each name sorts as the whole names do.
/// \param known so many are known to be shared; a former result, or 0.
std::size_t SharedLength(std::string_view a, std::string_view b, std::size_t known) noexcept;

/// An object to sort, in sixteen bytes: its index, and a key made of its rank and the start of its
/// name. A smaller key sorts first, by rank, then in natural order; equal keys say nothing of the
/// order, and the one with the smaller index sorts first.
class NaturalKey {
public:
    NaturalKey(int rank, std::string_view name, std::uint32_t index) noexcept;
    /// The key of no name, which is yet to be replaced.
    explicit NaturalKey(std::uint32_t index) noexcept : start_(0), restAndIndex_(index) {}

    std::uint32_t GetIndex() const noexcept { return static_cast<std::uint32_t>(restAndIndex_); }

    /// Whether the keys are equal, whatever their indices.
    friend bool AreEqual(const NaturalKey& a, const NaturalKey& b) noexcept {
        return a.start_ == b.start_ && a.restAndIndex_ >> 32U == b.restAndIndex_ >> 32U;
    }
    friend bool operator<(const NaturalKey& a, const NaturalKey& b) noexcept {
        return a.start_ != b.start_ ? a.start_ < b.start_ : a.restAndIndex_ < b.restAndIndex_;
    }

private:
    /// The first eight bytes of the key.
    std::uint64_t start_;
    /// The other four bytes in the upper half, the index in the lower one: sorting compares both at
    /// once.
    std::uint64_t restAndIndex_;
};

} // namespace Orn_Hdl::Names
