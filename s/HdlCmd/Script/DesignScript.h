// The commands of a script that make the design.
#pragma once

#include "HdlCmd/Script/Expressible.h"
#include "HdlCmd/Script/InstanceStages.h"
#include "HdlCmd/Script/Lines.h"
#include "HdlCmd/Script/SettledSignals.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string>
#include <string_view>

namespace Orn_Hdl::Script {

/// Says a netlist object by object.
class DesignScript {
public:
    DesignScript(const Netlist& netlist, Lines& lines);

    void Write();

private:
    void WriteComponent(const Component& component);
    void AddInstance(const Instance& instance);
    void WriteConnections(const Instance& instance);
    void WritePin(const Instance& instance, const Pin& pin);
    void WriteUnlisted(const Instance& instance, const Pin& pin);
    void WritePinHolder(const HolderPhrases& phrases, std::string_view owner, const Pin& pin);

    void WriteSignals();
    void WriteDeclared(const Signal& signal);
    void WriteBus(const Bus& bus);
    void Declare(const Signal& signal, std::string_view name);
    void WritePart(const SettledSignal& part);
    void WriteCompound(const CompoundBus& compound);
    void Use(std::string_view name, const BitVectorValue& constant);
    void WriteConstant(const Signal& signal);
    void WriteSignalHolder(const Signal& signal, std::string_view name);
    bool AppearsByUse(const SettledSignal& settled) const;

    void WriteAllAliases();
    void WriteAliases(const SettledSignal& settled);

    const std::string& PinPath(std::string_view owner, const Pin& pin);

    const Netlist& netlist_;
    Lines& lines_;
    const Phrases& phrases_;
    const SettledSignals settled_;
    const InstanceStages stages_;
    /// Looks at objects only in a trial.
    Expressible expressible_;
    std::string pinPath_;
};

} // namespace Orn_Hdl::Script
