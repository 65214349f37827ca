#include "Orn_Hdl/LegalNetlist.h"

#include "Exception/Failure.h"
#include "HdlModel/Names/Names.h"
#include "Legal/Copy.h"
#include "Legal/Plan.h"
#include "Orn_Hdl/Writers/Verilog.h"
#include "Orn_Hdl/Writers/Vhdl.h"
#include "Writers/Text.h"

#include <algorithm>

namespace Orn_Hdl {

namespace {

std::vector<Check::Finding> FindErrors(const Netlist& netlist, const HdlOptions& options,
                                       Check::Targets targets) {
    Checking::Context context(netlist, options, targets, true);
    context.CheckAll();
    std::vector<Check::Finding> findings = context.TakeFindings();
    findings.erase(std::remove_if(findings.begin(), findings.end(),
                                  [](const Check::Finding& finding) {
                                      return finding.GetSeverity() != Check::Severity::Error;
                                  }),
                   findings.end());
    return findings;
}

[[noreturn]] void FailWith(const std::vector<Check::Finding>& errors) {
    std::string text;
    for (const Check::Finding& error : errors) {
        text.append(text.empty() ? "" : "\n").append(error.message);
        text.append(" [").append(error.rule->name).append("]");
    }
    Fail(LegalUnit, __LINE__, "No legal netlist can be written: %s.\n", {text});
}

} // namespace

struct LegalNetlist::Implementation {
    Implementation(Netlist& design, const HdlOptions& optionsInForce)
        : netlist(design), options(optionsInForce), plan(design, optionsInForce) {}

    void WriteLiterally(Netlist& written, const HdlOptions& writtenWith, Language language,
                        OutStream& out) const;
    void MakeCopy(Language language);

    Netlist& netlist;
    const HdlOptions& options;
    Legal::Plan plan;
    /// The design as it is written in one language; null until it is made.
    std::unique_ptr<Netlist> copy;
    HdlOptions copyOptions;
    Language copied = Language::Verilog;
};

LegalNetlist::LegalNetlist(Netlist& netlist, const HdlOptions& options)
    : implementation_(std::make_unique<Implementation>(netlist, options)) {}

LegalNetlist::~LegalNetlist() = default;

const std::vector<Check::Finding>& LegalNetlist::GetErrors() const noexcept {
    return implementation_->plan.GetErrors();
}

bool LegalNetlist::IsUnchanged() const noexcept {
    return !implementation_->plan.IsNeeded();
}

std::string LegalNetlist::GetName(const Object& object) const {
    const Legal::NewName* const changed = implementation_->plan.GetNames().Find(object);
    const bool isEscaped =
        changed != nullptr && (changed->verilog.front() == '\\' || changed->vhdl.front() == '\\');
    if (changed != nullptr && !isEscaped) {
        return changed->verilog;
    }
    const std::string_view name = object.GetNameView();
    if (object.GetObjectType() == ObjectTypePin) {
        return std::string(Writers::GetBaseName(static_cast<const Pin&>(object)));
    }
    return std::string(object.GetObjectType() == ObjectTypeSignal ? Names::BaseName(name) : name);
}

void LegalNetlist::Implementation::WriteLiterally(Netlist& written, const HdlOptions& writtenWith,
                                                  Language language, OutStream& out) const {
    if (language == Language::Vhdl) {
        VhdlNetlister(out).WriteLiterally(written, writtenWith);
    } else {
        VerilogNetlister(out).WriteLiterally(written, writtenWith);
    }
}

/// The changes are foreseen; what is left nevertheless is reported rather than written.
void LegalNetlist::Implementation::MakeCopy(Language language) {
    copy = nullptr;
    auto made = std::make_unique<Netlist>();
    Legal::Copier(netlist, plan, language, *made).CopyAll();
    copyOptions = plan.GetOptions();
    copyOptions.legal = true;
    const Check::Targets targets =
        language == Language::Vhdl ? Check::Targets::Vhdl() : Check::Targets::Verilog();
    const std::vector<Check::Finding> left = FindErrors(*made, copyOptions, targets);
    if (!left.empty()) {
        FailWith(left);
    }
    copy = std::move(made);
    copied = language;
}

void LegalNetlist::Prepare(Language language) {
    Implementation& own = *implementation_;
    if (!own.plan.GetErrors().empty()) {
        FailWith(own.plan.GetErrors());
    }
    if (own.plan.IsNeeded() && (own.copy == nullptr || own.copied != language)) {
        own.MakeCopy(language);
    }
}

void LegalNetlist::Write(Language language, OutStream& out) {
    Prepare(language);
    Implementation& own = *implementation_;
    if (own.copy == nullptr) {
        own.WriteLiterally(own.netlist, own.options, language, out);
        return;
    }
    own.copyOptions.writeHeader = own.options.writeHeader;
    own.WriteLiterally(*own.copy, own.copyOptions, language, out);
    if (!own.options.verify) {
        own.copy = nullptr;
    }
}

const Netlist& LegalNetlist::GetWrittenNetlist() const noexcept {
    return implementation_->copy != nullptr ? *implementation_->copy : implementation_->netlist;
}

const HdlOptions& LegalNetlist::GetWrittenOptions() const noexcept {
    return implementation_->copy != nullptr ? implementation_->copyOptions
                                            : implementation_->options;
}

} // namespace Orn_Hdl
