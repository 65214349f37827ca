// The output files named on the command line.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Proof.h"
#include "Port/File.h"
#include "Tool.h"

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Orn_Hdl {
class LegalNetlist;
class Model;
} // namespace Orn_Hdl

namespace Tool {

class Certificate;
class Progress;
class TemporaryFile;

/// The netlists to write.
struct Outputs {
    /// The file of each language; "-" is standard output, and an empty name writes none.
    std::map<Orn_Hdl::Language, std::string> files;
    bool noHeader = false;
    /// The folder for one file a model; empty for one file for all. With a folder, the files of the
    /// languages are lists of these files.
    std::string folder;

    /// Whether there is nothing to write.
    bool IsEmpty() const;
};

/// A text file that is written as a whole: an existing file does not change before `Commit`. If the
/// name is empty, there is no file, and nothing fails.
class OutputFile {
public:
    /// Prints a message if the file cannot be written.
    explicit OutputFile(const std::string& name);
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;
    ~OutputFile();

    /// The stream to write to; null if there is no file or it cannot be written.
    Port::Stream* GetStream() noexcept { return stream_ ? &*stream_ : nullptr; }
    /// Writes the buffered text, and prints a message if any of the text was lost.
    Status Flush();
    /// Replaces the named file, and prints a message if that fails.
    Status Commit();

private:
    bool Open();
    Status Check(bool good);

    const std::string name_;
    /// What is written of a compressed file.
    std::unique_ptr<TemporaryFile> contents_;
    Port::File file_;
    std::optional<Port::Stream> stream_;
    Status status_ = Status::Success;
};

/// Reports that a netlist does not mean what its design does. \return the exit status.
using TellDifferences = std::function<Status(
    const std::vector<Orn_Hdl::Proof::Difference>& differences, const std::string& netlist)>;

/// Writes the netlists in the order of their languages, and prints a message for each that could
/// not be written.
/// \param legal the legal netlist of the model, without errors; null to write the design as it
///        stands.
/// \param tell reports what the proof finds that the model's options ask for.
/// \param certificate gets what was proven.
Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress,
                    Orn_Hdl::LegalNetlist* legal, const TellDifferences& tell,
                    Certificate& certificate);

} // namespace Tool
