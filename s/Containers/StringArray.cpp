#include "Orn_Hdl/Containers/StringArray.h"

#include "Containers/EightBytes.h"
#include "Containers/StableSort.h"
#include "Port/Ascii.h"
#include "Port/Text.h"

#include <algorithm>
#include <climits>
#include <functional>
#include <utility>

namespace Orn_Hdl {

using std::string_view;

StringArray::StringArray(Port::TextView text, Port::TextView separators, bool skipEmpty,
                         Port::TextView quotes) {
    Parse(text, separators, skipEmpty, quotes);
}

bool StringArray::GetIntAt(int i, int& value, int /*unused*/) const {
    const Port::StringBase<char> text = GetAt(i);
    long number = 0;
    if (!Port::strtol(text.CStr(), number) || number < INT_MIN || number > INT_MAX) {
        return false;
    }
    value = static_cast<int>(number);
    return true;
}

bool StringArray::Contains(Port::TextView text) const noexcept {
    for (int i = 0; i < GetSize(); ++i) {
        if (GetView(i) == text.GetView()) {
            return true;
        }
    }
    return false;
}

bool StringArray::IContains(Port::TextView text) const noexcept {
    for (int i = 0; i < GetSize(); ++i) {
        if (Port::EqualIgnoringCase(GetView(i), text)) {
            return true;
        }
    }
    return false;
}

bool StringArray::Contains(const StringArray& other) const noexcept {
    if (other.GetSize() > GetSize()) {
        return false;
    }
    for (int i = 0; i < other.GetSize(); ++i) {
        if (!Contains(other.GetView(i))) {
            return false;
        }
    }
    return true;
}

bool StringArray::IContains(const StringArray& other) const noexcept {
    if (other.GetSize() > GetSize()) {
        return false;
    }
    for (int i = 0; i < other.GetSize(); ++i) {
        if (!IContains(other.GetView(i))) {
            return false;
        }
    }
    return true;
}

Port::StringBase<char> StringArray::Concatenate(Port::TextView separator) const {
    Port::StringBase<char> text;
    for (int i = 0; i < GetSize(); ++i) {
        if (i > 0) {
            text += separator;
        }
        text += GetView(i);
    }
    return text;
}

std::string StringArray::JoinFrom(int first) const {
    std::string text;
    for (int i = first; i < GetSize(); ++i) {
        if (i > first) {
            text += ' ';
        }
        text += GetView(i);
    }
    return text;
}

void StringArray::ClosePiece(std::size_t start) {
    slots_.push_back({start, text_.size() - start});
}

/// Whether a text is in the list's own buffer, which moves when it grows.
bool StringArray::IsOwn(string_view text) const noexcept {
    const std::less_equal<const char*> isNotAfter;
    return isNotAfter(text_.data(), text.data()) &&
           isNotAfter(text.data(), text_.data() + text_.size());
}

int StringArray::AddView(string_view text) {
    const std::size_t start = text_.size();
    text_.append(text);
    ClosePiece(start);
    return GetSize() - 1;
}

void StringArray::Add(const StringArray& other) {
    // By index, with the size read once: the list may be added to itself.
    const int count = other.GetSize();
    for (int i = 0; i < count; ++i) {
        Add(other.GetAt(i));
    }
}

/// Makes room for `length` more characters. If the buffer would have to grow, the texts move to a
/// new one, without the unused parts of the old one. The new buffer is large enough that moving
/// takes constant amortised time.
void StringArray::MakeRoom(std::size_t length) {
    if (length <= text_.capacity() - text_.size()) {
        return;
    }
    std::size_t used = length;
    for (const Slot& slot : slots_) {
        used += slot.length;
    }
    std::string kept;
    kept.reserve(used * 2 + slots_.size());
    for (Slot& slot : slots_) {
        const std::size_t start = kept.size();
        kept.append(text_, slot.start, slot.length);
        slot.start = start;
    }
    text_ = std::move(kept);
}

void StringArray::SetAt(int i, Port::TextView set) {
    if (i < 0) {
        return;
    }
    const std::string copy(IsOwn(set) ? set.GetView() : string_view());
    const string_view text = IsOwn(set) ? string_view(copy) : set.GetView();
    const auto index = static_cast<std::size_t>(i);
    if (index >= slots_.size()) {
        slots_.resize(index + 1, Slot{0, 0});
    }
    Slot& slot = slots_[index];
    if (text.size() > slot.length) {
        MakeRoom(text.size());
        const std::size_t start = text_.size();
        text_.append(text);
        slot.start = start;
    } else {
        text_.replace(slot.start, text.size(), text);
    }
    slot.length = text.size();
}

void StringArray::Empty() noexcept {
    text_.clear();
    slots_.clear();
}

void StringArray::Sort() {
    std::stable_sort(slots_.begin(), slots_.end(), [this](const Slot& a, const Slot& b) {
        const string_view text = text_;
        return text.substr(a.start, a.length) < text.substr(b.start, b.length);
    });
}

void StringArray::Sort(bool (*less)(const Port::StringBase<char>&, const Port::StringBase<char>&,
                                    void*),
                       void* context) {
    if (less == nullptr) {
        return;
    }
    // The caller's predicate may modify the list, so the list is not changed before the order is
    // final.
    const StringArray before(*this);
    std::vector<Port::StringBase<char>> texts;
    texts.reserve(slots_.size());
    for (const string_view text : before) {
        texts.emplace_back(text);
    }
    std::vector<const Port::StringBase<char>*> order;
    order.reserve(texts.size());
    for (const auto& text : texts) {
        order.push_back(&text);
    }
    StableSort(order,
               [less, context](const auto* a, const auto* b) { return less(*a, *b, context); });
    if (!std::equal(begin(), end(), before.begin(), before.end())) {
        return;
    }
    StringArray sorted;
    for (const auto* text : order) {
        sorted.AddView(*text);
    }
    *this = std::move(sorted);
}

int StringArray::Parse(Port::TextView text, Port::TextView separators, bool skipEmpty,
                       Port::TextView quotes) {
    if (IsOwn(text) || IsOwn(separators) || IsOwn(quotes)) {
        return Split(std::string(text.GetView()), std::string(separators.GetView()), skipEmpty,
                     std::string(quotes.GetView()));
    }
    return Split(text, separators, skipEmpty, quotes);
}

namespace {

/// The characters of a line from a position on, fewer than eight, and a blank behind them.
std::uint64_t LoadLast(string_view line, std::size_t position) noexcept {
    const std::size_t bits = 8 * (line.size() - position);
    std::uint64_t text = 0;
    if (line.size() >= sizeof text) {
        // In two steps, since none may shift all bits out.
        text = EightBytes::Load(line.data() + line.size() - sizeof text) >> 8U >> (56 - bits);
    } else {
        line.copy(reinterpret_cast<char*>(&text), line.size());
    }
    return text | std::uint64_t(' ') << bits;
}

} // namespace

int StringArray::ParseCommandLine(Port::TextView commandLine) {
    if (IsOwn(commandLine)) {
        return ParseCommandLine(std::string(commandLine.GetView()));
    }
    const string_view line = commandLine;
    // Without quotes, the words are parts of the line: it is copied as a whole and scanned eight
    // characters at a time. The line itself is scanned, because a processor waits long before it
    // can read what it has just copied. A blank behind the line ends its last word.
    constexpr std::size_t Step = sizeof(std::uint64_t);
    const int before = GetSize();
    const std::size_t offset = text_.size();
    text_.append(line);
    std::size_t start = 0;
    for (std::size_t i = 0; i <= line.size(); i += Step) {
        const std::uint64_t text =
            i + Step <= line.size() ? EightBytes::Load(line.data() + i) : LoadLast(line, i);
        // Blanks and quotes, and some characters between them that need no attention.
        std::uint64_t marks = EightBytes::MarkRange(text, ' ', '\'');
        for (; marks != 0; marks &= marks - 1) {
            const std::size_t end = i + EightBytes::FirstMarked(marks);
            const char c = end == line.size() ? ' ' : line[end];
            if (c == '"' || c == '\'') {
                text_.resize(offset);
                slots_.resize(static_cast<std::size_t>(before));
                return Parse(line, " ", true, "\"\"''");
            }
            if (c == ' ') {
                if (end > start) {
                    slots_.push_back({offset + start, end - start});
                }
                start = end + 1;
            }
        }
    }
    return GetSize() - before;
}

namespace {

/// The closing character of the pair that `c` opens, or NUL if it opens none.
char ClosingOf(char c, string_view quotes) noexcept {
    for (std::size_t i = 0; i + 1 < quotes.size(); i += 2) {
        if (quotes[i] == c) {
            return quotes[i + 1];
        }
    }
    return '\0';
}

} // namespace

int StringArray::Split(string_view text, string_view separators, bool skipEmpty,
                       string_view quotes) {
    const int before = GetSize();
    const char separator = separators.empty() ? '\0' : separators.front();
    const string_view others = separators.substr(std::min<std::size_t>(1, separators.size()));
    const auto isSeparator = [separator, others](char c) {
        return (c == separator && separator != '\0') ||
               (!others.empty() && others.find(c) != string_view::npos);
    };
    // The pieces are not longer than the text, so the buffer grows at most once.
    text_.reserve(text_.size() + text.size());
    std::size_t start = text_.size();
    char closing = '\0';
    bool wasQuoted = false;
    std::size_t i = 0;
    const auto openQuote = [&] {
        closing = i < text.size() ? ClosingOf(text[i], quotes) : '\0';
        if (closing != '\0') {
            ++i;
        }
    };
    openQuote();
    while (i < text.size()) {
        const char c = text[i];
        const char next = i + 1 < text.size() ? text[i + 1] : '\0';
        const bool isLast = i + 1 == text.size();
        if (closing == '\0' && !isSeparator(c)) {
            // A run of plain characters is copied as a whole.
            std::size_t end = i + 1;
            while (end < text.size() && !isSeparator(text[end])) {
                ++end;
            }
            text_.append(text, i, end - i);
            i = end;
        } else if (closing == '\0') {
            if (text_.size() > start || !skipEmpty || wasQuoted) {
                ClosePiece(start);
                start = text_.size();
            }
            wasQuoted = false;
            ++i;
            openQuote();
        } else if (c == closing) {
            if (isLast || isSeparator(next)) {
                closing = '\0';
                wasQuoted = true;
            }
            ++i;
        } else if (c == '\\' && next == closing && !isLast) {
            text_ += closing;
            i += 2;
        } else {
            text_ += c;
            ++i;
        }
    }
    if (text_.size() > start) {
        ClosePiece(start);
    }
    return GetSize() - before;
}

} // namespace Orn_Hdl
