#include "design/RunDesign.h"

#include "LastingEngines.h"
#include "LegalNames.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Progress.h"
#include "check/WriteGate.h"
#include "design/ComponentCheck.h"
#include "design/DesignOutput.h"
#include "design/LegalDesign.h"
#include "design/ModelLinks.h"
#include "proof/Certificate.h"
#include "warnings/SlipFinder.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace Tool {

namespace {

/// One command file and its model.
struct FileOfDesign {
    FileOfDesign(const std::string& name, bool quiet, Reporter& reporter)
        : progress(quiet, name), file(name, reporter, progress) {}

    Progress progress;
    CommandFile file;
    Orn_Hdl::Model* model = nullptr;
    Replayed replayed;
};

/// The run of one command line.
class DesignRun {
public:
    explicit DesignRun(const RunOptions& options)
        : options_(options), reporter_(options.report, [this] { EraseProgress(); }) {}
    DesignRun(const DesignRun&) = delete;
    DesignRun& operator=(const DesignRun&) = delete;

    Status Run();
    Reporter& GetReporter() noexcept { return reporter_; }

private:
    void EraseProgress();
    Status Replay();
    Status Replay(FileOfDesign& file);
    Status CheckDesign();
    bool TellSameNames();
    Status Write();
    Status PlanLegally(std::optional<LegalDesign>& legal);
    Outputs GetAllowedOutputs(Status& status);
    Status WriteNames(const LegalDesign& legal, OutputFile& nameMap) const;
    std::vector<Orn_Hdl::Model*> GetModels() const;
    void Report(const FileOfDesign& file, std::string message);

