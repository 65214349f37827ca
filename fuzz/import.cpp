// The input is a JSON netlist behind a byte of options. Whatever is not refused becomes the same
// netlist by way of a model and by way of a command file.

#include "Bytes.h"
#include "Check.h"
#include "Consistency.h"
#include "ImportContext.h"
#include "ImportNetlist.h"
#include "ImportReader.h"
#include "ImportSink.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"
#include "Writes.h"

#include <algorithm>
#include <optional>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;
namespace Import = Tool::Import;

std::optional<Import::Bit> PickUnknownAs(Fuzz::Bytes& bytes) {
    switch (bytes.Choose(4)) {
    case 0:
        return Import::Zero;
    case 1:
        return Import::One;
    default:
        return std::nullopt;
    }
}

std::string WriteCommands(const Import::Netlist& netlist) {
    Fuzz::MemoryFiles files;
    Port::File file;
    Check(file.open("commands", Port::File::Overwrite, true), "the command file is open");
    Port::Stream stream(file);
    Import::CommandSink sink(stream);
    netlist.Emit(sink);
    Check(stream.flush() && file.close(), "the command file is written");
    return files.GetFiles().at("commands");
}

void Replay(Model& model, std::string_view commands) {
    while (!commands.empty()) {
        const std::size_t end = std::min(commands.find('\n'), commands.size() - 1);
        model.ExecuteLine(commands.substr(0, end));
        commands.remove_prefix(end + 1);
    }
}

void CheckImport(const Import::Netlist& netlist) {
    CommandFactory factory;
    Model direct(&factory);
    Import::ModelSink sink(direct);
    netlist.Emit(sink);
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
    const std::optional<Import::Bit> unknownAs = PickUnknownAs(bytes);
    const bool keepAttributes = bytes.Choose(2) == 0;
    try {
        const std::unique_ptr<Import::Design> design =
            Import::ReadDesign(std::string(bytes.Rest()), keepAttributes);
        Import::Module& top = Import::FindTop(*design, "");
        Import::Context context(top, unknownAs);
        CheckImport(Import::Netlist(*design, top, context));
    } catch (const Import::Error&) {
        // What is no netlist, or cannot be imported, is told.
    }
    return 0;
}
