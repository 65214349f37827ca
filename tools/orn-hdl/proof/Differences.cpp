#include "proof/Differences.h"

#include "check/Checker.h"
#include "check/Located.h"
#include "check/Report.h"
#include "diagnostics/CommandLines.h"
#include "diagnostics/Reporter.h"

#include <cstddef>
#include <utility>

namespace Tool {

using Orn_Hdl::Check;
using Orn_Hdl::Proof;

namespace {

Place MakePlace(const Proof::Difference& difference, const std::string& netlist) {
    Place place;
    place.file = netlist;
    place.line = difference.line;
    place.source = difference.source;
    if (difference.column > 0) {
        place.columns = {static_cast<std::size_t>(difference.column - 1), 1};
    }
    return place;
}

std::string GetRule(const Proof::Difference& difference) {
    return difference.rule == nullptr ? std::string() : std::string(difference.rule->name);
}

void AddRuleNotes(const Proof::Difference& difference, std::vector<Note>& notes) {
    if (difference.rule != nullptr) {
        notes.push_back({"orn-hdl check tells of it: " + std::string(difference.rule->what)});
        notes.push_back({"what helps: " + std::string(difference.rule->help)});
    }
}

/// Where the causes of the differences are in the command file.
std::vector<Checking::Located> Locate(const std::vector<Proof::Difference>& differences,
                                      std::uint64_t line, CommandLines& lines) {
    std::vector<Checking::Located> located;
    for (const Proof::Difference& difference : differences) {
        static constexpr Check::Rule NoRule = {};
        Checking::Located& added = located.emplace_back();
        added.finding.rule = difference.rule == nullptr ? &NoRule : difference.rule;
        added.finding.message = difference.message;
        added.finding.cause = difference.cause;
        added.checkedAt = line;
        added.isObstacle = true;
    }
    // A pipe is read once; what is found stands at the line that writes.
    if (CanReadAgain(lines.GetSystemName())) {
        Checking::Locate(lines.GetSystemName().c_str(), located);
    }
    return located;
}

} // namespace

Status ReportDifferences(const std::vector<Proof::Difference>& differences,
                         const std::string& netlist, std::uint64_t line, CommandLines& lines,
                         Reporter& reporter) {
    std::vector<Checking::Reported> reports =
        Checking::MakeReports(Locate(differences, line, lines), lines);
    for (std::size_t i = 0; i < reports.size(); ++i) {
        Diagnostic& diagnostic = reports[i].diagnostic;
        diagnostic.rule = GetRule(differences[i]);
        diagnostic.message = "the netlist " + netlist + " is not proven: " + diagnostic.message;
        diagnostic.notes.clear();
        if (differences[i].line != 0) {
            diagnostic.notes.push_back(
                {"the netlist says so here", MakePlace(differences[i], netlist)});
        }
        AddRuleNotes(differences[i], diagnostic.notes);
        reporter.Report(std::move(diagnostic));
    }
    return Status::Unproven;
}

Status ReportDifferences(const std::vector<Proof::Difference>& differences,
                         const std::string& netlist, Reporter& reporter) {
    for (const Proof::Difference& difference : differences) {
        Diagnostic diagnostic;
        diagnostic.rule = GetRule(difference);
        diagnostic.place = MakePlace(difference, netlist);
        diagnostic.message = difference.message;
        AddRuleNotes(difference, diagnostic.notes);
        reporter.Report(std::move(diagnostic));
    }
    return Status::Unproven;
}

} // namespace Tool
