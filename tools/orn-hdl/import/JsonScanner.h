// The words and marks of a JSON text, which is read piece by piece.
#pragma once

#include "import/JsonPath.h"
#include "import/TextSource.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

/// The text is no JSON at the place that a scanner has reached.
struct JsonSyntaxError {
    const char* reason = "";
    /// Whether the value in which the error was found tells where it is.
    bool hasPath = true;
    /// Whether there is a place in the text.
    bool hasPlace = true;
};

/// Reads one word or mark after the other. No more of the text is in memory than one piece and one
/// word. All functions throw `JsonSyntaxError` where the text is no JSON.
class JsonScanner {
public:
    enum class Kind : std::uint8_t { Object, Array, Text, Number, Word };

    struct Number {
        /// Whether it has no fraction and no exponent, and fits.
        bool isInteger = false;
        std::int64_t value = 0;
    };

    /// \param source not owned.
    explicit JsonScanner(TextSource& source);

    /// Fails unless the text begins with an object or an array.
    void CheckBeginning();
    /// Whether nothing but blanks is left.
    bool IsAtEnd();
    /// How many bytes were read so far. Some of them may not have been scanned.
    std::size_t GetBytesRead() const noexcept {
        return dropped_ + static_cast<std::size_t>(end_ - buffer_.data());
    }
    /// The line and the column that the scanner has reached, or the end of the text without its
    /// blanks. The scanner cannot be used afterwards.
    TextPlace FindPlace();

    /// What kind of value comes next.
    Kind GetKind();
    /// Takes the mark that opens an object or an array.
    /// \return false if `close` follows, which is taken, too.
    bool TakeOpening(char close);
    /// Takes what follows a member: a comma, or `close`. \return whether it is a comma.
    bool TakeSeparator(char close);
    /// Takes the name of a field and the colon. The name is valid until the colon is taken.
    std::string_view TakeKey();
    void TakeColon() { Take(':'); }
    /// Takes a text, which comes next. It is valid until the next call.
    std::string_view TakeText();
    /// Takes a number, which comes next.
    Number TakeNumber();
    /// Takes true, false or null, if one of these comes next.
    void TakeWord();

private:
    [[noreturn]] void FailStructure();
    void SkipBlanks();
    void Take(char mark);
    /// Reads the next piece. What lies in front of `at_` may be dropped.
    /// \return false at the end of the text.
    bool Fill();
    /// The size of the longest text at `at_` whose characters are all accepted.
    template <class Accept> std::size_t Measure(const Accept& accept);
    void CheckUtf8(std::string_view text);
    /// The characters of a text with escapes.
    std::string_view Unescape(std::string_view text);
    std::size_t UnescapeUnicode(std::string_view text, std::size_t at);

    TextSource& source_;
    /// Room for a byte 0 behind the text, and for a look at eight bytes there.
    std::vector<char> buffer_;
    const char* at_ = nullptr;
    const char* end_ = nullptr;
    bool isEnd_ = false;
    /// How many bytes are no longer in the buffer, how many lines end in them, and where the last
    /// line begins in the whole text.
    std::size_t dropped_ = 0;
    std::uint64_t droppedLines_ = 0;
    std::size_t lineStart_ = 0;
    /// A text without its escapes.
    std::string unescaped_;
};

} // namespace Tool::Import
