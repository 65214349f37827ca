// Writes the associations of VHDL port maps.
#pragma once

#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers/Vhdl.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {

/// Writes one association or several for each pin. VHDL knows no concatenation and no slice against
/// its bus as an actual, so these are wired in pieces, the pin's name, the formal, being cut to
/// match.
class WritePortAssignmentVisitor : public SignalVisitor {
public:
    /// \param separator what stands between two associations; not owned.
    WritePortAssignmentVisitor(std::string_view separator, VhdlStatements& statements,
                               OutStream& out) noexcept
        : separator_(separator), statements_(statements), out_(out) {}

    /// Begins another port map: no separator stands before its first association.
    void BeginPortMap() noexcept { pending_ = std::string_view(); }
    /// Writes the associations of a pin, which may be open.
    void WritePin(const Pin& pin);

    void VisitScalarSignal(ScalarSignal* signal) override;
    void VisitBus(Bus* bus) override;
    void VisitBusSlice(BusSlice* slice) override;
    void VisitBusIndex(BusIndex* bit) override;
    void VisitCompoundBus(CompoundBus* compound) override;

private:
    void SetFormal(std::string_view name);
    void SetFormalPiece(const std::string& formal, int start, int count);
    void WriteSeparator();
    void WriteScalar(std::string_view actual);
    void WriteBus(std::string_view actual);
    void WriteFormal();
    bool WriteBitByBit(const BusSlice& slice);

    std::string_view separator_;
    std::string_view pending_;
    std::string formal_;
    bool isScalarFormal_ = true;
    VhdlStatements& statements_;
    OutStream& out_;
};

} // namespace Orn_Hdl
