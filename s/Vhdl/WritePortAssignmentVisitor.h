// Writes the associations of VHDL port maps.
#pragma once

#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers/Vhdl.h"

#include <string>
#include <string_view>
#include <utility>

namespace Orn_Hdl {

/// Writes one or more associations for each pin. In VHDL, neither a concatenation nor a slice
/// against its bus can be an actual, so these are associated piece by piece with slices of the
/// formal, the pin's name.
class WritePortAssignmentVisitor : public SignalVisitor {
public:
    /// What is written between two associations.
    struct Separator {
        /// Behind the former one.
        std::string_view after;
        /// In front of the next one.
        std::string_view before;
    };

    /// \param separator its texts are not owned.
    WritePortAssignmentVisitor(const Separator& separator, VhdlStatements& statements,
                               OutStream& out) noexcept
        : separator_(separator), statements_(statements), out_(out) {}

    /// Begins another port map, whose first association has no separator before it.
    void BeginPortMap() noexcept { pending_ = Separator(); }
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
    Separator TakeSeparator() noexcept { return std::exchange(pending_, separator_); }
    void WriteScalar(std::string_view actual);
    void WriteBus(std::string_view actual);
    void WriteFormal();
    void WriteAssociation(std::string_view formal, std::string_view actual);
    bool WriteBitByBit(std::string_view slice);

    Separator separator_;
    /// What is written in front of the next association.
    Separator pending_;
    /// The formal of the present association: a view of the pin's name, or of `formalText_`.
    std::string_view formal_;
    std::string formalText_;
    bool isScalarFormal_ = true;
    VhdlStatements& statements_;
    OutStream& out_;
};

} // namespace Orn_Hdl