    const RunOptions& options_;
    Reporter reporter_;
    std::vector<std::unique_ptr<FileOfDesign>> files_;
    /// Used models first.
    std::vector<std::size_t> order_;
};

void DesignRun::EraseProgress() {
    if (!files_.empty()) {
        files_.back()->progress.Erase();
    }
}

void DesignRun::Report(const FileOfDesign& file, std::string message) {
    Diagnostic diagnostic;
    diagnostic.place.file = file.file.name;
    diagnostic.message = std::move(message);
    reporter_.Report(std::move(diagnostic));
}

std::vector<Orn_Hdl::Model*> DesignRun::GetModels() const {
    std::vector<Orn_Hdl::Model*> models;
    for (const std::unique_ptr<FileOfDesign>& file : files_) {
        models.push_back(file->model);
    }
    return models;
}

Status DesignRun::Run() {
    const Status replayed = Replay();
    const bool isComplete =
        std::all_of(files_.begin(), files_.end(), [](const std::unique_ptr<FileOfDesign>& file) {
            return file->replayed.complete;
        });
    const bool hasSlips = std::any_of(files_.begin(), files_.end(),
                                      [](const auto& file) { return file->replayed.slips > 0; });
    if (!isComplete) {
        return replayed;
    }
    if (options_.warnings.areErrors && hasSlips) {
        return Worse(replayed, Status::Failed);
    }
    const Status checked = CheckDesign();
    return Worse(replayed, checked == Status::Success ? Write() : checked);
}

Status DesignRun::Replay() {
    DropLastingEngines();
    Status status = Status::Success;
    for (const std::string& name : options_.files) {
        files_.push_back(std::make_unique<FileOfDesign>(name, options_.quiet, reporter_));
        status = Worse(status, Replay(*files_.back()));
        if (!files_.back()->replayed.complete) {
            break;
        }
    }
    return status;
}

Status DesignRun::Replay(FileOfDesign& file) {
    // Models of one engine need different names before they are replayed.
    Orn_Hdl::Engine& engine = MakeLastingEngine();
    const std::string name = GetModelName(file.file.name, {});
    engine.CreateAndAddModel(name, file.file.name);
    file.model = engine.GetModel(name);
    file.model->GetOptions()->legal = options_.legal;
    file.model->GetOptions()->escapeNames = options_.names == "escape";
    file.model->GetOptions()->verify = options_.verify;
    file.model->GetOptions()->dontCares = options_.dontCares;
    file.model->GetOptions()->threads = options_.threads;
    Checking::WriteGate gate(*file.model, file.file.lines, reporter_);
    file.replayed = Tool::Replay(*file.model, file.file, options_.keepGoing, options_.writeRules,
                                 options_.check ? &gate : nullptr, &options_.warnings);
    file.progress.Erase();
    return file.replayed.status;
}

/// Whether two files make a design of one name, which is reported.
bool DesignRun::TellSameNames() {
    ModelLinks links(GetModels());
    bool isTold = false;
    for (std::size_t i = 0; i < files_.size(); ++i) {
        const std::string name(files_[i]->model->GetNetlist()->GetNameView());
        if (const std::size_t first = *links.Find(name); first != i) {
            Report(*files_[i], "the design has the name \"" + name + "\", as that of " +
                                   files_[first]->file.name + " has");
            isTold = true;
        }
    }
    return isTold;
}

Status DesignRun::CheckDesign() {
    if (TellSameNames()) {
        return Status::Failed;
    }
    ModelLinks links(GetModels());
    order_ = links.Order();
    if (order_.empty()) {
        std::string chain;
        for (const std::size_t model : links.GetChain()) {
            chain.append(chain.empty() ? "\"" : " > \"");
            chain.append(files_[model]->model->GetNetlist()->GetNameView()).append("\"");
        }
        Report(*files_[links.GetChain().front()], "the design contains itself: " + chain);
        return Status::Failed;
    }
    std::vector<ModelOfFile> models;
    for (const std::unique_ptr<FileOfDesign>& file : files_) {
        models.push_back({file->model, &file->file.lines});
    }
    return CheckComponents(models, links, reporter_) ? Status::Success : Status::Failed;
}

/// Makes the legal netlists, or tells why there are none.
Status DesignRun::PlanLegally(std::optional<LegalDesign>& legal) {
    std::vector<Orn_Hdl::Model*> models;
    for (const std::size_t index : order_) {
        models.push_back(files_[index]->model);
    }
    legal.emplace(models);
    bool isLegal = legal->GetProblem().empty();
    if (!isLegal) {
        Report(*files_.front(), legal->GetProblem());
    }
    for (std::size_t i = 0; i < order_.size(); ++i) {
        FileOfDesign& file = *files_[order_[i]];
        isLegal &= !Checking::WriteGate(*file.model, file.file.lines, reporter_)
                        .Tell(legal->Get(i).GetErrors(), file.replayed.lines);
    }
    return isLegal ? Status::Success : Status::Failed;
}

/// The outputs without the languages for which a design has errors.
Outputs DesignRun::GetAllowedOutputs(Status& status) {
    Outputs outputs = options_.outputs;
    for (auto& [language, name] : outputs.files) {
        for (const std::unique_ptr<FileOfDesign>& file : files_) {
            Checking::WriteGate gate(*file->model, file->file.lines, reporter_);
            if (options_.check && !name.empty() && !gate.Allows(language, file->replayed.lines)) {
                name.clear();
                status = Status::Failed;
            }
        }
    }
    return outputs;
}

Status DesignRun::WriteNames(const LegalDesign& legal, OutputFile& nameMap) const {
    if (Port::Stream* out = nameMap.GetStream()) {
        for (std::size_t i = 0; i < order_.size(); ++i) {
            WriteLegalNames(*files_[order_[i]]->model->GetNetlist(), legal.Get(i), *out);
        }
    }
    return nameMap.Flush();
}

Status DesignRun::Write() {
    Status status = Status::Success;
    const Outputs outputs = GetAllowedOutputs(status);
    if (outputs.IsEmpty() && options_.nameMap.empty()) {
        return status;
    }
    std::optional<LegalDesign> legal;
    OutputFile nameMap(options_.nameMap);
    if (options_.legal) {
        const Status planned = PlanLegally(legal);
        const Status named = planned == Status::Success ? WriteNames(*legal, nameMap) : planned;
        if (named != Status::Success) {
            return Worse(status, named);
        }
    }
    std::vector<DesignModel> models(files_.size());
    for (std::size_t i = 0; i < order_.size(); ++i) {
        FileOfDesign& file = *files_[order_[i]];
        models[order_[i]] = {file.model, legal ? &legal->Get(i) : nullptr,
                             TellOf(file.file, file.replayed.lines)};
    }
    Progress progress(options_.quiet, options_.files.front());
    Certificate none("");
    status = Worse(status, WriteDesign(models, outputs, progress, none));
    return status == Status::Success ? nameMap.Commit() : status;
}

/// The first option that a run of several files does not have; empty for none.
std::string FindSingleOption(const RunOptions& options) {
    if (options.model) {
        return "--model";
    }
    if (!options.commandFile.empty()) {
        return "--output-commands";
    }
    return options.certificate.empty() ? "" : "--certificate";
}

} // namespace

Status RunDesign(const RunOptions& options) {
    const std::string single = FindSingleOption(options);
    if (!single.empty()) {
        Complain(single + " is for one command file; see --help");
        return Status::Usage;
    }
    if (std::count(options.files.begin(), options.files.end(), "-") > 1) {
        Complain("standard input can be read once");
        return Status::Usage;
    }
    DesignRun run(options);
    const Status status = run.Run();
    run.GetReporter().Finish(GetWarningRules());
    return status;
}

} // namespace Tool
