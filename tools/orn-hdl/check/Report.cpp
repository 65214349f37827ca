#include "check/Report.h"

#include "diagnostics/CommandLines.h"
#include "diagnostics/JsonWriter.h"
#include "diagnostics/MachineFormats.h"
#include "diagnostics/NameKey.h"

#include <algorithm>
#include <map>
#include <optional>
#include <string_view>

namespace Tool::Checking {

using std::string_view;
using Check = Orn_Hdl::Check;

namespace {

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

/// The text of a line with a mark at the name that a cause has.
class MarkedLines {
public:
    MarkedLines(const std::vector<Located>& findings, CommandLines& lines);

    Place Get(std::uint64_t line, const Check::Cause& cause) const;

private:
    /// By line; they are read in ascending order.
    std::map<std::uint64_t, Place> places_;
};

/// The line at which a finding is reported.
std::uint64_t GetLine(const Located& located) {
    return located.line != 0 ? located.line : located.checkedAt;
}

MarkedLines::MarkedLines(const std::vector<Located>& findings, CommandLines& lines) {
    for (const Located& located : findings) {
        places_[GetLine(located)];
        places_[located.otherLine];
    }
    for (auto& [line, place] : places_) {
        place = lines.GetPlace(line);
    }
}

/// The word of a line that names a cause: its second name, which is the narrower one, or its first.
std::optional<Mark> FindName(const std::string& name, const std::vector<WordPlace>& words) {
    const std::string wanted = GetNameKey(name);
    for (std::size_t i = 1; i < words.size() && !wanted.empty(); ++i) {
        const std::string word = GetNameKey(words[i].text);
        const std::size_t dot = word.find('.');
        const int index = static_cast<int>(i);
        if (word == wanted || word.substr(0, word.find('(')) == wanted) {
            return Mark::Word(index);
        }
        if (dot != std::string::npos && word.substr(dot + 1) == wanted) {
            return Mark::Part(index, dot + 1);
        }
    }
    return std::nullopt;
}

/// What of a line is marked for a cause: a constant, or else the second name, which is the narrower
/// one, or the first.
std::optional<Mark> FindMark(const Check::Cause& cause, const std::vector<WordPlace>& words) {
    std::optional<Mark> mark = FindName(cause.second, words);
    if (!mark) {
        mark = FindName(cause.first, words);
    }
    if (mark && cause.kind == Check::Cause::Kind::Constant &&
        mark->last + 1 < static_cast<int>(words.size())) {
        mark = Mark::Word(mark->last + 1);
    }
    return mark;
}

Place MarkedLines::Get(std::uint64_t line, const Check::Cause& cause) const {
    Place place = places_.at(line);
    const std::vector<WordPlace> words = FindWords(place.source);
    if (const std::optional<Mark> mark = FindMark(cause, words)) {
        place.columns = GetColumns(*mark, words);
    }
    return place;
}

/// Who minds, what was noted, the other half of a clash, and what helps.
std::vector<Note> GetNotes(const Located& located, const MarkedLines& lines) {
    std::vector<Note> notes;
    for (std::string& saying : GetSayings(located.finding.verdicts)) {
        notes.push_back({std::move(saying)});
    }
    for (const std::string& note : located.finding.notes) {
        notes.push_back({note});
    }
    if (located.otherLine != 0) {
        notes.push_back(
            {"the other half is here", lines.Get(located.otherLine, located.finding.other)});
    }
    notes.push_back({"what helps: " + std::string(located.finding.rule->help)});
    return notes;
}

std::map<string_view, std::size_t> CountRules(const std::vector<Reported>& findings) {
    std::map<string_view, std::size_t> counts;
    for (const Reported& reported : findings) {
        if (!reported.diagnostic.rule.empty()) {
            ++counts[reported.diagnostic.rule];
        }
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

std::string FormatAsText(const std::vector<Reported>& findings, const TextStyle& style) {
    std::string text;
    std::size_t errors = style.failures;
    for (const Reported& reported : findings) {
        errors += reported.diagnostic.severity == Severity::Error ? 1 : 0;
        text.append(FormatText(reported.diagnostic, style.useColor));
    }
    text.append(std::to_string(errors)).append(errors == 1 ? " error, " : " errors, ");
    const std::size_t warnings = findings.size() + style.failures - errors;
    text.append(std::to_string(warnings)).append(warnings == 1 ? " warning" : " warnings");
    string_view separator = ": ";
    for (const auto& [rule, count] : CountRules(findings)) {
        text.append(separator).append(std::to_string(count)).append(" ").append(rule);
        separator = ", ";
    }
    return text.append("\n");
}

/// A note on one line; one about another place names it.
std::string ToLine(const Note& note) {
    if (note.place.line == 0) {
        return note.text;
    }
    return note.place.file + ":" + std::to_string(note.place.line) + ": " + note.text;
}

void WriteFinding(const Reported& reported, JsonWriter& json) {
    const Diagnostic& diagnostic = reported.diagnostic;
    json.BeginObject();
    json.Key("rule").Text(diagnostic.rule);
    json.Key("severity").Text(GetSeverityName(diagnostic.severity));
    json.Key("file").Text(diagnostic.place.file);
    json.Key("line").Number(diagnostic.place.line);
    json.Key("targets").BeginArray();
    for (const Check::Target target : reported.targets) {
        json.Text(Check::GetName(target));
    }
    json.EndArray();
    json.Key("message").Text(diagnostic.message);
    json.Key("notes").BeginArray();
    for (const Note& note : diagnostic.notes) {
        json.Text(ToLine(note));
    }
    json.EndArray().EndObject();
}

std::string FormatAsJson(const std::vector<Reported>& findings) {
    JsonWriter json;
    json.BeginObject().Key("findings").BeginArray();
    for (const Reported& reported : findings) {
        WriteFinding(reported, json);
    }
    json.EndArray().Key("counts").BeginObject();
    for (const auto& [rule, count] : CountRules(findings)) {
        json.Key(rule).Number(count);
    }
    json.EndObject().EndObject();
    return json.Take();
}

std::string FormatAsSarif(const std::vector<Reported>& findings) {
    std::vector<RuleTexts> rules;
    for (const Check::Rule& rule : Check::GetRules()) {
        rules.push_back({rule.name, rule.what, rule.why, rule.help});
    }
    std::vector<Diagnostic> diagnostics;
    diagnostics.reserve(findings.size());
    for (const Reported& reported : findings) {
        diagnostics.push_back(reported.diagnostic);
    }
    return FormatSarif(diagnostics, rules);
}

string_view SeverityOf(const Check::Rule& rule) {
    return rule.verdicts.GetWorst() > Check::Verdict::Warns ? "error" : "warning";
}

} // namespace

std::vector<Reported> MakeReports(const std::vector<Located>& findings, CommandLines& lines) {
    const MarkedLines marked(findings, lines);
    std::vector<Reported> reports;
    for (const Located& located : findings) {
        const Check::Finding& finding = located.finding;
        Reported& reported = reports.emplace_back();
        reported.targets = GetTargets(finding);
        reported.diagnostic =
            Diagnostic{located.IsError() ? Severity::Error : Severity::Warning,
                       std::string(finding.rule->name), marked.Get(GetLine(located), finding.cause),
                       finding.message, GetNotes(located, marked)};
    }
    return reports;
}

std::string Format(const std::vector<Reported>& findings, ReportFormat format,
                   const TextStyle& style) {
    switch (format) {
    case ReportFormat::Json:
        return FormatAsJson(findings);
    case ReportFormat::Sarif:
        return FormatAsSarif(findings);
    default:
        return FormatAsText(findings, style);
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
