// What a Scanner reads at the moment: a file, or the text of a macro in one.
#pragma once

#include "Readers/InputText.h"
#include "Readers/Verilog/Scanner.h"

namespace Orn_Hdl::Readers {

struct Scanner::Source {
    InputText text;
    std::uint32_t file = 0;
    std::uint32_t line = 1;
    /// How many characters stand in front of the line.
    std::uint64_t lineStart = 0;
    /// Whether this is the text of a macro, which is used at `place`.
    bool isMacro = false;
    Place place;
};

inline Place Scanner::GetPlace() const noexcept {
    if (source_->isMacro) {
        return source_->place;
    }
    constexpr std::uint64_t LastColumn = UINT32_MAX;
    const std::uint64_t column = input_->GetOffset(input_->current) - source_->lineStart + 1;
    return Place{source_->file, source_->line,
                 static_cast<std::uint32_t>(column < LastColumn ? column : LastColumn)};
}

/// Whether nothing is left of the innermost source.
inline bool Scanner::IsAtEnd() {
    return input_->current == input_->end && !input_->ReadOn();
}

/// The character behind the next one; NUL at the end.
inline char Scanner::PeekSecond() {
    if (input_->current + 1 == input_->end) {
        input_->ReadOn();
    }
    return input_->current[1];
}

/// Steps over a line feed.
inline void Scanner::EndLine() noexcept {
    ++input_->current;
    ++source_->line;
    source_->lineStart = input_->GetOffset(input_->current);
}

/// Takes the characters that belong together, the next one first.
template <class IsPart> std::string_view Scanner::TakeWhile(IsPart isPart) {
    InputText& input = *input_;
    input.mark = input.current;
    for (;;) {
        const char* p = input.current;
        while (isPart(*p)) {
            ++p;
        }
        input.current = p;
        if (p != input.end || !input.ReadOn()) {
            break;
        }
    }
    const std::string_view text(input.mark, static_cast<std::size_t>(input.current - input.mark));
    input.mark = nullptr;
    return text;
}

} // namespace Orn_Hdl::Readers
