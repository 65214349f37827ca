/// \file
/// Output streams: the only way text leaves the library. A file stream indents and wraps lines, a
/// memory stream collects the text unchanged.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <type_traits>

namespace Port {
class Folder;
}

namespace Orn_Hdl {

/// Where an `OutStream` sends its text.
class ORN_HDL_API StreamDst {
public:
    /// A destination at indent level 0.
    StreamDst() noexcept = default;
    /// A file destination writes what it holds back and closes its file.
    virtual ~StreamDst();
    /// Ends the line in hand and passes on all that is held back; does nothing in the base.
    virtual void Flush();
    /// Writes "\n".
    virtual void WriteNewLine();
    /// Writes a text that ends in NUL; a null text writes nothing.
    virtual void Write(const char* text) = 0;
    /// Writes a number in decimal digits.
    virtual void Write(int number) = 0;
    /// Writes a text of known length; in the base through `Write(const char*)`.
    virtual void WriteView(std::string_view text);
    /// Writes some texts one after the other; in the base through `WriteView`.
    virtual void WritePieces(const std::string_view* pieces, std::size_t count);

    /// Goes one indent level deeper.
    void Indent() noexcept { ++indentLevel_; }
    /// Goes one indent level back, never below level 0.
    void Unindent() noexcept {
        if (indentLevel_ > 0) {
            --indentLevel_;
        }
    }
    /// The present indent level, from 0.
    int GetIndentLevel() const noexcept { return indentLevel_; }

protected:
    /// A copy has the same indent level and nothing else.
    StreamDst(const StreamDst&) noexcept = default;
    /// Takes over the indent level and nothing else.
    StreamDst& operator=(const StreamDst&) noexcept = default;

private:
    int indentLevel_ = 0;
};

/// A front over a destination: forwards texts, numbers, line ends and indentation.
class ORN_HDL_API OutStream {
    template <class Number>
    static constexpr bool IsOtherInteger =
        std::is_integral_v<Number> && !std::is_same_v<Number, bool> &&
        (sizeof(Number) > sizeof(int) || std::is_same_v<Number, short> ||
         std::is_same_v<Number, unsigned short> || std::is_same_v<Number, unsigned> ||
         std::is_same_v<Number, long> || std::is_same_v<Number, unsigned long>);

public:
    /// What is written besides texts and numbers: a line end, or all that is held back.
    enum Operand { NewLine = 0, Flush = 1 };

    /// Takes ownership of the destination; null makes a stream that drops everything.
    explicit OutStream(StreamDst* destination);
    OutStream(const OutStream&) = delete;
    OutStream& operator=(const OutStream&) = delete;
    /// Deletes the destination, which flushes and closes a file.
    virtual ~OutStream();

    /// Writes a text that ends in NUL; a null text writes nothing.
    OutStream& operator<<(const char* text);
    /// Writes a text.
    OutStream& operator<<(const Port::StringBase<char>& text) { return *this << text.GetView(); }
    /// Writes a text.
    OutStream& operator<<(const std::string& text) { return *this << std::string_view(text); }
    /// Writes a text of known length.
    OutStream& operator<<(std::string_view text);
    /// Writes a number in decimal digits.
    OutStream& operator<<(int number);
    /// Writes an integer of another size in decimal digits.
    template <class Integer, std::enable_if_t<IsOtherInteger<Integer>, int> = 0>
    OutStream& operator<<(Integer number) {
        return *this << std::string_view(std::to_string(number));
    }
    /// A character or a number with a fraction would be written as an integer, a semicolon as 59.
    /// Write the text that is meant.
    template <class Other,
              std::enable_if_t<std::is_arithmetic_v<Other> && !IsOtherInteger<Other>, int> = 0>
    OutStream& operator<<(Other) = delete;
    /// Writes a line end or all that is held back; any other operand does nothing.
    OutStream& operator<<(Operand operand);
    /// Writes texts, each as if by itself: a file's lines are broken between them.
    OutStream& WritePieces(std::initializer_list<std::string_view> pieces);

    /// Goes one indent level deeper.
    void Indent() noexcept;
    /// Goes one indent level back, never below level 0.
    void Unindent() noexcept;
    /// Writes a line end with the indent level at 0, so that the empty line holds no blanks.
    void WriteEmptyLine();

protected:
    /// The destination; null when everything is dropped.
    StreamDst* GetDestination() const noexcept { return destination_.get(); }

private:
    std::unique_ptr<StreamDst> destination_;
};

class TextFileDst;
class TextMemDst;

/// Writes into a file: three blanks of indentation a level, and lines broken after 80 columns where
/// a blank or a comma allows it. A comment line and a line that ends within one text are never
/// broken.
///
/// Nothing is thrown for a file that cannot be opened or written: what is written is dropped, and
/// `GetError` tells the system's reason.
class ORN_HDL_API TextFileOutStream : public OutStream {
public:
    /// What becomes of the file that is there already. `Replace` is `Overwrite` that happens as a
    /// whole: the former file stands as it was until `Close` puts the new one in its place, which
    /// it does only when everything was written. `Port::File::Mode` tells which files are written
    /// directly all the same.
    ///
    /// A stream that is destroyed while its file is open writes the rest and closes the file, but
    /// for one that is to replace a file: that one drops its text, and the former file stands. Its
    /// destructor runs as well when an exception ends the writing half-way, and the half of a text
    /// must not take the place of a whole one.
    enum Mode { Overwrite, Append, Replace };

