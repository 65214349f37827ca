// The functions of the C interface for checks and proofs.
#include "C/Calls.h"
#include "C/Texts.h"
#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Proof.h"

#include <algorithm>
#include <iterator>

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::End;
using CInterface::FindingsEntity;
using CInterface::ModelEntity;
using CInterface::Require;
using namespace Orn_Hdl;

namespace {

static_assert(Check::TargetCount == ORN_HDL_TARGET_COUNT);

std::string_view NameOf(Check::Cause::Kind kind) noexcept {
    // In the order of the enumerators.
    static constexpr std::string_view Names[] = {"Design",
                                                 "DesignName",
                                                 "Component",
                                                 "Pin",
                                                 "Instance",
                                                 "Signal",
                                                 "Connection",
                                                 "Alias",
                                                 "Constant",
                                                 "ModuleAttribute",
                                                 "ComponentAttribute",
                                                 "InstanceAttribute",
                                                 "SignalAttribute",
                                                 "Comment",
                                                 "Library",
                                                 "UseClause",
                                                 "Include",
                                                 "Option"};
    static_assert(std::size(Names) == static_cast<std::size_t>(Check::Cause::Kind::Option) + 1);
    return Names[static_cast<std::size_t>(kind)];
}

void TakeCause(const Check::Cause& cause, CInterface::Finding& result) {
    result.cause = NameOf(cause.kind);
    result.first = cause.first;
    result.second = cause.second;
}

CInterface::Finding ToFinding(const Check::Finding& finding) {
    CInterface::Finding result;
    result.isError = finding.GetSeverity() == Check::Severity::Error;
    result.rule = finding.rule->name;
    result.message = finding.message;
    for (const std::string& note : finding.notes) {
        result.notes.append(note).push_back('\n');
    }
    TakeCause(finding.cause, result);
    for (const Check::Target target : Check::GetTargets()) {
        result.verdicts[static_cast<std::size_t>(target)] =
            static_cast<std::int32_t>(finding.verdicts.Get(target));
    }
    return result;
}

CInterface::Finding ToFinding(const Proof::Difference& difference) {
    CInterface::Finding result;
    result.rule = difference.rule == nullptr ? std::string_view() : difference.rule->name;
    result.message = difference.message;
    TakeCause(difference.cause, result);
    result.line = difference.line;
    result.column = difference.column;
    result.source = difference.source;
    return result;
}

template <class Found> void GiveFindings(const Found& found, orn_hdl_findings_t* findings) {
    auto entity = std::make_unique<FindingsEntity>();
    entity->findings.reserve(found.size());
    for (const auto& finding : found) {
        entity->findings.push_back(ToFinding(finding));
    }
    // The handle leads to the entity, which the destroying call deletes.
    findings->id = entity.release()->GetId();
}

Check::Targets ToTargets(orn_hdl_targets_t bits) {
    Check::Targets targets;
    for (const Check::Target target : Check::GetTargets()) {
        if ((bits & (1U << static_cast<unsigned>(target))) != 0) {
            targets.Add(target);
        }
    }
    return targets;
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_get_target(size_t index, const char** name) {
    return CInterface::Attempt(nullptr, [&] {
        Require(name != nullptr);
        if (index >= Check::TargetCount) {
            End(ORN_HDL_END);
        }
        // The names are literals.
        *name = Check::GetName(Check::GetTargets().at(index)).data();
    });
}

orn_hdl_status_t orn_hdl_get_rule(size_t index, orn_hdl_rule_t* rule) {
    return CInterface::Attempt(nullptr, [&] {
        Require(rule != nullptr);
        const std::vector<Check::Rule>& rules = Check::GetRules();
        if (index >= rules.size()) {
            End(ORN_HDL_END);
        }
        const auto toText = [](std::string_view text) -> orn_hdl_text_t {
            return {text.data(), text.size()};
        };
        const Check::Rule& found = rules[index];
        *rule = {toText(found.name), toText(found.what), toText(found.why), toText(found.example),
                 toText(found.help)};
    });
}

orn_hdl_status_t orn_hdl_model_check(orn_hdl_model_t model, orn_hdl_targets_t targets,
                                     orn_hdl_findings_t* findings) {
    return CInterface::LookAt(model, [&](ModelEntity& entity) {
        Require(findings != nullptr);
        const Model& checked = entity.model;
        GiveFindings(
            Check::Run(*checked.GetNetlist(), *entity.model.GetOptions(), ToTargets(targets)),
            findings);
    });
}

orn_hdl_status_t orn_hdl_model_check_legal(orn_hdl_model_t model, orn_hdl_findings_t* findings) {
    return CInterface::Change(model, [&](Model& target) {
        Require(findings != nullptr);
        const LegalNetlist legal(*target.GetNetlist(), *target.GetOptions());
        GiveFindings(legal.GetErrors(), findings);
    });
}

orn_hdl_status_t orn_hdl_model_prove(orn_hdl_model_t model, orn_hdl_language_t language,
                                     const char* fileName, orn_hdl_findings_t* findings) {
    return CInterface::Change(model, [&](Model& target) {
        Require(findings != nullptr);
        GiveFindings(Proof::Compare(Port::ViewOf(fileName), CInterface::ToLanguage(language),
                                    *target.GetNetlist(), *target.GetOptions()),
                     findings);
    });
}

orn_hdl_status_t orn_hdl_findings_get_count(orn_hdl_findings_t findings, size_t* count) {
    return CInterface::Look<FindingsEntity>(findings.id, [&](const FindingsEntity& entity) {
        Require(count != nullptr);
        *count = entity.findings.size();
    });
}

orn_hdl_status_t orn_hdl_findings_get(orn_hdl_findings_t findings, size_t index,
                                      orn_hdl_finding_t* finding) {
    return CInterface::Look<FindingsEntity>(findings.id, [&](const FindingsEntity& entity) {
        Require(finding != nullptr);
        if (index >= entity.findings.size()) {
            End(ORN_HDL_END);
        }
        const CInterface::Finding& found = entity.findings[index];
        CInterface::Texts texts;
        texts.Put(finding->rule, found.rule);
        texts.Put(finding->message, found.message);
        texts.Put(finding->notes, found.notes);
        texts.Put(finding->cause, found.cause);
        texts.Put(finding->first, found.first);
        texts.Put(finding->second, found.second);
        texts.Put(finding->source, found.source);
        texts.HandOut();
        finding->isError = found.isError ? 1 : 0;
        finding->line = found.line;
        finding->column = found.column;
        std::copy(std::begin(found.verdicts), std::end(found.verdicts), finding->verdicts);
    });
}

orn_hdl_status_t orn_hdl_findings_destroy(orn_hdl_findings_t findings) {
    FindingsEntity* entity = nullptr;
    const orn_hdl_status_t status = CInterface::Resolve(findings.id, entity);
    delete entity;
    return status;
}

} // extern "C"
