#include "Run.h"

#include "CommandsOutput.h"
#include "Gzip.h"
#include "LastingEngines.h"
#include "LegalNames.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/Ascii.h"
#include "Port/File.h"
#include "Progress.h"
#include "check/Checker.h"
#include "check/WriteGate.h"
#include "design/RunDesign.h"
#include "explain/FailureExplainer.h"
#include "proof/Certificate.h"
#include "proof/Differences.h"
#include "warnings/SlipFinder.h"

#include <algorithm>
#include <cstdint>
#include <optional>
#include <string_view>
#include <system_error>
#include <utility>

namespace Tool {

namespace {

/// The number of lines between two readings of the clock.
constexpr std::uint64_t LinesPerUpdate = 4096;

/// The name of the model if the commands come from standard input and do not name it.
constexpr const char* NamelessModel = "HDL_NETLIST";

/// The replay of one file: its progress, messages and status.
class Replayer {
public:
    Replayer(Orn_Hdl::Model& model, CommandFile& file, Checking::WriteGate* gate,
             const WarningOptions* warnings, Certificate* certificate)
        : model_(model), file_(file), gate_(gate), certificate_(certificate),
          explainer_(model, file.lines), asErrors_(warnings != nullptr && warnings->areErrors) {
        if (warnings != nullptr && !warnings->dropped.all()) {
            slips_.emplace(model, *warnings, [this](const FoundSlip& found) { Report(found); });
        }
    }
    Replayer(const Replayer&) = delete;
    Replayer& operator=(const Replayer&) = delete;

    /// Executes one line, which ends at `position` in the file. \return whether it succeeded.
    bool Execute(const Orn_Hdl::StringArray& words, std::uint64_t position) {
        ++lines_;
        if (lines_ % LinesPerUpdate == 0) {
            file_.progress.Update(lines_, position);
        }
        if (gate_ != nullptr && !gate_->Allows(words, lines_)) {
            status_ = Worse(status_, Status::Failed);
            return false;
        }
        try {
            model_.Execute(words);
        } catch (const Orn_Hdl::ProofException& exception) {
            const std::string netlist(words.GetView(words.GetSize() - 1));
            status_ = Worse(status_, ReportDifferences(exception.GetDifferences(), netlist, lines_,
                                                       file_.lines, file_.reporter));
            return false;
        } catch (const Orn_Hdl::Exception& exception) {
            if (!TellWhyNotLegal(words)) {
                Report(words, exception.getLocalized().GetView());
            }
            status_ = Worse(status_, Status::Failed);
            if (slips_) {
                slips_->Skip();
            }
            return false;
        }
        if (slips_) {
            words_ = &words;
            slips_->Look(words);
        }
        if (model_.GetWriteError() != 0) {
            return ReportWriteError(words);
        }
        return certificate_ == nullptr || !Checking::Checker::IsWrite(words) || Certify(words);
    }

    Status GetStatus() const noexcept { return status_; }
    std::uint64_t GetLineCount() const noexcept { return lines_; }
    std::uint64_t GetSlipCount() const noexcept { return slipCount_; }

private:
    /// Tells what keeps a write command from writing a legal netlist, with the lines that brought
    /// it in. \return whether there is anything.
    bool TellWhyNotLegal(const Orn_Hdl::StringArray& words) {
        if (!model_.GetOptions()->legal || !Checking::Checker::IsWrite(words)) {
            return false;
        }
        const Orn_Hdl::LegalNetlist legal(*model_.GetNetlist(), *model_.GetOptions());
        return Checking::WriteGate(model_, file_.lines, file_.reporter)
            .Tell(legal.GetErrors(), lines_);
    }

    bool Certify(const Orn_Hdl::StringArray& words) {
        const bool isVerilog = Port::EqualIgnoringCase(words.GetView(1), "VERILOG");
        const auto language = isVerilog ? Orn_Hdl::Language::Verilog : Orn_Hdl::Language::Vhdl;
        std::optional<Orn_Hdl::LegalNetlist> legal;
        if (model_.GetOptions()->legal) {
            legal.emplace(*model_.GetNetlist(), *model_.GetOptions());
        }
        // The command does not keep what it wrote in the design's place.
        const bool isOther = legal && !legal->IsUnchanged();
        if (isOther) {
            Orn_Hdl::OutStream nothing(nullptr);
            legal->Write(language, nothing);
        }
        const Status status =
            certificate_->AddNetlist(std::string(model_.GetWrittenFileName().GetView()), language,
                                     isOther ? legal->GetWrittenNetlist() : *model_.GetNetlist());
        status_ = Worse(status_, status);
        return status == Status::Success;
    }

