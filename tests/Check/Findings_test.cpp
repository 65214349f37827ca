// Every finding in the command files of the rules, with its verdicts, cause, objects and notes.

#include "Orn_Hdl/Check.h"

#include "Support/RuleFiles.h"

#include <string>

namespace Orn_Hdl {
namespace {

std::string Describe(const Check::Cause& cause) {
    return std::to_string(static_cast<int>(cause.kind)) + " \"" + cause.first + "\" \"" +
           cause.second + "\"";
}

std::string Describe(const Check::Finding& finding) {
    std::string text(finding.rule->name);
    text += ": " + finding.message + "\n    ";
    for (const Check::Target target : Check::GetTargets()) {
        text += ".wmr"[static_cast<int>(finding.verdicts.Get(target))];
    }
    text +=
        "\n    cause " + Describe(finding.cause) + "\n    other " + Describe(finding.other) + "\n";
    for (const Object* object : finding.objects) {
        text.append("    object ").append(object->GetNameView()).append("\n");
    }
    for (const std::string& note : finding.notes) {
        text.append("    note ").append(note).append("\n");
    }
    return text;
}

TEST(Findings, AreThoseOfTheRulesFiles) {
    CommandFactory factory;
    for (const auto& folder : Support::RuleFolders()) {
        std::string text;
        for (const char* name : {"bad", "good"}) {
            const auto model = Support::ReadDesign(factory, folder / (std::string(name) + ".cmd"));
            text.append("# ").append(name).append("\n");
            for (const Check::Finding& finding :
                 Check::Run(*model->GetNetlist(), *model->GetOptions())) {
                text += Describe(finding);
            }
        }
        Support::ExpectFile(folder / "findings.txt", text);
    }
}

TEST(Findings, OfFewerTargetsAreThoseThatConcernThem) {
    CommandFactory factory;
    for (const auto& folder : Support::RuleFolders()) {
        const auto model = Support::ReadDesign(factory, folder / "bad.cmd");
        const std::vector<Check::Finding> all =
            Check::Run(*model->GetNetlist(), *model->GetOptions());
        for (const Check::Target target : Check::GetTargets()) {
            Check::Targets one;
            one.Add(target);
            std::vector<std::string> expected;
            for (const Check::Finding& finding : all) {
                if (finding.verdicts.Get(target) != Check::Verdict::Accepts) {
                    expected.emplace_back(finding.rule->name);
                }
            }
            std::vector<std::string> rules;
            for (const Check::Finding& finding :
                 Check::Run(*model->GetNetlist(), *model->GetOptions(), one)) {
                EXPECT_NE(finding.verdicts.Get(target), Check::Verdict::Accepts);
                rules.emplace_back(finding.rule->name);
            }
            EXPECT_EQ(rules, expected) << folder << " " << Check::GetName(target);
        }
    }
}

} // namespace
} // namespace Orn_Hdl
