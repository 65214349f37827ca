// Writes a signal as a Verilog expression.
#pragma once

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Streams.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {

/// Writes a name, with its range or index in brackets, or a concatenation. Verilog does not allow a
/// slice against its bus, so such a slice becomes a concatenation of its bits.
class WriteSignalVisitor : public SignalVisitor {
public:
    enum Place {
        /// In a pin connection, where an empty name or "open" means no connection.
        Connection,
        /// In an assignment, where every name means a signal.
        Assignment
    };

    WriteSignalVisitor(OutStream& out, Place place) noexcept : out_(out), place_(place) {}

    void VisitScalarSignal(ScalarSignal* signal) override;
    void VisitBus(Bus* bus) override;
    void VisitBusSlice(BusSlice* slice) override;
    void VisitBusIndex(BusIndex* bit) override;
    void VisitCompoundBus(CompoundBus* compound) override;

private:
    bool IsWritten(const Signal& signal) const noexcept;
    void WriteInBrackets(std::string_view name);
    void WriteBits(const Names::BusName& slice);

    OutStream& out_;
    Place place_;
    std::string text_;
};

} // namespace Orn_Hdl
