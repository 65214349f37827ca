// The input is two bytes of options and a JSON netlist. If the netlist is not refused, each of its
// modules is imported into a model and into a command file, and both give the same netlist. The
// modules of a design with hierarchy agree in their ports, as do their legal netlists.

#include "Bytes.h"
#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"
#include "Writes.h"
#include "design/LegalDesign.h"
#include "import/CommandSink.h"
#include "import/DesignReader.h"
#include "import/DesignUnits.h"
#include "import/EmitNetlist.h"
#include "import/FirstValues.h"
#include "import/Hierarchy.h"
#include "import/ImportedNetlist.h"
#include "import/ModelSink.h"
#include "import/TopModule.h"

#include <algorithm>
#include <optional>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;
namespace Import = Tool::Import;

Import::UnknownValues PickUnknownValues(int choice) {
    switch (choice) {
    case 0:
        return Import::UnknownValues(Import::Zero);
    case 1:
        return Import::UnknownValues(Import::One);
    case 2:
        return Import::UnknownValues(Import::Unknown);
    default:
        return Import::UnknownValues(std::nullopt);
    }
}

Import::ImportRules PickRules(Fuzz::Bytes& bytes, const Import::CellLibrary& library) {
    using Import::NameLanguages;
    constexpr NameLanguages Languages[] = {NameLanguages::Both, NameLanguages::Verilog,
                                           NameLanguages::Vhdl};
    const int choice = bytes.Choose(24);
    const Import::NameRules names(Languages[choice / 4 % 3], true);
    return Import::ImportRules{PickUnknownValues(choice % 4), names, choice >= 12, library};
}

std::string WriteCommands(const Import::ImportedNetlist& netlist) {
    Fuzz::MemoryFiles files;
    Port::File file;
    Check(file.open("commands", Port::File::Overwrite, true), "the command file is open");
    Port::Stream stream(file);
    Import::CommandSink sink(stream);
    Import::EmitNetlist(netlist, sink);
    Check(stream.flush() && file.close(), "the command file is written");
    const std::string* const text = files.Find("commands");
    Check(text != nullptr, "the command file exists");
    return *text;
}

void Replay(Model& model, std::string_view commands) {
    while (!commands.empty()) {
        const std::size_t end = std::min(commands.find('\n'), commands.size() - 1);
        model.ExecuteLine(commands.substr(0, end));
        commands.remove_prefix(end + 1);
    }
}

/// Makes the model of a module, and checks it.
Model& ImportModule(const Import::ImportedNetlist& netlist, Engine& engine) {
    engine.CreateAndAddModel(netlist.name.c_str(), "design.json");
    Model& direct = *engine.GetModel(netlist.name.c_str());
    Import::ModelSink sink(direct);
    Import::EmitNetlist(netlist, sink);
    Fuzz::CheckNetlist(*direct.GetNetlist());
    Fuzz::CheckNames(*direct.GetNetlist());
    return direct;
}

/// Compares the model with what the command file makes. Writing changes it.
void CheckCommands(const Import::ImportedNetlist& netlist, Model& direct) {
    CommandFactory factory;
    Model replayed(&factory);
    Replay(replayed, WriteCommands(netlist));
    replayed.GetOptions()->dontCares = direct.GetOptions()->dontCares;
    Check(Fuzz::WriteWithChecks(*direct.GetNetlist(), *direct.GetOptions()) ==
              Fuzz::WriteThreeTimes(*replayed.GetNetlist(), *replayed.GetOptions()),
          "the command file makes the same netlist");
}

/// The modules of a design, used ones first, as an import makes them.
std::vector<Import::ImportedNetlist> MakeNetlists(Import::ImportedDesign& design,
                                                  Import::ImportRules rules) {
    Import::Warnings warnings;
    const Import::Hierarchy hierarchy(design);
    const std::vector<Import::Module*> modules = hierarchy.Order({&Import::FindTop(design, "")});
    std::optional<Import::DesignUnits> units;
    if (modules.size() > 1) {
        units.emplace(design, hierarchy, rules.names, warnings);
        rules.units = &*units;
    }
    std::vector<Import::ImportedNetlist> netlists;
    for (Import::Module* module : modules) {
        netlists.push_back(Import::MakeNetlist(design, *module, rules, warnings));
    }
    return netlists;
}

/// Checks that the components of modules have pins as the modules have ports.
void CheckAgreement(const std::vector<Model*>& models) {
    for (const Model* user : models) {
        for (const Model* used : models) {
            const Netlist& module = *used->GetNetlist();
            const Component* const component =
                user->GetNetlist()->GetComponent(module.GetNameView());
            if (component == nullptr) {
                continue;
            }
            for (const Pin* pin : component->GetPinIterator()) {
                const Signal* const port = module.GetSignal(pin->GetNameView());
                Check(port != nullptr && port->IsPort(), "a pin of a module is one of its ports");
                Check(port->GetPortPolarity().GetValue() == pin->GetPolarity().GetValue(),
                      "a pin of a module has the direction of its port");
            }
        }
    }
}

/// Writes all modules legally, unless something keeps them from it.
void WriteLegally(const std::vector<Model*>& models) {
    const Tool::LegalDesign legal(models);
    for (std::size_t i = 0; i < models.size(); ++i) {
        if (!legal.GetProblem().empty() || !legal.Get(i).GetErrors().empty()) {
            return;
        }
    }
    for (const Language language : {Language::Verilog, Language::Vhdl}) {
        for (std::size_t i = 0; i < models.size(); ++i) {
            TextMemOutStream out;
            legal.Get(i).Write(language, out);
            Check(!out.GetValue().IsEmpty(), "a legal netlist is written");
            Fuzz::CheckNetlist(*models[i]->GetNetlist());
        }
    }
}

void CheckImport(Import::ImportedDesign& design, const Import::ImportRules& rules, bool isLegal) {
    const std::vector<Import::ImportedNetlist> netlists = MakeNetlists(design, rules);
    Engine engine;
    std::vector<Model*> models;
    for (const Import::ImportedNetlist& netlist : netlists) {
        models.push_back(&ImportModule(netlist, engine));
    }
    CheckAgreement(models);
    if (isLegal) {
        WriteLegally(models);
        return;
    }
    for (std::size_t i = 0; i < models.size(); ++i) {
        CheckCommands(netlists[i], *models[i]);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    const Import::CellLibrary library;
    const Import::ImportRules rules = PickRules(bytes, library);
    const int choice = bytes.Choose(4);
    try {
        const std::unique_ptr<Import::ImportedDesign> design =
            Import::ReadDesign(std::string(bytes.Rest()), choice % 2 == 0);
        if (rules.keepPorts) {
            Import::SetFirstValues(*design);
        }
        CheckImport(*design, rules, choice >= 2);
    } catch (const Import::Error&) {
        // The input is no netlist, or cannot be imported.
    }
    return 0;
}
