#include "Verilog/WriteSignalVisitor.h"

#include "HdlModel/Signals/SignalBits.h"
#include "Writers/SignalLists.h"
#include "Writers/Text.h"

#include <algorithm>

namespace Orn_Hdl {

using std::string_view;
using Writers::Put;

namespace {

constexpr char InBracket(char c) noexcept {
    if (c == '(') {
        return '[';
    }
    return c == ')' ? ']' : c;
}

} // namespace

inline bool WriteSignalVisitor::IsWritten(string_view name) const noexcept {
    return place_ == Assignment || !Writers::IsOpen(name);
}

std::optional<string_view> WriteSignalVisitor::GetPiece(const Signal* signal) {
    if (signal == nullptr) {
        return string_view();
    }
    const int type = signal->GetSignalType();
    if (type != SignalTypeScalar && type != SignalTypeBusIndex) {
        return std::nullopt;
    }
    const string_view name = signal->GetNameView();
    if (!IsWritten(name)) {
        return string_view();
    }
    return type == SignalTypeScalar ? name : InBrackets(name);
}

string_view WriteSignalVisitor::InBrackets(string_view name) {
    text_.resize(name.size());
    std::transform(name.begin(), name.end(), text_.begin(), InBracket);
    return text_;
}

void WriteSignalVisitor::WriteInBrackets(string_view name) {
    Put(out_, InBrackets(name));
}

void WriteSignalVisitor::WriteBits(const Names::BusName& slice) {
    string_view separator = "{";
    SignalBits::ForEach(slice, slice.GetBits(), [this, &separator](string_view bit) {
        Put(out_, separator);
        separator = ", ";
        WriteInBrackets(bit);
    });
    Put(out_, "}");
}

void WriteSignalVisitor::VisitScalarSignal(ScalarSignal* signal) {
    if (IsWritten(signal->GetNameView())) {
        Put(out_, signal->GetNameView());
    }
}

void WriteSignalVisitor::VisitBus(Bus* bus) {
    if (!IsWritten(bus->GetNameView())) {
        return;
    }
    const string_view name = bus->GetNameView();
    Names::BusName parsed;
    if (Names::ParseBus(name, parsed) && parsed.IsOneBit()) {
        WriteInBrackets(Names::WithIndex(parsed.base, parsed.leftIndex));
    } else {
        WriteInBrackets(name);
    }
}

void WriteSignalVisitor::VisitBusSlice(BusSlice* slice) {
    if (!IsWritten(slice->GetNameView())) {
        return;
    }
    const string_view name = slice->GetNameView();
    Names::BusName parsed;
    if (Writers::RunsAgainstParent(*slice) && Names::ParseBus(name, parsed) &&
        parsed.IsExpandable()) {
        WriteBits(parsed);
    } else {
        WriteInBrackets(name);
    }
}

void WriteSignalVisitor::VisitBusIndex(BusIndex* bit) {
    if (IsWritten(bit->GetNameView())) {
        WriteInBrackets(bit->GetNameView());
    }
}

void WriteSignalVisitor::VisitCompoundBus(CompoundBus* compound) {
    if (!IsWritten(compound->GetNameView())) {
        return;
    }
    Put(out_, "{");
    bool isFirst = true;
    for (Signal* member : compound->GetBusMemberIterator()) {
        if (!isFirst) {
            Put(out_, ", ");
        }
        isFirst = false;
        member->AcceptSignal(*this);
    }
    Put(out_, "}");
}

} // namespace Orn_Hdl
