// The common part of the writers of all languages.
#pragma once

#include "HdlModel/Netlist/SignalsAhead.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Writers/Generics.h"
#include "Writers/SignalLists.h"
#include "Writers/Text.h"

namespace Orn_Hdl::Writers {

/// One write of one netlist: first the netlist is prepared, then it is only read. The writer of
/// each language derives from it.
class NetlistPass {
public:
    NetlistPass(const NetlistPass&) = delete;
    NetlistPass& operator=(const NetlistPass&) = delete;

protected:
    NetlistPass(Language language, OutStream& out, Netlist& netlist,
                const HdlOptions& options) noexcept
        : out_(out), netlist_(netlist), options_(options), language_(language) {}
    ~NetlistPass() = default;

    /// Sorts the netlist and makes the dummy signals that it needs.
    void Prepare();
    /// Writes the header, if the options ask for it, and the netlist's comment.
    void WriteOpening();
    /// Calls `write` between two comments that hide its output from synthesis.
    template <class Write> void WriteHidden(const Write& write);
    /// Calls `writeConstant` for each signal that has a constant, then `writeAlias` for each signal
    /// and each of its aliases.
    template <class WriteConstant, class WriteAlias>
    void WriteAssignments(const SignalLists& signals, const WriteConstant& writeConstant,
                          const WriteAlias& writeAlias) const;
    template <class Write> void ForEachInstance(const Write& write) const;
    /// The attribute INIT of an instance whose value is the module's own INIT; null if there is
    /// none, or if this netlist does not pass it on.
    Attribute* FindPassedInit(const GenericAttrs& attributes) const;

    OutStream& out_;
    Netlist& netlist_;
    const HdlOptions& options_;

private:
    const Language language_;
    bool passesInit_ = false;
};

template <class Write> void NetlistPass::WriteHidden(const Write& write) {
    Writers::WriteHidden(out_, language_, write);
}

template <class WriteConstant, class WriteAlias>
void NetlistPass::WriteAssignments(const SignalLists& signals, const WriteConstant& writeConstant,
                                   const WriteAlias& writeAlias) const {
    for (Signal* signal : signals.constants) {
        writeConstant(*signal);
    }
    for (Signal* signal : signals.aliased) {
        for (Signal* alias : signal->GetSignalIterator()) {
            if (IsWritable(language_, alias->GetNameView())) {
                writeAlias(*signal, *alias);
            }
        }
    }
}

template <class Write> void NetlistPass::ForEachInstance(const Write& write) const {
    constexpr int Lead = 4;
    SignalsAhead ahead(netlist_, Lead);
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        ahead.Step();
        write(*instance);
    }
}

} // namespace Orn_Hdl::Writers
