#include "Port/String.h"

#include "Port/Ascii.h"
#include "Port/CLocale.h"
#include "Port/File.h"

#include <algorithm>
#include <cstdarg>
#include <cstdio>

namespace Port {

namespace {

int ToIndex(std::size_t position) noexcept {
    return position == std::string_view::npos ? -1 : static_cast<int>(position);
}

} // namespace

template <class Char>
int StringBase<Char>::Compare(TextView other, CompareType type) const noexcept {
    return type == CompareExact ? GetView().compare(other) : OrderIgnoringCase(GetView(), other);
}

template <class Char> int StringBase<Char>::GetIndexOfFirstChar(Char c) const noexcept {
    return ToIndex(text_.find(c));
}

template <class Char> int StringBase<Char>::GetIndexOfLastChar(Char c) const noexcept {
    return ToIndex(text_.rfind(c));
}

template <class Char> int StringBase<Char>::GetIndexOfString(TextView text) const noexcept {
    return ToIndex(text_.find(text.GetView()));
}

template <class Char> StringBase<Char> StringBase<Char>::Extract(const Port_Range& range) const {
    if (range.GetStart() >= text_.size()) {
        return StringBase();
    }
    return GetView().substr(range.GetStart(), range.GetLength());
}

template <class Char> void StringBase<Char>::Remove(const Port_Range& range) {
    if (range.GetStart() < text_.size()) {
        text_.erase(range.GetStart(), range.GetLength());
    }
}

template <class Char> void StringBase<Char>::MakeUpper() noexcept {
    std::transform(text_.begin(), text_.end(), text_.begin(), ToUpper);
}

template <class Char> void StringBase<Char>::MakeLower() noexcept {
    std::transform(text_.begin(), text_.end(), text_.begin(), ToLower);
}

template <class Char> void StringBase<Char>::Trim(Char c, TrimType type) {
    if (type != TrimLeft) {
        text_.erase(text_.find_last_not_of(c) + 1);
    }
    if (type != TrimRight) {
        text_.erase(0, std::min(text_.find_first_not_of(c), text_.size()));
    }
}

template <class Char> void StringBase<Char>::ReplaceChars(TextView from, Char to) noexcept {
    for (Char& c : text_) {
        if (from.GetView().find(c) != View::npos) {
            c = to;
        }
    }
}

template <class Char>
bool StringBase<Char>::NextTokenRange(Port_Range& range, TextView separators,
                                      ParseType type) const {
    std::size_t start = 0;
    if (!range.IsBeforeText()) {
        if (range.GetEnd() >= text_.size()) {
            return false;
        }
        start = range.GetEnd() + 1;
    }
    const View set = separators;
    if (type == SkipEmptyTokens) {
        start = std::min(text_.find_first_not_of(set, start), text_.size());
    }
    if (start >= text_.size()) {
        return false;
    }
    const std::size_t end = std::min(text_.find_first_of(set, start), text_.size());
    range = Port_Range::MakeToken(start, end - start);
    return true;
}

template <class Char>
bool StringBase<Char>::NextTokenRange(Port_Range& range, TextView separators, int type) const {
    switch (type) {
    case KeepEmptyTokens:
        return NextTokenRange(range, separators, KeepEmptyTokens);
    case SkipEmptyTokens:
        return NextTokenRange(range, separators, SkipEmptyTokens);
    default:
        return false;
    }
}

template <class Char>
bool StringBase<Char>::GetRangeOfMatch(const Port_Regexp& pattern, Port_Range& range) const {
    return pattern.Search(text_, range);
}

template <class Char> bool StringBase<Char>::ReadLine(File& file) {
    View line;
    if (!file.NextLine(line)) {
        return false;
    }
    text_ = line;
    return true;
}

template <class Char> StringBase<Char> StringBase<Char>::Format(const char* format, ...) {
    if (format == nullptr) {
        return StringBase();
    }
    const CLocale scope;
    std::va_list arguments;
    va_start(arguments, format);
    std::va_list again;
    va_copy(again, arguments);
    // It was begun above. NOLINTNEXTLINE(clang-analyzer-valist.Uninitialized)
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    va_end(arguments);
    std::string text(length < 0 ? 0 : static_cast<std::size_t>(length), '\0');
    if (length > 0) {
        std::vsnprintf(text.data(), text.size() + 1, format, again);
    }
    va_end(again);
    return StringBase(std::move(text));
}

template class StringBase<char>;

} // namespace Port