    /// A stream without a file.
    TextFileOutStream();
    /// Opens a file; `IsOpen` tells whether it is open, `GetError` why it is not.
    /// \param fileName the file to open; null opens none.
    /// \param append whether the text goes behind what the file holds or replaces it.
    TextFileOutStream(const char* fileName, bool append);
    /// Opens a file; `IsOpen` tells whether it is open, `GetError` why it is not.
    /// \param append whether the text goes behind what the file holds or replaces it.
    TextFileOutStream(const Port::StringBase<char>& fileName, bool append);
    /// Opens a file; `IsOpen` tells whether it is open, `GetError` why it is not.
    /// \param fileName the file to open; null opens none.
    /// \param mode what becomes of a file that is there.
    TextFileOutStream(const char* fileName, Mode mode);
    /// Opens a file below a folder without following a link (`Port::File::OpenBelow`).
    /// \param path the file's path below the folder.
    /// \param fileName the name to remember.
    TextFileOutStream(const Port::Folder& folder, const char* path, const char* fileName,
                      Mode mode);
    /// Opens a file; `IsOpen` tells whether it is open, `GetError` why it is not.
    /// \param mode what becomes of a file that is there.
    TextFileOutStream(const Port::StringBase<char>& fileName, Mode mode);
    /// Only a `bool` and a `Mode` say what becomes of the file.
    template <class Other> TextFileOutStream(const char* fileName, Other) = delete;
    /// Only a `bool` and a `Mode` say what becomes of the file.
    template <class Other>
    TextFileOutStream(const Port::StringBase<char>& fileName, Other) = delete;
    /// Closes the file, if one is open, as it says at `Mode`.
    ~TextFileOutStream() override;

    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param fileName the file to open; null is the name of no file.
    /// \param append whether the text goes behind what the file holds or replaces it.
    /// \return whether a file is open now.
    bool Open(const char* fileName, bool append);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param append whether the text goes behind what the file holds or replaces it.
    /// \return whether a file is open now.
    bool Open(const Port::StringBase<char>& fileName, bool append);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param fileName the file to open; null is the name of no file.
    /// \param mode what becomes of a file that is there.
    /// \return whether a file is open now.
    bool Open(const char* fileName, Mode mode);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param mode what becomes of a file that is there.
    /// \return whether a file is open now.
    bool Open(const Port::StringBase<char>& fileName, Mode mode);
    /// Only a `bool` and a `Mode` say what becomes of the file.
    template <class Other> bool Open(const char* fileName, Other) = delete;
    /// Only a `bool` and a `Mode` say what becomes of the file.
    template <class Other> bool Open(const Port::StringBase<char>& fileName, Other) = delete;
    /// Whether a file is open.
    bool IsOpen() const noexcept;
    /// Writes what is held back and closes the file; `GetError` then tells whether all is written.
    void Close();
    /// The name that the constructor was given; empty when there was none.
    Port::StringBase<char> GetFileName() const;
    /// The system's error number of the first failure since the last opening, closing included; 0
    /// when everything went well.
    int GetError() const noexcept;
    /// How many bytes of this stream stand at the end of a file all the same, when appending to it
    /// has failed and they could not be taken back; 0 when the file ends as it began.
    std::uint64_t GetLeftoverSize() const noexcept;

private:
    TextFileDst& file_;
};

/// Collects the text in memory, without indentation and without breaking lines.
class ORN_HDL_API TextMemOutStream : public OutStream {
public:
    /// A stream whose text starts as `initial`; null is the empty text.
    explicit TextMemOutStream(const char* initial = nullptr);
    /// A stream whose text starts as `initial`.
    explicit TextMemOutStream(std::string_view initial);
    /// The text ends with the stream.
    ~TextMemOutStream() override;

    /// A copy of the text so far.
    Port::StringBase<char> GetValue() const;
    /// Replaces the text; null is read as "".
    void SetValue(const char* text);
    /// Replaces the text.
    void SetValue(std::string_view text);

private:
    TextMemDst& memory_;
};

} // namespace Orn_Hdl