    void Report(const Orn_Hdl::StringArray& words, std::string_view text) {
        file_.reporter.Report(explainer_.Explain(lines_, words, text));
    }

    /// Reports a slip in the present line.
    void Report(const FoundSlip& found) {
        const Warning& warning = GetWarning(found.slip);
        ++slipCount_;
        Diagnostic diagnostic;
        diagnostic.severity = asErrors_ ? Severity::Error : Severity::Warning;
        diagnostic.rule = warning.name;
        diagnostic.place = file_.lines.GetPlace(lines_, *words_, found.mark);
        diagnostic.message = found.message;
        diagnostic.notes.push_back(
            {found.hint.empty() ? "what helps: " + std::string(warning.help) : found.hint});
        file_.reporter.Report(std::move(diagnostic));
    }

    bool ReportWriteError(const Orn_Hdl::StringArray& words) {
        std::string text("cannot write ");
        text.append(model_.GetWrittenFileName().GetView()).append(": ");
        text.append(Port::ErrorText(model_.GetWriteError()).GetView());
        if (const std::uint64_t leftover = model_.GetWriteLeftover(); leftover != 0) {
            text.append("; the last ").append(std::to_string(leftover));
            text.append(" bytes of the file are a part of the new text");
        }
        Report(words, text);
        status_ = Status::File;
        // The model keeps the error of its last write. Clear it, so that it is reported once.
        model_.RecordWrite("", 0);
        return false;
    }

