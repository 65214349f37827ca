// The command files of the check's rules, written legally: byte for byte what the real tools
// accepted.

#include "Orn_Hdl/LegalNetlist.h"

#include "Support/RuleFiles.h"

#include <string>

namespace Orn_Hdl {
namespace {

/// Writes the design in the languages, or, if no netlist can be legal, tells why.
void Write(Model& model, const std::filesystem::path& folder,
           std::initializer_list<Language> languages) {
    model.GetOptions()->writeHeader = false;
    std::string errors;
    for (const Language language : languages) {
        LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
        errors.clear();
        for (const Check::Finding& finding : legal.GetErrors()) {
            errors.append(finding.message).append(" [").append(finding.rule->name).append("]\n");
        }
        TextMemOutStream out;
        if (legal.GetErrors().empty()) {
            legal.Write(language, out);
        }
        Support::ExpectFile(folder / (language == Language::Verilog ? "legal.v" : "legal.vhd"),
                            std::string(out.GetValue().GetView()));
    }
    Support::ExpectFile(folder / "errors.txt", errors);
}

TEST(LegalNetlists, OfTheRulesFilesAreWrittenToTheByte) {
    CommandFactory factory;
    for (const auto& folder : Support::RuleFolders()) {
        Write(*Support::ReadDesign(factory, folder / "bad.cmd"), folder,
              {Language::Verilog, Language::Vhdl});
    }
}

TEST(LegalNetlists, AreTheSameWhicheverLanguageComesFirst) {
    CommandFactory factory;
    for (const auto& folder : Support::RuleFolders()) {
        Write(*Support::ReadDesign(factory, folder / "bad.cmd"), folder,
              {Language::Vhdl, Language::Verilog});
    }
}

} // namespace
} // namespace Orn_Hdl
