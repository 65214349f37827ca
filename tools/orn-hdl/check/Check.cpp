#include "check/Check.h"

#include "check/Checker.h"
#include "check/Located.h"
#include "check/Report.h"
#include "design/ComponentCheck.h"
#include "design/ModelLinks.h"

#include "LastingEngines.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"
#include "Run.h"
#include "diagnostics/CommandLines.h"
#include "explain/FailureExplainer.h"
#include "load/RereadableFile.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <iterator>
#include <memory>
#include <sstream>
#include <string_view>
#include <utility>

namespace Tool {

namespace {

using Checking::Checker;
using Checking::Located;
using Checking::Reported;
using Orn_Hdl::Check;

/// The replay of one file, with a check at each line that would write.
class FileCheck {
public:
    /// \param engine holds the design, and no other one.
    FileCheck(Orn_Hdl::Engine& engine, const CheckOptions& options, const std::string& file,
              Check::Targets targets, Reporter& reporter)
        : engine_(engine), options_(options), file_(file), source_(file),
          lines_(file, source_.GetName()), reporter_(reporter), targets_(targets) {}

    /// Adds the findings to `all`, unless a line fails.
    Status Run(std::vector<Reported>& all);
    ModelOfFile GetModel() { return {model_, &lines_}; }

private:
    Status Replay();
    bool Execute(const Orn_Hdl::StringArray& words);
    void Report(const Orn_Hdl::StringArray& words, std::string_view text);

    Orn_Hdl::Engine& engine_;
    const CheckOptions& options_;
    const std::string& file_;
    const RereadableFile source_;
    CommandLines lines_;
    Reporter& reporter_;
    const Check::Targets targets_;
    Orn_Hdl::Model* model_ = nullptr;
    std::unique_ptr<Checker> checker_;
    std::vector<Located> findings_;
    std::uint64_t line_ = 0;
};

bool FileCheck::Execute(const Orn_Hdl::StringArray& words) {
    ++line_;
    try {
        if (checker_->IsWrite(words)) {
            checker_->CheckWrite(words, line_, findings_);
        } else {
            checker_->BeforeCommand(words);
            model_->Execute(words);
        }
        return true;
    } catch (const Orn_Hdl::Exception& exception) {
        Report(words, exception.getLocalized().GetView());
        return false;
    }
}

void FileCheck::Report(const Orn_Hdl::StringArray& words, std::string_view text) {
    reporter_.Report(FailureExplainer(*model_, lines_).Explain(line_, words, text));
}

Status FileCheck::Replay() {
    Orn_Hdl::CommandReader input(*model_);
    if (!input.Open(source_.GetName())) {
        return ComplainUnreadable(file_, input.GetError());
    }
    while (const Orn_Hdl::StringArray* words = input.Next()) {
        if (!Execute(*words)) {
            return Status::Failed;
        }
    }
    return input.GetError() == 0 ? Status::Success : ComplainUnreadable(file_, input.GetError());
}

Status FileCheck::Run(std::vector<Reported>& all) {
    const std::string name = GetModelName(file_, options_.model);
    engine_.CreateAndAddModel(name.c_str(), file_.c_str());
    model_ = engine_.GetModel(name.c_str());
    model_->GetOptions()->dontCares = options_.dontCares;
    model_->GetOptions()->threads = options_.threads;
    checker_ = std::make_unique<Checker>(*model_, targets_);
    const Status status = Replay();
    if (status != Status::Success) {
        return status;
    }
    if (!checker_->IsChecked()) {
        checker_->CheckAll(line_, findings_);
    }
    if (!Checking::Locate(source_.GetName(), findings_)) {
        return ComplainUnreadable(file_, 0);
    }
    for (Reported& reported : Checking::MakeReports(findings_, lines_)) {
        all.push_back(std::move(reported));
    }
    return Status::Success;
}

/// Checks all files, and the components of each that are models of others.
Status CheckAll(const CheckOptions& options, Check::Targets targets, Reporter& reporter,
                std::vector<Reported>& findings) {
    DropLastingEngines();
    std::vector<std::unique_ptr<FileCheck>> checks;
    std::vector<ModelOfFile> checked;
    std::vector<Orn_Hdl::Model*> models;
    Status status = Status::Success;
    for (const std::string& file : options.files) {
        checks.push_back(
            std::make_unique<FileCheck>(MakeLastingEngine(), options, file, targets, reporter));
        const Status one = checks.back()->Run(findings);
        if (one == Status::Success) {
            checked.push_back(checks.back()->GetModel());
            models.push_back(checked.back().model);
        }
        status = Worse(status, one);
    }
    // A single design is checked as it stands, even if it has a component of its own name.
    const bool agree =
        options.files.size() == 1 || CheckComponents(checked, ModelLinks(models), reporter);
    return agree ? status : Worse(status, Status::Failed);
}

bool ReadTargets(const std::string& names, Check::Targets& targets) {
    targets = names.empty() ? Check::Targets::All() : Check::Targets();
    std::istringstream rest(names);
    for (std::string name; std::getline(rest, name, ',');) {
        Check::Target target = {};
        if (!Check::FindTarget(name, target)) {
            std::string known;
            for (const Check::Target each : Check::GetTargets()) {
                known.append(known.empty() ? "" : ", ").append(Check::GetName(each));
            }
            std::string message = "there is no target ";
            Complain(message.append(name).append("; there are ").append(known));
            return false;
        }
        targets.Add(target);
    }
    return true;
}

Status ExplainRule(const std::string& name) {
    const Check::Rule* const rule = Check::FindRule(name);
    if (rule == nullptr) {
        Complain("there is no rule " + name + "; check --list lists them");
        return Status::Usage;
    }
    return Print(Checking::Explain(*rule));
}

bool Fails(const Reported& reported, const std::string& failOn) {
    return failOn == "warning" ||
           (failOn == "error" && reported.diagnostic.severity == Severity::Error);
}

} // namespace

Status CheckFiles(const CheckOptions& options) {
    if (options.markdown) {
        return Print(Checking::ListRulesAsMarkdown());
    }
    if (options.list) {
        return Print(Checking::ListRules());
    }
    if (!options.explain.empty()) {
        return ExplainRule(options.explain);
    }
    Check::Targets targets;
    if (options.files.empty()) {
        Complain("a command file is needed; check --help tells more");
        return Status::Usage;
    }
    if (!ReadTargets(options.targets, targets)) {
        return Status::Usage;
    }
    Reporter reporter(options.report);
    std::vector<Reported> findings;
    Status status = CheckAll(options, targets, reporter, findings);
    // Programs get one document, with the lines that failed before the findings.
    std::vector<Reported> all;
    for (Diagnostic& failure : reporter.TakeCollected()) {
        all.push_back(Reported{std::move(failure), {}});
    }
    std::move(findings.begin(), findings.end(), std::back_inserter(all));
    const Checking::TextStyle style{UsesColor(options.report.color, stdout),
                                    static_cast<std::size_t>(reporter.GetErrorCount())};
    status = Worse(status, Print(Checking::Format(all, options.report.format, style)));
    for (const Reported& reported : all) {
        if (Fails(reported, options.failOn)) {
            return Worse(status, Status::Failed);
        }
    }
    return status;
}

} // namespace Tool
