#include "HdlModel/Names/Names.h"

#include "Port/Text.h"

#include <algorithm>

namespace Orn_Hdl::Names {

using std::string_view;

bool IsNormalized(string_view name) noexcept {
    using namespace EightBytes;
    while (name.size() >= Count && MarkUnusual(Load(name.data())) == 0) {
        name.remove_prefix(Count);
    }
    if (name.size() < Count && MarkUnusual(LoadShort(name.data(), name.size())) == 0) {
        return true;
    }
    return std::all_of(name.begin(), name.end(), [](char c) { return Normalized(c) == c; });
}

void Normalize(std::string& name) noexcept {
    for (char& c : name) {
        c = Normalized(c);
    }
}

NormalizedText::NormalizedText(string_view text) : view_(text) {
    if (!IsNormalized(text)) {
        copy_ = text;
        Normalize(copy_);
        view_ = copy_;
    }
}

bool IsBase(string_view text) noexcept {
    if (text.empty() || !(Port::IsLetter(text[0]) || text[0] == '_' || text[0] == '\'')) {
        return false;
    }
    return std::all_of(text.begin() + 1, text.end(),
                       [](char c) { return Port::IsLetter(c) || Port::IsDigit(c) || c == '_'; });
}

bool IsInteger(string_view text) noexcept {
    if (!text.empty() && (text[0] == '+' || text[0] == '-')) {
        text.remove_prefix(1);
    }
    return !text.empty() && std::all_of(text.begin(), text.end(), Port::IsDigit);
}

bool ParseBus(string_view name, BusName& parsed) noexcept {
    if (name.empty() || name.back() != ')') {
        return false;
    }
    const std::size_t open = name.find('(');
    const std::size_t colon = name.find(':');
    if (open >= colon || colon == string_view::npos || name.find(')') != name.size() - 1) {
        return false;
    }
    const string_view base = name.substr(0, open);
    const string_view left = name.substr(open + 1, colon - open - 1);
    const string_view right = name.substr(colon + 1, name.size() - colon - 2);
    if (!IsBase(base) || !IsInteger(left) || !IsInteger(right)) {
        return false;
    }
    parsed = {{Port::ToIntSaturated(left), Port::ToIntSaturated(right)}, base, left, right};
    return true;
}

bool ParseBit(string_view name, BitName& parsed) noexcept {
    if (name.empty() || name.back() != ')') {
        return false;
    }
    const std::size_t open = name.find('(');
    if (open == string_view::npos || name.find(')') != name.size() - 1) {
        return false;
    }
    const string_view base = name.substr(0, open);
    const string_view index = name.substr(open + 1, name.size() - open - 2);
    if (!IsBase(base) || !IsInteger(index)) {
        return false;
    }
    parsed = {base, index, Port::ToIntSaturated(index)};
    return true;
}

int GetWidth(string_view name) noexcept {
    BusName parsed;
    return ParseBus(name, parsed) ? parsed.GetWidth() : 0;
}

bool IsDownTo(string_view name) noexcept {
    BusName parsed;
    return ParseBus(name, parsed) && parsed.IsDownTo();
}

bool GetIndexTexts(string_view name, Port::StringBase<char>& left, Port::StringBase<char>& right) {
    BusName parsed;
    if (!ParseBus(name, parsed)) {
        return false;
    }
    left = parsed.left;
    right = parsed.right;
    return true;
}

bool CompoundPieces::Next(string_view& piece) noexcept {
    while (!rest_.empty()) {
        const std::size_t end = std::min(rest_.find_first_of(",\\"), rest_.size());
        piece = rest_.substr(0, end);
        rest_.remove_prefix(std::min(end + 1, rest_.size()));
        if (!piece.empty()) {
            return true;
        }
    }
    return false;
}

bool IsCompound(string_view name) noexcept {
    CompoundPieces pieces(name);
    string_view piece;
    BusName bus;
    BitName bit;
    int count = 0;
    while (pieces.Next(piece)) {
        if (!IsBase(piece) && !ParseBus(piece, bus) && !ParseBit(piece, bit)) {
            return false;
        }
        count = std::min(count + 1, 2);
    }
    return count > 1;
}

string_view BaseName(string_view name) noexcept {
    const std::size_t open = name.find('(');
    if (open == string_view::npos || name.find(')') == string_view::npos ||
        name.find(',') != string_view::npos) {
        return name;
    }
    return name.substr(0, open);
}

string_view BeforeParenthesis(string_view name) noexcept {
    return name.substr(0, name.find('('));
}

std::string WithIndex(string_view base, string_view index) {
    std::string name;
    name.reserve(base.size() + index.size() + 2);
    name.append(base).append("(").append(index).append(")");
    return name;
}

std::string WithIndex(string_view base, int index) {
    return WithIndex(base, std::to_string(index));
}

std::string WithRange(string_view base, string_view left, string_view right) {
    std::string name;
    name.reserve(base.size() + left.size() + right.size() + 3);
    name.append(base).append("(").append(left).append(":").append(right).append(")");
    return name;
}

std::string WithRange(string_view base, int left, int right) {
    return WithRange(base, std::to_string(left), std::to_string(right));
}

bool IsDummy(string_view base) noexcept {
    return base.size() >= DummySuffix.size() &&
           IsNamed(base.substr(base.size() - DummySuffix.size()), DummySuffix);
}

std::string DummyOf(string_view base) {
    return std::string(base).append(DummySuffix);
}

std::string DummyOfPart(string_view name) {
    const string_view base = BeforeParenthesis(name);
    return DummyOf(base).append(name.substr(base.size()));
}

namespace {

std::size_t DigitRun(string_view text, std::size_t start) noexcept {
    std::size_t end = start;
    while (end < text.size() && Port::IsDigit(text[end])) {
        ++end;
    }
    return end - start;
}

unsigned char Rank(char c) noexcept {
    return static_cast<unsigned char>(Port::ToUpper(c));
}

} // namespace

std::size_t SharedLength(string_view a, string_view b, std::size_t known) noexcept {
    const std::size_t common = std::min(a.size(), b.size());
    std::size_t length = known;
    while (length < common && Rank(a[length]) == Rank(b[length])) {
        ++length;
    }
    // A run of digits is compared as a number.
    while (length > known && Port::IsDigit(a[length - 1])) {
        --length;
    }
    return length;
}

int CompareNatural(string_view a, string_view b) noexcept {
    const std::size_t common = std::min(a.size(), b.size());
    std::size_t i = 0;
    while (i < common && Rank(a[i]) == Rank(b[i])) {
        ++i;
    }
    if (i == a.size() || i == b.size()) {
        return a.size() == b.size() ? 0 : (a.size() < b.size() ? -1 : 1);
    }
    const bool digitA = Port::IsDigit(a[i]);
    const bool digitB = Port::IsDigit(b[i]);
    if (digitA != digitB) {
        return digitA ? 1 : -1;
    }
    if (digitA) {
        const std::size_t runA = DigitRun(a, i);
        const std::size_t runB = DigitRun(b, i);
        if (runA != runB) {
            return runA < runB ? -1 : 1;
        }
    }
    return Rank(a[i]) < Rank(b[i]) ? -1 : 1;
}

namespace {

/// Collects the bytes of a sort key. Each step must preserve the order.
class NaturalKeyBytes {
public:
    static constexpr unsigned Size = 12;

