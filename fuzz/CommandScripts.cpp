#include "CommandScripts.h"

#include "Check.h"

#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Streams.h"

#include <cstdio>
#include <optional>
#include <string>
#include <string_view>

namespace Fuzz {

namespace {

using Orn_Hdl::Model;

std::string WriteCommands(const Model& model) {
    Orn_Hdl::TextMemOutStream out;
    model.WriteCommands(out);
    return std::string(out.GetValue().GetView());
}

/// The commands of a model; nothing if they cannot express it.
std::optional<std::string> FindCommands(const Model& model) {
    try {
        return WriteCommands(model);
    } catch (const Orn_Hdl::Exception& exception) {
        const std::string_view text = exception.getLocalized().GetView();
        constexpr std::string_view Beginning = "No command can express ";
        Check(text.substr(0, Beginning.size()) == Beginning, "commands are refused with a reason");
        return std::nullopt;
    }
}

} // namespace

void CheckCommands(const Model& model) {
    const std::optional<std::string> commands = FindCommands(model);
    if (!commands) {
        return;
    }
    Orn_Hdl::CommandFactory factory;
    Model replayed(&factory);
    for (std::string_view rest = *commands; !rest.empty();) {
        const std::string_view line = rest.substr(0, rest.find('\n'));
        rest.remove_prefix(line.size() + 1);
        try {
            replayed.ExecuteLine(line);
        } catch (const Orn_Hdl::Exception& exception) {
            std::fprintf(stderr, "%.*s: %s", static_cast<int>(line.size()), line.data(),
                         exception.what());
            Check(false, "the commands of a model are executed");
        }
    }
    Check(WriteCommands(replayed) == *commands, "the commands of a model come again");
}

} // namespace Fuzz
