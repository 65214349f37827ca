// The file destination: indentation, and lines broken after 80 columns.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Port/File.h"

#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl {

class TextFileDst final : public StreamDst {
public:
    static constexpr std::size_t Width = 80;

    TextFileDst() = default;
    TextFileDst(const char* fileName, TextFileOutStream::Mode mode);
    TextFileDst(const TextFileDst&) = delete;
    TextFileDst& operator=(const TextFileDst&) = delete;
    ~TextFileDst() override;

    bool Open(const char* fileName, TextFileOutStream::Mode mode);
    bool IsOpen() const noexcept { return file_.IsOpen(); }
    void Close();
    const Port::StringBase<char>& GetFileName() const noexcept { return fileName_; }
    int GetError() const noexcept { return file_.GetError(); }

    void Flush() override;
    void Write(const char* text) override;
    void Write(int number) override;
    void WriteView(std::string_view text) override;

private:
    /// What a search for a place to break has found so far in the line. It goes on where it
    /// stopped, so a line of any length is searched once.
    struct BreakSearch {
        std::size_t searched = 0;
        std::size_t afterSpace = 0;
        std::size_t afterComma = 0;
        bool inLiteral = false;
        bool isComment = false;
    };

    void BeginLine();
    void AppendWrapping(std::string_view text);
    void SearchBreak();
    void BreakAt(std::size_t position);
    void AppendIndentation(int extraLevels);
    void EndBuffer();

    Port::File file_;
    bool replaces_ = false;
    std::optional<Port::Stream> stream_;
    Port::StringBase<char> fileName_;
    std::string line_;
    BreakSearch search_;
};

} // namespace Orn_Hdl
