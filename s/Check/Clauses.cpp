// What the netlist as a whole needs: ports, libraries, use clauses, include files, configurations.

#include "Check/Context.h"
#include "Check/Identifier.h"
#include "Check/NameCheck.h"
#include "Check/ReservedWords.h"
#include "HdlModel/Netlist/Primitives.h"
#include "Port/Ascii.h"
#include "Writers/OneLine.h"
#include "Writers/Text.h"

#include <algorithm>
#include <set>
#include <vector>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

bool IsVhdlIdentifier(string_view name) {
    const Identifier identifier(name);
    const Verdicts reserved = FindReserved("", name);
    return identifier.isVhdl && identifier.hasProperUnderscores &&
           reserved.Get(Check::Target::Vhdl93) == Check::Verdict::Accepts;
}

string_view Trim(string_view text) {
    while (!text.empty() && text.front() == ' ') {
        text.remove_prefix(1);
    }
    while (!text.empty() && text.back() == ' ') {
        text.remove_suffix(1);
    }
    return text;
}

/// The pieces of a text between separators, without blanks around them.
std::vector<string_view> Split(string_view text, char separator) {
    std::vector<string_view> pieces;
    for (std::size_t start = 0; start <= text.size();) {
        const std::size_t end = std::min(text.find(separator, start), text.size());
        pieces.push_back(Trim(text.substr(start, end - start)));
        start = end + 1;
    }
    return pieces;
}

class Clauses {
public:
    explicit Clauses(Context& context) : context_(context), options_(context.options) {}

    void CheckAll() {
        CheckPorts();
        CheckLibraries();
        CheckUseClauses();
        CheckStdLogic();
        CheckIncludes();
        CheckConfiguration();
        CheckComponents();
    }

private:
    void CheckPorts();
    void CheckLibraries();
    void CheckUseClauses();
    void CheckSelectedName(string_view clause, string_view name);
    void CheckStdLogic();
    void CheckIncludes();
    void CheckConfiguration();
    void CheckComponents();

    Context& context_;
    const HdlOptions& options_;
    std::set<std::string> libraries_ = {"std", "work"};
};

void Clauses::CheckPorts() {
    if (context_.isMended) {
        return;
    }
    for (const Signal* signal : context_.netlist.GetSignalIterator()) {
        if (signal->IsNeededToDeclared() && signal->IsPort() &&
            !Writers::IsOpen(signal->GetNameView())) {
            return;
        }
    }
    if (Finding* finding = context_.Add(RuleId::NoPorts, Named(Kind::DesignName, ""))) {
        finding->objects = {&context_.netlist};
        finding->message = "the design has no ports";
    }
}

void Clauses::CheckLibraries() {
    for (int i = 0; i < options_.vhdl.libraries.GetSize(); ++i) {
        const string_view clause = options_.vhdl.libraries.GetView(i);
        for (const string_view name : Split(clause, ',')) {
            libraries_.insert(Lower(name));
            const bool isKnown = Port::EqualIgnoringCase(name, "ieee") ||
                                 Port::EqualIgnoringCase(name, "std") ||
                                 Port::EqualIgnoringCase(name, "work");
            if (!IsVhdlIdentifier(name)) {
                if (Finding* finding =
                        context_.Add(RuleId::LibraryClause, Named(Kind::Library, clause))) {
                    finding->message = "the library " + Quoted(name) + " has no legal name";
                }
            } else if (!isKnown) {
                if (Finding* finding =
                        context_.Add(RuleId::NeededLibrary, Named(Kind::Library, clause))) {
                    finding->message = "the library " + Quoted(name) + " has to be analysed first";
                }
            }
        }
    }
}

void Clauses::CheckUseClauses() {
    for (int i = 0; i < options_.vhdl.useClauses.GetSize(); ++i) {
        const string_view clause = options_.vhdl.useClauses.GetView(i);
        for (const string_view name : Split(clause, ',')) {
            CheckSelectedName(clause, name);
        }
    }
}

