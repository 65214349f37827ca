// The input is two bytes of options and a JSON netlist. If the netlist is not refused, it is
// imported into a model and into a command file, and both give the same netlist.

#include "Bytes.h"
#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"
#include "Writes.h"
#include "import/CommandSink.h"
#include "import/DesignReader.h"
#include "import/EmitNetlist.h"
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

void CheckImport(const Import::ImportedNetlist& netlist) {
    CommandFactory factory;
    Model direct(&factory);
    Import::ModelSink sink(direct);
    Import::EmitNetlist(netlist, sink);
    Fuzz::CheckNetlist(*direct.GetNetlist());
    Fuzz::CheckNames(*direct.GetNetlist());
    Model replayed(&factory);
    Replay(replayed, WriteCommands(netlist));
    Check(Fuzz::WriteWithChecks(*direct.GetNetlist(), *direct.GetOptions()) ==
              Fuzz::WriteThreeTimes(*replayed.GetNetlist(), *replayed.GetOptions()),
          "the command file makes the same netlist");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    const Import::CellLibrary library;
    const Import::ImportRules rules = PickRules(bytes, library);
    const bool keepAttributes = bytes.Choose(2) == 0;
    try {
        const std::unique_ptr<Import::ImportedDesign> design =
            Import::ReadDesign(std::string(bytes.Rest()), keepAttributes);
        Import::Module& top = Import::FindTop(*design, "");
        Import::Warnings warnings;
        CheckImport(Import::MakeNetlist(*design, top, rules, warnings));
    } catch (const Import::Error&) {
        // The input is no netlist, or cannot be imported.
    }
    return 0;
}
