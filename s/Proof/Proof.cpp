#include "Orn_Hdl/Proof.h"

#include "Exception/Failure.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"
#include "Port/File.h"
#include "Proof/Comparison.h"
#include "Proof/Meaning.h"
#include "Readers/Verilog/ReadVerilog.h"
#include "Readers/Vhdl/ReadVhdl.h"

#include <algorithm>
#include <charconv>
#include <map>
#include <string_view>
#include <utility>

namespace Orn_Hdl {

namespace {

using Proving::Findings;
using Readers::Place;
using std::string_view;

/// Takes a number and the colon behind it off the front of a text.
std::uint32_t TakeNumber(string_view& text) {
    std::uint32_t number = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    const auto length = static_cast<std::size_t>(result.ptr - text.data());
    text.remove_prefix(std::min(length + 1, text.size()));
    return number;
}

/// Turns an error of the reader, "FILE:LINE:COLUMN: error: TEXT", into a difference.
void AddError(string_view text, string_view fileName, Findings& findings) {
    constexpr string_view Mark = " error: ";
    Place place;
    if (text.substr(0, fileName.size()) == fileName) {
        text.remove_prefix(std::min(fileName.size() + 1, text.size()));
        place.line = TakeNumber(text);
        place.column = TakeNumber(text);
    }
    if (text.substr(0, Mark.size()) == Mark) {
        text.remove_prefix(Mark.size());
    }
    findings.Add("it cannot be read: " + std::string(text.substr(0, text.find('\n'))), place, {});
}

void CompareIncludes(const std::vector<std::string>& read, const StringArray& meant,
                     Findings& findings) {
    for (std::size_t i = 0; i < std::max(read.size(), static_cast<std::size_t>(meant.GetSize()));
         ++i) {
        const auto index = static_cast<int>(i);
        std::string wanted(index < meant.GetSize() ? meant.GetView(index) : string_view());
        const std::string found = i < read.size() ? read[i] : std::string();
        const bool isQuoted = wanted.size() > 1 && wanted.front() == '"' && wanted.back() == '"';
        if (isQuoted) {
            wanted = wanted.substr(1, wanted.size() - 2);
        }
        if (wanted != found) {
            std::string message("the netlist includes \"");
            message.append(found).append("\", the design \"").append(wanted).append("\"");
            findings.Add(std::move(message), {}, {Check::Cause::Kind::Include, wanted, ""});
        }
    }
}

void CompareVerilog(const char* fileName, const Netlist& netlist, const HdlOptions& options,
                    Findings& findings) {
    Readers::VerilogSetup setup;
    setup.includes = VerilogReader::Includes::Keep;
    setup.names = ReaderNames::Literal;
    Readers::Heads components;
    components.Add(netlist, Proving::NameInVerilog);
    Proving::Comparison comparison(netlist, options, Language::Verilog, findings);
    const std::vector<std::string> includes =
        Readers::ReadVerilog(fileName, setup, components, comparison);
    comparison.End();
    CompareIncludes(includes, options.verilog.includePaths, findings);
}

/// Whether both say the same, letter case and blanks aside. One clause may name several things.
bool AreSameClauses(const std::vector<std::string>& read, const std::vector<std::string>& meant) {
    const auto join = [](const std::vector<std::string>& clauses) {
        std::string all;
        for (const std::string& clause : clauses) {
            for (const char c : clause + ",") {
                all.append(c == ' ' || c == '\t' ? 0 : 1, Port::ToLower(c));
            }
        }
        return all;
    };
    return join(read) == join(meant);
}

/// The name that every architecture has.
constexpr string_view ArchitectureName = "BEHAVIORAL";

void CompareFrame(const Readers::VhdlFrame& frame, const Netlist& netlist,
                  const HdlOptions::VhdlOption& options, Findings& findings) {
    std::vector<std::string> libraries;
    std::vector<std::string> uses;
    libraries.reserve(static_cast<std::size_t>(options.libraries.GetSize()));
    uses.reserve(static_cast<std::size_t>(options.useClauses.GetSize()));
    for (int i = 0; i < options.libraries.GetSize(); ++i) {
        libraries.emplace_back(options.libraries.GetView(i));
    }
    for (int i = 0; i < options.useClauses.GetSize(); ++i) {
        uses.emplace_back(options.useClauses.GetView(i));
    }
    if (options.useDefaultLibrary) {
        libraries.insert(libraries.end(), {"ieee", "KESTRA"});
        uses.insert(uses.end(),
                    {"ieee.std_logic_1164.ALL", "ieee.numeric_std.ALL", "KESTRA.Vcomponents.ALL"});
    }
    if (!AreSameClauses(frame.libraries, libraries)) {
        findings.Add("the library clauses are not those of the design", {},
                     {Check::Cause::Kind::Library, "", ""});
    }
    if (!AreSameClauses(frame.uses, uses)) {
        findings.Add("the use clauses are not those of the design", {},
                     {Check::Cause::Kind::UseClause, "", ""});
    }
    std::vector<std::string> configurations;
    if (!options.suppressConfiguration) {
        configurations.push_back("CFG_" + std::string(netlist.GetNameView()));
    }
    if (frame.architecture != ArchitectureName) {
        findings.Add("the architecture is \"" + frame.architecture + "\"", {},
                     {Check::Cause::Kind::DesignName, "", ""});
    }
    if (frame.configurations != configurations ||
        (!configurations.empty() &&
         (frame.configured != ArchitectureName || frame.configuredEntity != netlist.GetNameView() ||
          !frame.isConfigurationHidden))) {
        findings.Add("the configuration is not that of the design", {},
                     {Check::Cause::Kind::DesignName, "", ""});
    }
}

void CompareVhdl(const char* fileName, const Netlist& netlist, const HdlOptions& options,
                 Findings& findings) {
    Readers::VhdlSetup setup;
    setup.names = ReaderNames::Literal;
    Proving::Comparison comparison(netlist, options, Language::Vhdl, findings);
    const Readers::VhdlFrame frame = Readers::ReadVhdl(fileName, setup, netlist, comparison);
    comparison.End();
    CompareFrame(frame, netlist, options.vhdl, findings);
}

/// Adds the texts of the lines.
void AddLines(std::vector<Proof::Difference>& differences, const char* fileName) {
    std::map<std::uint64_t, std::string> texts;
    for (const Proof::Difference& difference : differences) {
        texts[difference.line];
    }
    Port::File file;
    file.open(fileName, Port::File::Read, true);
    std::uint64_t line = 0;
    string_view text;
    for (auto& [wanted, found] : texts) {
        while (line < wanted && file.NextLine(text)) {
            ++line;
        }
        found = line == wanted && line > 0 ? text : string_view();
    }
    for (Proof::Difference& difference : differences) {
        difference.source = texts[difference.line];
    }
}

/// Whether both name the same command. Only the check tells a bus from a scalar signal of the same
/// name.
bool AreSame(const Check::Cause& found, const Check::Cause& wanted) {
    return found.kind == wanted.kind && found.first == wanted.first &&
           (found.second == wanted.second || wanted.kind == Check::Cause::Kind::Signal);
}

/// Adds the rules that tell of what differs.
void AddRules(std::vector<Proof::Difference>& differences, Language language,
              const Netlist& netlist, const HdlOptions& options) {
    const Check::Targets targets =
        language == Language::Verilog ? Check::Targets::Verilog() : Check::Targets::Vhdl();
    std::vector<Check::Finding> found = Check::Run(netlist, options, targets);
    // An error tells more than a warning.
    std::stable_partition(found.begin(), found.end(), [](const Check::Finding& finding) {
        return finding.GetSeverity() == Check::Severity::Error;
    });
    for (Proof::Difference& difference : differences) {
        const bool hasCause = difference.cause.kind != Check::Cause::Kind::Design;
        auto match = std::find_if(found.begin(), found.end(), [&](const Check::Finding& finding) {
            return hasCause && (AreSame(finding.cause, difference.cause) ||
                                AreSame(finding.other, difference.cause));
        });
        // What cannot be read is whatever the check holds against the whole.
        if (!hasCause && !found.empty()) {
            match = found.begin();
        }
        if (match != found.end()) {
            difference.rule = match->rule;
            difference.cause = hasCause ? difference.cause : match->cause;
        }
    }
}

} // namespace

std::vector<Proof::Difference> Proof::Compare(const Port::TextArgument& fileName, Language language,
                                              const Netlist& netlist, const HdlOptions& options) {
    const char* const name = fileName.Get() == nullptr ? "" : fileName.Get();
    Port::File file;
    if (!file.open(name, Port::File::Read, true)) {
        Fail(ProofUnit, __LINE__, "Cannot read \"%s\": %s.\n",
             {name, Port::ErrorText(file.GetError()).GetView()});
    }
    file.close();
    Findings findings;
    try {
        try {
            if (language == Language::Vhdl) {
                CompareVhdl(name, netlist, options, findings);
            } else {
                CompareVerilog(name, netlist, options, findings);
            }
        } catch (const Exception& exception) {
            AddError(exception.getLocalized().GetView(), name, findings);
        }
    } catch (const Proving::EnoughFound&) {
        // The first differences say enough.
    }
    std::vector<Difference> differences = findings.Take();
    if (!differences.empty()) {
        AddLines(differences, name);
        AddRules(differences, language, netlist, options);
    }
    return differences;
}

void Proof::Require(const Port::TextArgument& fileName, const Port::TextArgument& shownName,
                    Language language, const Netlist& netlist, const HdlOptions& options) {
    std::vector<Difference> differences = Compare(fileName, language, netlist, options);
    if (!differences.empty()) {
        throw ProofException(std::string(Port::ViewOf(shownName.Get())), std::move(differences));
    }
}

ProofException::ProofException(const std::string& fileName,
                               std::vector<Proof::Difference> differences)
    : Exception("DesignEntry", ProofUnit.name, ProofUnit.revision, __LINE__),
      differences_(std::move(differences)) {
    std::string text = "\"" + fileName + "\" does not mean what the design does: ";
    bool isFirst = true;
    for (const Proof::Difference& difference : differences_) {
        text.append(isFirst ? "" : "; ").append(difference.message);
        if (difference.line != 0) {
            text.append(" (line ").append(std::to_string(difference.line)).append(")");
        }
        if (difference.rule != nullptr) {
            text.append(" [").append(difference.rule->name).append("]");
        }
        isFirst = false;
    }
    setDescription((text + ".\n").c_str());
}

ProofException::ProofException(const ProofException&) = default;

ProofException::~ProofException() = default;

} // namespace Orn_Hdl
