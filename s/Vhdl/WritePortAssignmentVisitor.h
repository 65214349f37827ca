// Writes the associations of VHDL port maps.
#pragma once

#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers/Vhdl.h"
#include "Streams/DirectText.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {

/// Writes one or more associations for each pin. In VHDL, neither a concatenation nor a slice
/// against its bus can be an actual, so these are associated piece by piece with slices of the
/// formal, the pin's name.
class WritePortAssignmentVisitor : public SignalVisitor {
public:
    /// \param isOnePerLine whether each association has a line of its own.
    WritePortAssignmentVisitor(bool isOnePerLine, VhdlStatements& statements, OutStream& out)
        : isOnePerLine_(isOnePerLine), statements_(statements), out_(out) {}

    /// Begins another port map, whose first association has no separator before it.
    void BeginPortMap() noexcept { isFirst_ = true; }
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
    std::string_view EndFormerAssociation();
    void WriteScalar(std::string_view actual);
    void WriteBus(std::string_view actual);
    void WriteFormal();
    void WriteAssociation(std::string_view formal, std::string_view actual);
    bool WriteBitByBit(std::string_view slice);

    const bool isOnePerLine_;
    bool isFirst_ = true;
    /// The formal of the present association: a view of the pin's name, or of `formalText_`.
    std::string_view formal_;
    std::string formalText_;
    bool isScalarFormal_ = true;
    VhdlStatements& statements_;
    OutStream& out_;
    DirectText text_{out_};
};

} // namespace Orn_Hdl