    Orn_Hdl::Model& model_;
    CommandFile& file_;
    Checking::WriteGate* const gate_;
    Certificate* const certificate_;
    FailureExplainer explainer_;
    const bool asErrors_;
    /// Without a value if no slips are reported.
    std::optional<SlipFinder> slips_;
    /// The line that `slips_` looks at.
    const Orn_Hdl::StringArray* words_ = nullptr;
    std::uint64_t slipCount_ = 0;
    std::uint64_t lines_ = 0;
    Status status_ = Status::Success;
};

} // namespace

std::string GetModelName(const std::string& file, const std::optional<std::string>& asked) {
    if (asked) {
        return *asked;
    }
    if (file == "-") {
        return NamelessModel;
    }
    const std::string name(WithoutGzip(file));
    return std::string(Port::FileName(name.c_str()).GetStem().GetView());
}

CommandFile::CommandFile(const std::string& fileName, const ReportOptions& report,
                         Progress& shownProgress)
    : name(fileName), progress(shownProgress), lines(fileName, SystemFileName(fileName.c_str())),
      own_(std::in_place, report, [&shownProgress] { shownProgress.Erase(); }), reporter(*own_) {}

CommandFile::CommandFile(const std::string& fileName, Reporter& shared, Progress& shownProgress)
    : name(fileName), progress(shownProgress), lines(fileName, SystemFileName(fileName.c_str())),
      reporter(shared) {}

Replayed Replay(Orn_Hdl::Model& model, CommandFile& file, bool keepGoing, const WriteRules& rules,
                Checking::WriteGate* gate, const WarningOptions* warnings,
                Certificate* certificate) {
    Orn_Hdl::CommandReader input(model);
    if (!input.Open(SystemFileName(file.name.c_str()))) {
        return {ComplainUnreadable(file.name, input.GetError()), false, 0};
    }
    std::optional<RulesInForce> inForce;
    try {
        inForce.emplace(model, rules);
    } catch (const std::system_error& error) {
        return {ComplainUnwritable(rules.folder.value_or(""), error.code().value()), false, 0};
    }
    Replayer replayer(model, file, gate, warnings, certificate);
    while (const Orn_Hdl::StringArray* words = input.Next()) {
        if (!replayer.Execute(*words, input.GetPosition()) &&
            (!keepGoing || file.reporter.IsAtLimit())) {
            return {replayer.GetStatus(), false, 0};
        }
    }
    if (input.GetError() != 0) {
        file.progress.Erase();
        return {ComplainUnreadable(file.name, input.GetError()), false, 0};
    }
    return {replayer.GetStatus(), true, replayer.GetLineCount(), replayer.GetSlipCount()};
}

TellDifferences TellOf(CommandFile& file, std::uint64_t lines) {
    return [&file, lines](const std::vector<Orn_Hdl::Proof::Difference>& differences,
                          const std::string& netlist) {
        return ReportDifferences(differences, netlist, lines, file.lines, file.reporter);
    };
}

namespace {

/// Writes the outputs and the table of names, or tells why there is no legal netlist.
Status WriteLegally(Orn_Hdl::Model& model, const Outputs& outputs, const RunOptions& options,
                    std::uint64_t lines, CommandFile& file, Certificate& certificate) {
    if (outputs.IsEmpty() && options.nameMap.empty()) {
        return Status::Success;
    }
    Orn_Hdl::LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
    if (Checking::WriteGate(model, file.lines, file.reporter).Tell(legal.GetErrors(), lines)) {
        return Status::Failed;
    }
    OutputFile nameMap(options.nameMap);
    if (Port::Stream* out = nameMap.GetStream()) {
        WriteLegalNames(*model.GetNetlist(), legal, *out);
    }
    Status status = nameMap.Flush();
    if (status == Status::Success) {
        status =
            WriteOutputs(model, outputs, file.progress, &legal, TellOf(file, lines), certificate);
    }
    return status == Status::Success ? nameMap.Commit() : status;
}

/// Writes the commands of the model. The name of the file in hand is not the design's own.
Status WriteCommands(Orn_Hdl::Model& model, const std::string& file, CommandsOutput& commands) {
    const Port::String source = model.GetSourceFileName();
    if (source.GetView() == file) {
        model.SetSourceFileName("");
    }
    const Status status = commands.Write(model);
    model.SetSourceFileName(source);
    return status;
}

/// Replays the file of the options and writes its netlists.
Status ReplayAndWrite(Orn_Hdl::Model& model, CommandFile& file, const RunOptions& options) {
    Checking::WriteGate gate(model, file.lines, file.reporter);
    Certificate certificate(options.certificate);
    const Replayed replayed =
        Replay(model, file, options.keepGoing, options.writeRules, options.check ? &gate : nullptr,
               &options.warnings, options.certificate.empty() ? nullptr : &certificate);
    if (!replayed.complete) {
        return replayed.status;
    }
    if (options.warnings.areErrors && replayed.slips > 0) {
        return Worse(replayed.status, Status::Failed);
    }
    // A write changes the design, so the commands come first. Their file is replaced last.
    CommandsOutput commands(options.commandFile);
    const Status saved = WriteCommands(model, options.file, commands);
    if (saved != Status::Success) {
        return Worse(replayed.status, saved);
    }
    Outputs outputs = options.outputs;
    Status status = replayed.status;
    for (auto& [language, name] : outputs.files) {
        if (options.check && !name.empty() && !gate.Allows(language, replayed.lines)) {
            name.clear();
            status = Worse(status, Status::Failed);
        }
    }
    const Status written =
        options.legal ? WriteLegally(model, outputs, options, replayed.lines, file, certificate)
                      : WriteOutputs(model, outputs, file.progress, nullptr,
                                     TellOf(file, replayed.lines), certificate);
    status = Worse(status, written);
    if (written == Status::Success) {
        status = Worse(status, commands.Commit());
    }
    if (status != Status::Success || !certificate.IsWanted()) {
        return status;
    }
    status = certificate.AddCommands(file.name, file.lines.GetSystemName());
    return status == Status::Success ? certificate.Write() : status;
}

} // namespace

Status Run(const RunOptions& options) {
    if (!options.files.empty()) {
        return RunDesign(options);
    }
    const auto isOut = [](const auto& output) { return output.second == "-"; };
    if (!options.certificate.empty() &&
        (options.file == "-" ||
         std::any_of(options.outputs.files.begin(), options.outputs.files.end(), isOut))) {
        Complain("a certificate is of files: name the command file and the netlists");
        return Status::Usage;
    }
    Progress progress(options.quiet, options.file);
    CommandFile file(options.file, options.report, progress);
    DropLastingEngines();
    Orn_Hdl::Engine& engine = MakeLastingEngine();
    const std::string name = GetModelName(options.file, options.model);
    engine.CreateAndAddModel(name.c_str(), options.file.c_str());
    Orn_Hdl::Model& model = *engine.GetModel(name.c_str());
    model.GetOptions()->legal = options.legal;
    model.GetOptions()->escapeNames = options.names == "escape";
    model.GetOptions()->verify = options.verify;
    model.GetOptions()->dontCares = options.dontCares;
    model.GetOptions()->threads = options.threads;
    const Status status = ReplayAndWrite(model, file, options);
    file.reporter.Finish(GetWarningRules());
    return status;
}

} // namespace Tool