    bool IsFull() const noexcept { return used_ >= Size; }
    /// The bytes from `start` on as a number, the first one the highest.
    template <class Number> Number Get(unsigned start) const noexcept {
        Number number = 0;
        for (unsigned i = 0; i < sizeof(Number); ++i) {
            number = static_cast<Number>(number << 8U | bytes_[start + i]);
        }
        return number;
    }
    void Append(unsigned byte) noexcept {
        if (!IsFull()) {
            bytes_[used_++] = static_cast<unsigned char>(byte);
        }
    }
    /// \return false if the rank is out of the range that is encoded exactly; the key must end
    /// then.
    bool AppendRank(int rank) noexcept {
        constexpr int FirstPlain = -1;
        constexpr int LastPlain = FirstPlain + 253;
        const int clamped = std::clamp(rank, FirstPlain - 1, LastPlain + 1);
        Append(static_cast<unsigned>(clamped - FirstPlain + 1));
        return rank >= FirstPlain && rank <= LastPlain;
    }
    void AppendName(string_view name) noexcept {
        constexpr unsigned LastPlainRank = 253;
        for (std::size_t i = 0; i < name.size() && !IsFull();) {
            if (Port::IsDigit(name[i])) {
                i = AppendDigits(name, i);
                continue;
            }
            const unsigned rank = Rank(name[i]);
            Append(std::min(rank, LastPlainRank + 1));
            i = rank > LastPlainRank ? name.size() : i + 1;
        }
    }

private:
    /// A run of digits is encoded as 255, its length, and two digits a byte, so that it sorts after
    /// every other character, and a longer run after a shorter one.
    /// \return the index behind the digits.
    std::size_t AppendDigits(string_view name, std::size_t start) noexcept {
        constexpr unsigned DigitMark = 255;
        constexpr std::size_t LongestRun = 255;
        const std::size_t run = DigitRun(name, start);
        Append(DigitMark);
        Append(static_cast<unsigned>(std::min(run, LongestRun)));
        if (run >= LongestRun) {
            return name.size();
        }
        const std::size_t end = start + run;
        for (std::size_t i = start; i < end; i += 2) {
            const unsigned high = Rank(name[i]) & 15U;
            const unsigned low = i + 1 < end ? Rank(name[i + 1]) & 15U : 0;
            Append(high << 4U | low);
        }
        return end;
    }

    unsigned char bytes_[Size] = {};
    unsigned used_ = 0;
};

} // namespace

NaturalKey::NaturalKey(int rank, string_view name, std::uint32_t index) noexcept {
    NaturalKeyBytes bytes;
    if (bytes.AppendRank(rank)) {
        bytes.AppendName(name);
    }
    start_ = bytes.Get<std::uint64_t>(0);
    restAndIndex_ = std::uint64_t(bytes.Get<std::uint32_t>(sizeof start_)) << 32U | index;
}

} // namespace Orn_Hdl::Names
