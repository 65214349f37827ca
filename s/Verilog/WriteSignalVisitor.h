// Writes a signal as a Verilog expression.
#pragma once

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Streams.h"

#include <optional>
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

    /// What is written for a signal if that is one piece of text, as for most signals; nothing for
    /// another one. Null is no signal, for which the text is empty. The text is valid until the
    /// next call.
    std::optional<std::string_view> GetPiece(const Signal* signal);

    void VisitScalarSignal(ScalarSignal* signal) override;
    void VisitBus(Bus* bus) override;
    void VisitBusSlice(BusSlice* slice) override;
    void VisitBusIndex(BusIndex* bit) override;
    void VisitCompoundBus(CompoundBus* compound) override;

private:
    bool IsWritten(std::string_view name) const noexcept;
    std::string_view InBrackets(std::string_view name);
    void WriteInBrackets(std::string_view name);
    void WriteBits(const Names::BusName& slice);

    OutStream& out_;
    Place place_;
    std::string text_;
};

} // namespace Orn_Hdl
