// What a script says, in the order of its lines: options, module, components, signals, compounds,
// instances with the connections of their pins, aliases.
//
// The order of most objects does not show in a netlist, since a write sorts them. What shows is the
// order of a component's pins, of the slices and bits of a bus, of aliases, attributes and comment
// lines. A script keeps these, and says what comes from a use of a name, not from a line of its
// own, by that use only. So the script of the replayed design is the same.
#include "HdlCmd/Script/CommandScript.h"

#include "HdlCmd/Script/DesignScript.h"
#include "HdlCmd/Script/Lines.h"
#include "HdlCmd/Script/OptionScript.h"

namespace Orn_Hdl {

void WriteCommandScript(const Netlist& netlist, const HdlOptions& options, OutStream& out) {
    const auto write = [&netlist, &options](Script::Lines& lines) {
        Script::WriteOptions(netlist, options, lines);
        Script::DesignScript(netlist, lines).Write();
    };
    Script::Lines trial(nullptr);
    write(trial);
    Script::Lines lines(&out);
    write(lines);
}

} // namespace Orn_Hdl
