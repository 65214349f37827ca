// `orn-hdl run`: replays a command file and writes netlists.
#pragma once

#include "Output.h"
#include "Tool.h"
#include "WriteRules.h"
#include "diagnostics/CommandLines.h"
#include "diagnostics/Reporter.h"
#include "warnings/Table.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

class Certificate;
class Progress;

namespace Checking {
class WriteGate;
}

struct RunOptions {
    /// The command file; "-" is standard input.
    std::string file;
    /// The command files, if there are several; each becomes a model of its own.
    std::vector<std::string> files;
    /// The name of the model; the default is the file's name without folder and extension.
    std::optional<std::string> model;
    Outputs outputs;
    WriteRules writeRules;
    /// Continue after an error.
    bool keepGoing = false;
    bool quiet = false;
    /// Write nothing that has errors for its language.
    bool check = false;
    /// Write legal netlists, or nothing.
    bool legal = false;
    /// The file for the commands of the design in which the replay ends; "-" is standard output,
    /// and an empty name is none.
    std::string commandFile;
    /// Read each netlist back and compare it with the design before it replaces its file.
    bool verify = false;
    /// The file for the certificate of the netlists; empty for none.
    std::string certificate;
    /// How a legal netlist changes names: "rename" or "escape".
    std::string names = "rename";
    /// The file for the table of old and new names; empty for none.
    std::string nameMap;
    /// Whether the digit "-" of a constant is a don't care.
    bool dontCares = false;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
    ReportOptions report;
    WarningOptions warnings;
};

Status Run(const RunOptions& options);

/// The name of a command file's model: the one asked for, or else the file's name without folder
/// and extension.
std::string GetModelName(const std::string& file, const std::optional<std::string>& asked);

/// The result of a replay.
struct Replayed {
    Status status = Status::Success;
    /// Whether the replay reached the end of the file.
    bool complete = false;
    /// How many lines were replayed.
    std::uint64_t lines = 0;
    /// How many slips were found.
    std::uint64_t slips = 0;
};

/// A command file, and where messages about it go.
struct CommandFile {
    /// \param fileName the file; "-" is standard input.
    CommandFile(const std::string& fileName, const ReportOptions& report, Progress& shownProgress);
    /// One of several files, whose messages go to one reporter.
    CommandFile(const std::string& fileName, Reporter& shared, Progress& shownProgress);

    const std::string name;
    Progress& progress;
    CommandLines lines;

private:
    std::optional<Reporter> own_;

public:
    Reporter& reporter;
};

/// Reports differences at the lines of a command file, or at its last one.
TellDifferences TellOf(CommandFile& file, std::uint64_t lines);

/// Replays a command file into a model. Every line that fails, and every netlist that a line could
/// not write, is reported with file and line; the replay ends there unless `keepGoing` is true.
/// \param gate decides which lines may write; null when all may.
/// \param warnings the slips that are reported; null for none.
/// \param certificate gets the netlists that lines have written; null for none.
Replayed Replay(Orn_Hdl::Model& model, CommandFile& file, bool keepGoing,
                const WriteRules& rules = {}, Checking::WriteGate* gate = nullptr,
                const WarningOptions* warnings = nullptr, Certificate* certificate = nullptr);

} // namespace Tool
