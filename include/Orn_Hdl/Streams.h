/// \file
/// Output streams: the only way text leaves the library. A file stream indents and wraps lines, a
/// memory stream collects the text unchanged.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>

namespace Port {
class Folder;
}

namespace Orn_Hdl {

/// Where an `OutStream` sends its text.
class ORN_HDL_API StreamDst {
public:
    StreamDst() noexcept = default;
    virtual ~StreamDst();
    /// Does nothing in the base.
    virtual void Flush();
    /// Writes "\n".
    virtual void WriteNewLine();
    /// A null text writes nothing.
    virtual void Write(const char* text) = 0;
    virtual void Write(int number) = 0;
    /// Writes a text of known length; in the base through `Write(const char*)`.
    virtual void WriteView(std::string_view text);
    /// Writes some texts one after the other; in the base through `WriteView`.
    virtual void WritePieces(const std::string_view* pieces, std::size_t count);

    /// Goes one level deeper.
    void Indent() noexcept { ++indentLevel_; }
    /// Never goes below level 0.
    void Unindent() noexcept {
        if (indentLevel_ > 0) {
            --indentLevel_;
        }
    }
    /// The present level, from 0.
    int GetIndentLevel() const noexcept { return indentLevel_; }

protected:
    /// A copy has the same indent level and nothing else.
    StreamDst(const StreamDst&) noexcept = default;
    StreamDst& operator=(const StreamDst&) noexcept = default;

private:
    int indentLevel_ = 0;
};

/// A front over a destination: forwards texts, numbers, line ends and indentation.
class ORN_HDL_API OutStream {
public:
    /// What is written besides texts and numbers: a line end, or all that is held back.
    enum Operand { NewLine = 0, Flush = 1 };

    /// Takes ownership of the destination; null makes a stream that drops everything.
    explicit OutStream(StreamDst* destination);
    OutStream(const OutStream&) = delete;
    OutStream& operator=(const OutStream&) = delete;
    /// Deletes the destination, which flushes and closes a file.
    virtual ~OutStream();

    /// \{
    /// Writes a text, a number or an operand; a null text writes nothing.
    OutStream& operator<<(const char* text);
    OutStream& operator<<(const Port::StringBase<char>& text) { return *this << text.GetView(); }
    OutStream& operator<<(const std::string& text) { return *this << std::string_view(text); }
    OutStream& operator<<(std::string_view text);
    OutStream& operator<<(int number);
    OutStream& operator<<(Operand operand);
    /// \}
    /// Writes texts, each as if by itself: a file's lines are broken between them.
    OutStream& WritePieces(std::initializer_list<std::string_view> pieces);

    /// \{
    /// As those of the destination.
    void Indent() noexcept;
    void Unindent() noexcept;
    /// \}
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
    /// it does only when everything was written. A stream that ends without `Close` drops its text.
    /// `Port::File::Mode` tells which files are written directly all the same.
    enum Mode { Overwrite, Append, Replace };

    /// A stream without a file.
    TextFileOutStream();
    /// \param fileName the file to open; null opens none.
    /// \param append whether the text goes behind what the file holds or replaces it.
    TextFileOutStream(const char* fileName, bool append);
    /// \param mode what becomes of a file that is there.
    TextFileOutStream(const char* fileName, Mode mode);
    /// Opens a file below a folder without following a link (`Port::File::OpenBelow`).
    /// \param path the file's path below the folder.
    /// \param fileName the name to remember.
    TextFileOutStream(const Port::Folder& folder, const char* path, const char* fileName,
                      Mode mode);
    ~TextFileOutStream() override;

    /// Closes the file that is open and opens another. The remembered name does not change.
    bool Open(const char* fileName, bool append);
    /// Whether a file is open.
    bool IsOpen() const noexcept;
    /// Writes what is held back and closes the file; `GetError` then tells whether all is written.
    void Close();
    /// The name that the constructor was given.
    Port::StringBase<char> GetFileName() const;
    /// The system's error number of the first failure since the last opening, closing included; 0
    /// when everything went well.
    int GetError() const noexcept;

private:
    TextFileDst& file_;
};

/// Collects the text in memory, without indentation and without breaking lines.
class ORN_HDL_API TextMemOutStream : public OutStream {
public:
    /// \param initial what the text starts as; null for the empty text.
    explicit TextMemOutStream(const char* initial = nullptr);
    ~TextMemOutStream() override;

    /// The text so far.
    Port::StringBase<char> GetValue() const;
    /// Replaces the text; null is read as "".
    void SetValue(const char* text);

private:
    TextMemDst& memory_;
};

} // namespace Orn_Hdl
