#include "proof/Verify.h"

#include "Gzip.h"
#include "LastingEngines.h"
#include "NoWrites.h"
#include "Progress.h"
#include "Run.h"
#include "check/WriteGate.h"
#include "proof/Certificate.h"
#include "proof/Differences.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/String.h"

namespace Tool {

namespace {

using Orn_Hdl::Language;

/// The language of the netlist; nothing when nothing tells it.
std::optional<Language> FindLanguage(const VerifyOptions& options) {
    const std::string netlist(WithoutGzip(options.netlist));
    Port::String extension(options.language.empty() ? netlist.substr(netlist.rfind('.') + 1).c_str()
                                                    : options.language.c_str());
    extension.MakeLower();
    for (const char* word : {"v", "sv", "vh", "verilog"}) {
        if (extension == word) {
            return Language::Verilog;
        }
    }
    for (const char* word : {"vhd", "vhdl"}) {
        if (extension == word) {
            return Language::Vhdl;
        }
    }
    return std::nullopt;
}

/// Does to the design what a write does, and compares.
Status Compare(Orn_Hdl::Model& model, Language language, const VerifyOptions& options,
               std::uint64_t lines, CommandFile& file, Certificate& certificate) {
    Orn_Hdl::OutStream nothing(nullptr);
    std::optional<Orn_Hdl::LegalNetlist> legal;
    if (options.legal) {
        legal.emplace(*model.GetNetlist(), *model.GetOptions());
        if (Checking::WriteGate(model, file.lines, file.reporter).Tell(legal->GetErrors(), lines)) {
            return Status::Failed;
        }
        legal->Write(language, nothing);
    } else if (language == Language::Verilog) {
        Orn_Hdl::VerilogNetlister(nothing).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    } else {
        Orn_Hdl::VhdlNetlister(nothing).WriteNetlist(model.GetNetlist(), model.GetOptions());
    }
    const Orn_Hdl::Netlist& written = legal ? legal->GetWrittenNetlist() : *model.GetNetlist();
    const std::vector<Orn_Hdl::Proof::Difference> differences =
        Orn_Hdl::Proof::Compare(SystemFileName(options.netlist.c_str()), language, written,
                                legal ? legal->GetWrittenOptions() : *model.GetOptions());
    if (!differences.empty()) {
        return ReportDifferences(differences, options.netlist, lines, file.lines, file.reporter);
    }
    return certificate.AddNetlist(options.netlist, language, written);
}

} // namespace

Status Verify(const VerifyOptions& options) {
    const std::optional<Language> language = FindLanguage(options);
    if (!language) {
        Complain("the language of " + options.netlist + " is not known; say it by --language");
        return Status::Usage;
    }
    DropLastingEngines();
    Orn_Hdl::Engine& engine = MakeLastingEngine();
    const std::string name = GetModelName(options.commands, options.model);
    engine.CreateAndAddModel(name, options.commands);
    Orn_Hdl::Model& model = *engine.GetModel(name);
    DropWrites(*model.GetCommandFactory());
    model.GetOptions()->legal = options.legal;
    model.GetOptions()->escapeNames = options.names == "escape";
    model.GetOptions()->dontCares = options.dontCares;
    model.GetOptions()->threads = options.threads;
    model.GetOptions()->verify = true;

    Progress progress(options.quiet, options.commands);
    CommandFile file(options.commands, options.report, progress);
    Certificate certificate(options.certificate);
    const Replayed replayed = Replay(model, file, false);
    Status status = replayed.status;
    if (replayed.complete) {
        status = Compare(model, *language, options, replayed.lines, file, certificate);
    }
    progress.Erase();
    file.reporter.Finish();
    if (status == Status::Success && !options.certificate.empty()) {
        status = certificate.AddCommands(options.commands, file.lines.GetSystemName());
        return status == Status::Success ? certificate.Write() : status;
    }
    return status;
}

} // namespace Tool
