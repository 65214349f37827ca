/// \file
/// Output streams: the only way text leaves the library. A file stream indents and wraps lines, a
/// memory stream collects the text unchanged.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <memory>
#include <string>
#include <string_view>

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

    void Indent() noexcept { ++indentLevel_; }
    /// Never goes below level 0.
    void Unindent() noexcept {
        if (indentLevel_ > 0) {
            --indentLevel_;
        }
    }
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
    enum Operand { NewLine = 0, Flush = 1 };

    /// Takes ownership of the destination; null makes a stream that drops everything.
    explicit OutStream(StreamDst* destination);
    OutStream(const OutStream&) = delete;
    OutStream& operator=(const OutStream&) = delete;
    /// Deletes the destination, which flushes and closes a file.
    virtual ~OutStream();

    OutStream& operator<<(const char* text);
    OutStream& operator<<(const Port::StringBase<char>& text) { return *this << text.GetView(); }
    OutStream& operator<<(std::string_view text);
    OutStream& operator<<(int number);
    OutStream& operator<<(Operand operand);

    void Indent() noexcept;
    void Unindent() noexcept;
    /// Writes a line end with the indent level at 0, so that the empty line holds no blanks.
    void WriteEmptyLine();

protected:
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
    /// A stream without a file.
    TextFileOutStream();
    /// \param fileName the file to open; null opens none.
    /// \param append whether the text goes behind what the file holds or replaces it.
    TextFileOutStream(const char* fileName, bool append);
    ~TextFileOutStream() override;

    /// Closes the file that is open and opens another. The remembered name does not change.
    bool Open(const char* fileName, bool append);
    bool IsOpen() const noexcept;
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

    Port::StringBase<char> GetValue() const;
    void SetValue(const char* text);

private:
    TextMemDst& memory_;
};

} // namespace Orn_Hdl
