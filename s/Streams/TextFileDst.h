// The file destination.
#pragma once

#include "Port/File.h"
#include "Streams/LineDst.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace Orn_Hdl {

class TextFileDst final : public LineDst {
public:
    TextFileDst() = default;
    TextFileDst(const char* fileName, TextFileOutStream::Mode mode);
    /// Opens the file at `path` below a folder.
    TextFileDst(const Port::Folder& folder, const char* path, const char* fileName,
                TextFileOutStream::Mode mode);
    TextFileDst(const TextFileDst&) = delete;
    TextFileDst& operator=(const TextFileDst&) = delete;
    ~TextFileDst() override;

    bool Open(const char* fileName, TextFileOutStream::Mode mode);
    bool IsOpen() const noexcept { return file_.IsOpen(); }
    void Close();
    const Port::StringBase<char>& GetFileName() const noexcept { return fileName_; }
    int GetError() const noexcept { return file_.GetError(); }
    std::uint64_t GetLeftoverSize() const noexcept { return file_.GetLeftoverSize(); }
    /// The name under which the file can be read that is to replace another; empty if none is.
    std::string GetTemporaryName() const { return file_.GetTemporaryName(); }
    /// Writes the bytes of a file. \return 0, or the error number if it cannot be read.
    int CopyFile(const char* fileName);

    void Flush() override;

private:
    std::unique_ptr<BranchDst> MakeBranch() const override;
    bool TakeLines(std::string_view lines) override;
    bool IsWriting() const noexcept override { return isGood_; }
    bool MakeRoom(std::size_t size) override;
    void WriteLongLine(std::string_view text) override;
    void Send(std::string_view text);
    void SendLines();

    Port::File file_;
    bool replaces_ = false;
    bool isGood_ = true;
    Port::StringBase<char> fileName_;
};

} // namespace Orn_Hdl