void Clauses::CheckSelectedName(string_view clause, string_view name) {
    const std::vector<string_view> pieces = Split(name, '.');
    const Cause cause = Named(Kind::UseClause, clause);
    // "all" ends the name, and is a reserved word anywhere else.
    const bool endsInAll = Port::EqualIgnoringCase(pieces.back(), "all");
    const bool isSelected =
        pieces.size() >= 2 &&
        std::all_of(pieces.begin(), pieces.end() - (endsInAll ? 1 : 0), IsVhdlIdentifier);
    if (!isSelected) {
        if (Finding* finding = context_.Add(RuleId::UseClause, cause)) {
            finding->message = "the use clause " + Quoted(name) + " has no selected name";
        }
    } else if (libraries_.count(Lower(pieces.front())) == 0) {
        if (Finding* finding = context_.Add(RuleId::UseClause, cause)) {
            finding->message = "the use clause " + Quoted(name) +
                               " names a library that no clause before it declares";
        }
    } else if (!Port::EqualIgnoringCase(pieces.front(), "ieee") &&
               !Port::EqualIgnoringCase(pieces.front(), "std")) {
        if (Finding* finding = context_.Add(RuleId::NeededLibrary, cause)) {
            finding->message = "the unit " + Quoted(name) + " has to be analysed first";
        }
    }
}

void Clauses::CheckStdLogic() {
    if (options_.vhdl.useDefaultLibrary) {
        return;
    }
    for (int i = 0; i < options_.vhdl.useClauses.GetSize(); ++i) {
        for (const string_view name : Split(options_.vhdl.useClauses.GetView(i), ',')) {
            if (Port::EqualIgnoringCase(name, "ieee.std_logic_1164.all")) {
                return;
            }
        }
    }
    if (Finding* finding =
            context_.Add(RuleId::NoStdLogic, Named(Kind::Option, "USE DEFAULT LIBRARY"))) {
        finding->message = "no use clause makes std_logic visible";
    }
}

void Clauses::CheckIncludes() {
    for (int i = 0; i < options_.verilog.includePaths.GetSize(); ++i) {
        const string_view text = options_.verilog.includePaths.GetView(i);
        const Port::String unquoted = HdlUtilities::RemoveQuotes(std::string(text).c_str());
        const Writers::OneLine file(unquoted);
        const bool isBroken = file.GetView().find('"') != string_view::npos;
        const bool isNone = file.GetView().empty();
        const Verdicts verdicts(isBroken ? "rrr..rrr." : isNone ? "rrr..wrr." : "www..www.");
        if (Finding* finding =
                context_.Add(RuleId::IncludeFile, verdicts, Named(Kind::Include, text))) {
            finding->message =
                "the file " + Quoted(file.GetView()) +
                (isBroken ? " has a quote in its name" : " has to be found by the tool");
        }
    }
}

void Clauses::CheckConfiguration() {
    if (options_.vhdl.suppressConfiguration) {
        return;
    }
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        const auto used = context_.used.find(component);
        if (used == context_.used.end() || IsPrimitive(*component)) {
            continue;
        }
        if (Finding* finding = context_.Add(RuleId::MissingConfiguration,
                                            Named(Kind::Component, component->GetNameView()))) {
            finding->objects = {component};
            finding->message = "the configuration uses " +
                               Quoted("WORK.CFG_" + std::string(component->GetNameView())) +
                               ", which has to be there";
        }
    }
}

void Clauses::CheckComponents() {
    if (!options_.vhdl.suppressComponent || context_.used.empty()) {
        return;
    }
    const bool mayBeDeclared =
        options_.vhdl.useDefaultLibrary || options_.vhdl.useClauses.GetSize() > 0;
    const Verdicts verdicts(mayBeDeclared ? "...ww...w" : "...rr...r");
    if (Finding* finding = context_.Add(RuleId::UndeclaredComponent, verdicts,
                                        Named(Kind::Option, "SUPPRESS COMPONENT"))) {
        finding->message = "the components have to be declared in a package of the use clauses";
    }
}

} // namespace

void CheckClauses(Context& context) {
    Clauses(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
