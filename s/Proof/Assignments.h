// The constants and aliases of a design, compared with the assignments of a netlist.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Proof/Bits.h"
#include "Proof/Findings.h"
#include "Readers/NetlistSink.h"

#include <string>

namespace Orn_Hdl::Proving {

/// A netlist assigns all constants first, in the order of the signals, then the aliases. One
/// constant or alias may be several assignments, of some bits each.
class Assignments {
public:
    /// \param dontCares whether a digit "-" of a constant stands for don't cares.
    Assignments(const Netlist& design, Language language, bool dontCares, Findings& findings);

    /// \{
    /// Takes an assignment of the netlist.
    void Tie(const Readers::Members& target, const std::string& bits, const Readers::Place& place);
    void Assign(const Readers::Members& target, const Readers::Members& source,
                const Readers::Place& place);
    /// \}
    /// Takes the end of the netlist.
    void End(const Readers::Place& place);

private:
    enum class Phase { Constants, Aliases, Done };

    bool IsNothing(const Signal& signal) const noexcept;
    bool IsOpenInVerilog(const Signal& signal) const noexcept;
    void SkipNothing() noexcept;
    void Advance();
    bool FindConstant();
    bool FindAlias();
    bool SetAlias();
    void Report(const std::string& found, const Readers::Place& place);
    std::string Describe() const;

    const Netlist& design_;
    const Language language_;
    const bool dontCares_;
    Findings& findings_;
    Phase phase_ = Phase::Constants;
    Iterator<Signal*> signals_;
    Iterator<Signal*> aliases_;
    /// What the netlist assigns next.
    const Signal* target_ = nullptr;
    const Signal* source_ = nullptr;
    BitQueue targetBits_;
    BitQueue sourceBits_;
    std::string constant_;
    /// How many bits of the constant were assigned.
    std::size_t tied_ = 0;
    /// Whether the assignments are another sequence than the design's; one report says so.
    bool isOff_ = false;
    /// Room that is kept.
    Runs targetRuns_;
    Runs sourceRuns_;
};

} // namespace Orn_Hdl::Proving
