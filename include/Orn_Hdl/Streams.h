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

class BranchDst;
class StreamBranch;

/// Where an `OutStream` sends its text.
class ORN_HDL_API StreamDst {
public:
    /// A destination at indent level 0.
    StreamDst() noexcept = default;
    /// A file destination writes its buffered text and closes its file.
    virtual ~StreamDst();
    /// Ends the current line and writes the buffered text; does nothing in the base.
    virtual void Flush();
    /// Writes "\n".
    virtual void WriteNewLine();
    /// Writes a text that ends in NUL; a null text writes nothing.
    virtual void Write(const char* text) = 0;
    /// Writes a number in decimal digits.
    virtual void Write(int number) = 0;
    /// Writes a text of known length; in the base through `Write(const char*)`.
    virtual void WriteView(std::string_view text);
    /// Writes texts one after the other; in the base through `WriteView`.
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
    /// Copies the indent level only.
    StreamDst(const StreamDst&) noexcept = default;
    /// Assigns the indent level only.
    StreamDst& operator=(const StreamDst&) noexcept = default;

private:
    friend class StreamBranch;

    /// A destination in memory that formats lines as this one does, with the present indentation;
    /// null in the base: all text is then written here, by one thread.
    virtual std::unique_ptr<BranchDst> MakeBranch() const;
    /// Writes the lines of a branch as they are. \return false, nothing written, if that would not
    /// be the same as writing them here, as in the base.
    virtual bool TakeLines(std::string_view lines);
    /// Whether text goes anywhere; false after a failure.
    virtual bool IsWriting() const noexcept;

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
    /// What is written besides texts and numbers: a line end, or the buffered text.
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
    /// A character or a floating-point number would be written as an integer, a semicolon as 59:
    /// write a text instead.
    template <class Other,
              std::enable_if_t<std::is_arithmetic_v<Other> && !IsOtherInteger<Other>, int> = 0>
    OutStream& operator<<(Other) = delete;
    /// Writes a line end or the buffered text; any other operand does nothing.
    OutStream& operator<<(Operand operand);
    /// Writes texts as separate pieces: a line of a file may be broken between them.
    OutStream& WritePieces(std::initializer_list<std::string_view> pieces);

    /// Goes one indent level deeper.
    void Indent() noexcept;
    /// Goes one indent level back, never below level 0.
    void Unindent() noexcept;
    /// Writes a line end without indentation, so that the empty line contains no blanks.
    void WriteEmptyLine();

protected:
    /// The destination; null when everything is dropped.
    StreamDst* GetDestination() const noexcept { return destination_.get(); }

private:
    friend class StreamBranch;

    std::unique_ptr<StreamDst> destination_;
};

class TextFileDst;
class TextMemDst;

/// Writes into a file: three blanks of indentation a level, and lines broken after 80 columns where
/// a blank or a comma allows it. A comment line and a line that ends within one text are never
/// broken.
///
/// No exception is thrown if a file cannot be opened or written: the text is dropped, and
/// `GetError` returns the system's error number.
class ORN_HDL_API TextFileOutStream : public OutStream {
public:
    /// How an existing file is treated. `Replace` overwrites it as a whole: the former file stays
    /// unchanged until `Close` replaces it, and only if everything was written. `Port::File::Mode`
    /// lists the files that are written directly nevertheless.
    ///
    /// A stream that is destroyed while its file is open writes the rest and closes the file. With
    /// `Replace`, it drops its text instead, and the former file stays: the destructor also runs
    /// if an exception interrupts the writing, and an incomplete text must not replace a complete
    /// one.
    enum Mode { Overwrite, Append, Replace };

    /// A stream without a file.
    TextFileOutStream();
    /// Opens a file; `IsOpen` returns whether it is open, `GetError` the reason if it is not.
    /// \param fileName the file to open; null opens none.
    /// \param append whether the text is appended to the contents of the file or replaces them.
    TextFileOutStream(const char* fileName, bool append);
    /// Opens a file; `IsOpen` returns whether it is open, `GetError` the reason if it is not.
    /// \param append whether the text is appended to the contents of the file or replaces them.
    TextFileOutStream(const Port::StringBase<char>& fileName, bool append);
    /// Opens a file; `IsOpen` returns whether it is open, `GetError` the reason if it is not.
    /// \param fileName the file to open; null opens none.
    /// \param mode how an existing file is treated.
    TextFileOutStream(const char* fileName, Mode mode);
    /// Opens a file below a folder without following a link (`Port::File::OpenBelow`).
    /// \param path the file's path below the folder.
    /// \param fileName the name to remember.
    TextFileOutStream(const Port::Folder& folder, const char* path, const char* fileName,
                      Mode mode);
    /// Opens a file; `IsOpen` returns whether it is open, `GetError` the reason if it is not.
    /// \param mode how an existing file is treated.
    TextFileOutStream(const Port::StringBase<char>& fileName, Mode mode);
    /// Rejects any other type than `bool` and `Mode`.
    template <class Other> TextFileOutStream(const char* fileName, Other) = delete;
    /// Rejects any other type than `bool` and `Mode`.
    template <class Other>
    TextFileOutStream(const Port::StringBase<char>& fileName, Other) = delete;
    /// Closes the file, if one is open; `Mode` describes how.
    ~TextFileOutStream() override;

    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param fileName the file to open; null opens none.
    /// \param append whether the text is appended to the contents of the file or replaces them.
    /// \return whether a file is open now.
    bool Open(const char* fileName, bool append);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param append whether the text is appended to the contents of the file or replaces them.
    /// \return whether a file is open now.
    bool Open(const Port::StringBase<char>& fileName, bool append);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param fileName the file to open; null opens none.
    /// \param mode how an existing file is treated.
    /// \return whether a file is open now.
    bool Open(const char* fileName, Mode mode);
    /// Closes the file that is open and opens another. The remembered name does not change.
    /// \param mode how an existing file is treated.
    /// \return whether a file is open now.
    bool Open(const Port::StringBase<char>& fileName, Mode mode);
    /// Rejects any other type than `bool` and `Mode`.
    template <class Other> bool Open(const char* fileName, Other) = delete;
    /// Rejects any other type than `bool` and `Mode`.
    template <class Other> bool Open(const Port::StringBase<char>& fileName, Other) = delete;
    /// Whether a file is open.
    bool IsOpen() const noexcept;
    /// Writes the buffered text and closes the file; `GetError` then returns whether that failed.
    void Close();
    /// The name given to the constructor; empty if there was none.
    Port::StringBase<char> GetFileName() const;
    /// The system's error number of the first failure since the last opening, including the
    /// closing; 0 if there was none.
    int GetError() const noexcept;
    /// The number of bytes that this stream has left at the end of a file, if appending failed and
    /// they could not be removed; 0 if the file has its former length.
    std::uint64_t GetLeftoverSize() const noexcept;

    /// Writes the buffered text, and gives the name under which a file that is written to replace
    /// another can be read before `Close` does so.
    /// \return an empty text when the file is written directly, or not at all.
    Port::StringBase<char> FlushToRead();
    /// Writes the bytes of a file as they are: without indentation, and without breaking lines.
    /// \return 0, or the system's error number if the file cannot be read.
    int WriteFile(const char* fileName);

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
    /// Destroys the text.
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
