#include "check/Report.h"

#include "Port/Version.h"
#include "check/Json.h"

#include <algorithm>
#include <map>
#include <string_view>

namespace Tool::Checking {

using std::string_view;
using Check = Orn_Hdl::Check;

namespace {

string_view SeverityName(const Check::Finding& finding) {
    return finding.GetSeverity() == Check::Severity::Error ? "error" : "warning";
}

std::string Join(const std::vector<Check::Target>& targets) {
    std::string text;
    for (const Check::Target target : targets) {
        text.append(text.empty() ? "" : ", ").append(Check::GetName(target));
    }
    return text;
}

constexpr std::pair<Check::Verdict, string_view> Sayings[] = {
    {Check::Verdict::Rejects, "rejected by "},
    {Check::Verdict::Misreads, "read otherwise than meant by "},
    {Check::Verdict::Warns, "warned of by "}};

/// Who minds, and how.
std::vector<std::string> GetSayings(const Check::Verdicts& verdicts) {
    Check::Finding finding;
    finding.verdicts = verdicts;
    std::vector<std::string> sayings;
    for (const auto& [verdict, saying] : Sayings) {
        const std::vector<Check::Target> targets = finding.GetTargets(verdict);
        if (!targets.empty()) {
            sayings.push_back(std::string(saying) + Join(targets));
        }
    }
    return sayings;
}

/// Who minds, what was noted, the other half of a clash, and what helps.
std::vector<std::string> GetNotes(const Located& located) {
    std::vector<std::string> notes = GetSayings(located.finding.verdicts);
    notes.insert(notes.end(), located.finding.notes.begin(), located.finding.notes.end());
    if (located.otherLine != 0) {
        notes.push_back(located.file + ":" + std::to_string(located.otherLine) +
                        ": the other half is here");
    }
    notes.push_back("what helps: " + std::string(located.finding.rule->help));
    return notes;
}

std::map<string_view, std::size_t> CountRules(const std::vector<Located>& findings) {
    std::map<string_view, std::size_t> counts;
    for (const Located& located : findings) {
        ++counts[located.finding.rule->name];
    }
    return counts;
}

/// Every target of whom a finding speaks.
std::vector<Check::Target> GetTargets(const Check::Finding& finding) {
    std::vector<Check::Target> targets;
    for (const Check::Target target : Check::GetTargets()) {
        if (finding.verdicts.Get(target) != Check::Verdict::Accepts) {
            targets.push_back(target);
        }
    }
    return targets;
}

std::string FormatText(const std::vector<Located>& findings) {
    std::string text;
    std::size_t errors = 0;
    for (const Located& located : findings) {
        const bool isError = located.IsError();
        errors += isError ? 1 : 0;
        text.append(located.file).append(":");
        text.append(std::to_string(located.line)).append(": ");
        text.append(isError ? "error" : "warning").append(": ");
        text.append(located.finding.message);
        text.append(" [").append(located.finding.rule->name).append("]\n");
        for (const std::string& note : GetNotes(located)) {
            text.append("    ").append(note).append("\n");
        }
    }
    text.append(std::to_string(errors)).append(errors == 1 ? " error, " : " errors, ");
    const std::size_t warnings = findings.size() - errors;
    text.append(std::to_string(warnings)).append(warnings == 1 ? " warning" : " warnings");
    string_view separator = ": ";
    for (const auto& [rule, count] : CountRules(findings)) {
        text.append(separator).append(std::to_string(count)).append(" ").append(rule);
        separator = ", ";
    }
    return text.append("\n");
}

std::string FormatJson(const std::vector<Located>& findings) {
    JsonWriter json;
    json.BeginObject().Key("findings").BeginArray();
    for (const Located& located : findings) {
        json.BeginObject();
        json.Key("rule").Text(located.finding.rule->name);
        json.Key("severity").Text(SeverityName(located.finding));
        json.Key("file").Text(located.file);
        json.Key("line").Number(located.line);
        json.Key("targets").BeginArray();
        for (const Check::Target target : GetTargets(located.finding)) {
            json.Text(Check::GetName(target));
        }
        json.EndArray();
        json.Key("message").Text(located.finding.message);
        json.Key("notes").BeginArray();
        for (const std::string& note : GetNotes(located)) {
            json.Text(note);
        }
        json.EndArray().EndObject();
    }
    json.EndArray().Key("counts").BeginObject();
    for (const auto& [rule, count] : CountRules(findings)) {
        json.Key(rule).Number(count);
    }
    json.EndObject().EndObject();
    return json.Take();
}

void WriteSarifRules(JsonWriter& json) {
    json.Key("rules").BeginArray();
    for (const Check::Rule& rule : Check::GetRules()) {
        json.BeginObject();
        json.Key("id").Text(rule.name);
        json.Key("shortDescription").BeginObject().Key("text").Text(rule.what).EndObject();
        json.Key("fullDescription").BeginObject().Key("text").Text(rule.why).EndObject();
        json.Key("help").BeginObject().Key("text").Text(rule.help).EndObject();
        json.EndObject();
    }
    json.EndArray();
}

/// Blanks and the like are written as %XX, as in any address.
std::string ToUri(string_view file) {
    constexpr string_view Plain = "-._~/";
    constexpr string_view Digits = "0123456789ABCDEF";
    std::string uri;
    for (const char c : file) {
        const auto byte = static_cast<unsigned char>(c);
        const bool isPlain = (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') ||
                             (c >= 'a' && c <= 'z') || Plain.find(c) != string_view::npos;
        if (isPlain) {
            uri.push_back(c);
        } else {
            uri.append({'%', Digits[byte >> 4U], Digits[byte & 15U]});
        }
    }
    return uri;
}

void WriteSarifPlace(JsonWriter& json, const std::string& file, std::uint64_t line) {
    json.BeginObject().Key("physicalLocation").BeginObject();
    json.Key("artifactLocation").BeginObject().Key("uri").Text(ToUri(file)).EndObject();
    json.Key("region").BeginObject().Key("startLine");
    json.Number(std::max<std::uint64_t>(line, 1)).EndObject();
    json.EndObject();
}

std::string FormatSarif(const std::vector<Located>& findings) {
    JsonWriter json;
    json.BeginObject();
    json.Key("$schema").Text("https://json.schemastore.org/sarif-2.1.0.json");
    json.Key("version").Text("2.1.0").Key("runs").BeginArray().BeginObject();
    json.Key("tool").BeginObject().Key("driver").BeginObject();
    json.Key("name").Text("orn-hdl");
    json.Key("version").Text(Port::Version::getValue("version").GetView());
    WriteSarifRules(json);
    json.EndObject().EndObject().Key("results").BeginArray();
    for (const Located& located : findings) {
        std::string text = located.finding.message;
        for (const std::string& note : GetNotes(located)) {
            text.append("\n").append(note);
        }
        json.BeginObject();
        json.Key("ruleId").Text(located.finding.rule->name);
        json.Key("level").Text(SeverityName(located.finding));
        json.Key("message").BeginObject().Key("text").Text(text).EndObject();
        json.Key("locations").BeginArray();
        WriteSarifPlace(json, located.file, located.line);
        json.EndObject().EndArray();
        if (located.otherLine != 0) {
            json.Key("relatedLocations").BeginArray();
            WriteSarifPlace(json, located.file, located.otherLine);
            json.Key("message").BeginObject().Key("text").Text("the other half").EndObject();
            json.EndObject().EndArray();
        }
        json.EndObject();
    }
    json.EndArray().EndObject().EndArray().EndObject();
    return json.Take();
}

string_view SeverityOf(const Check::Rule& rule) {
    return rule.verdicts.GetWorst() > Check::Verdict::Warns ? "error" : "warning";
}

} // namespace

std::string Format(const std::vector<Located>& findings, CheckFormat format) {
    switch (format) {
    case CheckFormat::Json:
        return FormatJson(findings);
    case CheckFormat::Sarif:
        return FormatSarif(findings);
    default:
        return FormatText(findings);
    }
}

std::string ListRules() {
    std::string text;
    for (const Check::Rule& rule : Check::GetRules()) {
        std::string name(rule.name);
        name.resize(std::max<std::size_t>(name.size() + 1, 24), ' ');
        std::string severity(SeverityOf(rule));
        severity.resize(9, ' ');
        text.append(name).append(severity).append(rule.what).append("\n");
    }
    return text;
}

std::string ListRulesAsMarkdown() {
    std::string text = "| rule | what is written | what comes of it | what helps |\n"
                       "| --- | --- | --- | --- |\n";
    for (const Check::Rule& rule : Check::GetRules()) {
        text.append("| `").append(rule.name).append("` | ").append(rule.what).append(" | ");
        string_view separator;
        for (const std::string& saying : GetSayings(rule.verdicts)) {
            text.append(separator).append(saying);
            separator = "; ";
        }
        text.append(" | ").append(rule.help).append(" |\n");
    }
    return text;
}

std::string Explain(const Check::Rule& rule) {
    std::string text(rule.name);
    text.append(": ").append(rule.what).append("\n\n").append(rule.why).append("\n");
    for (const std::string& saying : GetSayings(rule.verdicts)) {
        text.append("\n").append(saying);
    }
    text.append("\n\nExample:\n");
    for (string_view rest = rule.example; !rest.empty();) {
        const std::size_t end = std::min(rest.find('\n'), rest.size());
        text.append("    ").append(rest.substr(0, end)).append("\n");
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    return text.append("\nWhat helps: ").append(rule.help).append("\n");
}

} // namespace Tool::Checking
