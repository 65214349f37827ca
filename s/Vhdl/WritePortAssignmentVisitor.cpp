#include "Vhdl/WritePortAssignmentVisitor.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/SignalBits.h"
#include "Writers/Text.h"

#include <climits>
#include <utility>

namespace Orn_Hdl {

using std::string_view;
using Writers::Put;
using namespace std::literals::string_view_literals;

void WritePortAssignmentVisitor::WritePin(const Pin& pin) {
    SetFormal(pin.GetNameView());
    if (Signal* const signal = pin.GetSignal()) {
        signal->AcceptSignal(*this);
    } else if (pin.GetPinType() == PinTypeBus) {
        WriteBus(string_view());
    } else {
        WriteScalar(string_view());
    }
}

/// A formal of one bit is written as a bit, not as a range.
/// \param name must outlive the association.
void WritePortAssignmentVisitor::SetFormal(string_view name) {
    Names::BusName bus;
    const bool isBus = Names::ParseBus(name, bus);
    isScalarFormal_ = !isBus || bus.IsOneBit();
    formal_ = name;
    if (isBus && bus.IsOneBit()) {
        formalText_ = Names::WithIndex(bus.base, bus.leftIndex);
        formal_ = formalText_;
    }
}

/// Replaces the formal by a slice of it; only a formal with a range can be sliced.
void WritePortAssignmentVisitor::SetFormalPiece(const std::string& formal, int start, int count) {
    if (Bus::IsBusName(formal.c_str())) {
        formalText_ = Bus::GetBusSliceName(formal.c_str(), start, count).GetView();
        SetFormal(formalText_);
    } else {
        SetFormal(formal);
    }
}

/// Ends the association in front of the next one, if there is any.
/// \return what the next one begins with.
string_view WritePortAssignmentVisitor::EndFormerAssociation() {
    if (std::exchange(isFirst_, false)) {
        return {};
    }
    if (!isOnePerLine_) {
        return ", ";
    }
    text_.EndLine(",");
    return "          ";
}

void WritePortAssignmentVisitor::WriteFormal() {
    Put(out_, EndFormerAssociation());
    if (isScalarFormal_) {
        Put(out_, formal_);
    } else {
        statements_.WriteBus(formal_);
    }
    Put(out_, "=>");
}

void WritePortAssignmentVisitor::WriteAssociation(string_view formal, string_view actual) {
    text_.Put(EndFormerAssociation(), formal, "=>", actual);
}

void WritePortAssignmentVisitor::WriteScalar(string_view actual) {
    WriteAssociation(formal_, actual.empty() ? "open"sv : actual);
}

void WritePortAssignmentVisitor::WriteBus(string_view actual) {
    if (actual.empty()) {
        WriteAssociation(Names::BaseName(formal_), "open");
        return;
    }
    WriteFormal();
    Names::BusName bus;
    if (Names::ParseBus(actual, bus) && bus.IsOneBit()) {
        Put(out_, string_view(Names::WithIndex(bus.base, bus.leftIndex)));
    } else {
        statements_.WriteBus(actual);
    }
}

void WritePortAssignmentVisitor::VisitScalarSignal(ScalarSignal* signal) {
    WriteScalar(signal->GetNameView());
}

void WritePortAssignmentVisitor::VisitBus(Bus* bus) {
    WriteBus(bus->GetNameView());
}

void WritePortAssignmentVisitor::VisitBusSlice(BusSlice* slice) {
    const string_view name = slice->GetNameView();
    if (!slice->IsSameDirectionAsParent() && WriteBitByBit(name)) {
        return;
    }
    WriteFormal();
    statements_.WriteBus(Writers::IsOpen(name) ? "open"sv : name);
}

void WritePortAssignmentVisitor::VisitBusIndex(BusIndex* bit) {
    WriteScalar(bit->GetNameView());
}

void WritePortAssignmentVisitor::VisitCompoundBus(CompoundBus* compound) {
    const std::string formal(formal_);
    int offset = 0;
    for (Signal* member : compound->GetBusMemberIterator()) {
        const int width = member->GetWidth();
        if (width > 0) {
            SetFormalPiece(formal, offset, width);
            member->AcceptSignal(*this);
            offset = width > INT_MAX - offset ? INT_MAX : offset + width;
        }
    }
}

/// \return false, without writing anything, if the slice cannot be expanded.
bool WritePortAssignmentVisitor::WriteBitByBit(string_view slice) {
    Names::BusName range;
    if (!Names::ParseBus(slice, range) || !range.IsExpandable()) {
        return false;
    }
    const std::string formal(formal_);
    int position = 0;
    SignalBits::ForEach(range, range.GetBits(), [this, &formal, &position](string_view bit) {
        SetFormalPiece(formal, position++, 1);
        WriteScalar(bit);
    });
    return true;
}

} // namespace Orn_Hdl
