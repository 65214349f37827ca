// A file with a JSON netlist, which is read piece by piece.
#pragma once

#include "Gzip.h"
#include "Progress.h"
#include "Tool.h"
#include "import/TextSource.h"

#include "Port/File.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace Tool {

/// A file, or standard input, which may be compressed.
class JsonFile final : public Import::TextSource {
public:
    /// \param name "-" stands for standard input. \param progress shows how much was read.
    /// \throws GzipError if a compressed file cannot be opened.
    JsonFile(const std::string& name, Progress& progress);

    /// \throws GzipError if a compressed file cannot be read.
    std::size_t Read(char* to, std::size_t count) override;

    /// Whether reading ahead is worth a thread: the file is regular, so that nobody waits for more
    /// of it, and not small.
    bool IsLarge() const noexcept;
    /// Reads what is left of a compressed file, to see whether it is damaged.
    /// \throws GzipError if it is.
    void CheckRest();
    /// Whether the file was opened, and read without an error. Prints a message if not.
    Status GetStatus() const;
    /// The beginning of what was read.
    const std::string& GetBeginning() const noexcept { return beginning_; }

private:
    std::string name_;
    Progress& progress_;
    Port::File file_;
    std::optional<GzipReader> compressed_;
    bool isOpen_ = false;
    std::uint64_t bytes_ = 0;
    std::string beginning_;
};

} // namespace Tool
