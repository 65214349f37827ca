// One imported netlist: every name and every connection settled, ready to be handed on.
#pragma once

#include "ImportComponents.h"
#include "ImportContext.h"
#include "ImportDesign.h"
#include "ImportNames.h"
#include "ImportNets.h"
#include "ImportSink.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Port {
class Stream;
}

namespace Tool::Import {

class Netlist {
public:
    /// Checks everything there is to check, so that nothing is handed on of a design that is
    /// refused. The design is changed where a constant stands at an output pin.
    /// \param top a module of the design.
    /// \throws Error when the design cannot be imported.
    Netlist(Design& design, Module& top, Context& context);

    const std::string& GetName() const noexcept { return name_; }
    /// Hands on the whole netlist; the same sequence of operations for every sink.
    void Emit(Sink& sink) const;
    /// Writes a table of the names in the file and what became of them: kind, old name and new one,
    /// separated by tabs.
    void WriteNameMap(Port::Stream& out) const;

private:
    /// Gives bits of output pins that are constants, and so drive nothing, net bits of their own.
    /// \return `components`.
    static const Components& OpenConstantOutputs(Module& top, Context& context,
                                                 const Components& components);

    void NameDesign();
    void NameCells();
    std::string GetWantedCellName(std::size_t cell) const;
    void NameAttributes();
    void NameAttributesOf(std::string_view table, std::string_view owner, const Span& attributes);
    void SettleConnections();
    bool HasOpenInput(std::size_t cell) const;
    void CheckParameters();
    void EmitCell(Sink& sink, std::size_t index) const;
    void EmitAttributes(Sink& sink) const;

    Context& context_;
    const Module& top_;
    NameTable names_;
    Components components_;
    Nets nets_;
    std::string name_;
    std::vector<std::string> cellNames_;
    std::unordered_map<std::string_view, std::string> attributeNames_;
    /// By connection: a constant whose own signal would share its name with another one.
    std::vector<bool> sharesConstants_;
    bool hasOpenInputs_ = false;
};

} // namespace Tool::Import
