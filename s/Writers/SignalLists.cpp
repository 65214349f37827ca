#include "Writers/SignalLists.h"

#include "HdlModel/Netlist/WalkAhead.h"
#include "Writers/Text.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

namespace Orn_Hdl::Writers {

SignalLists::SignalLists(const Netlist& netlist, Language language) {
    WalkAhead(netlist.GetSignalIterator(), [this, language](Signal& signal) {
        Measure(signal);
        if (IsWritable(language, signal.GetNameView())) {
            Add(signal);
        }
    });
}

void SignalLists::Measure(const Signal& signal) noexcept {
    const int length =
        static_cast<int>(std::min<std::size_t>(signal.GetNameView().size(), INT32_MAX));
    if (signal.IsPort()) {
        longestPort = std::max(longestPort, length);
    }
    if (signal.IsNeededToDeclared()) {
        longestDeclared = std::max(longestDeclared, length);
    }
    if (signal.HasAttrs()) {
        longestAttr = std::max(longestAttr, Netlist::GetLongestAttrName(&signal));
    }
}

void SignalLists::Add(Signal& signal) {
    if (signal.IsNeededToDeclared()) {
        if (signal.IsPort()) {
            ports.push_back(&signal);
        } else {
            internals.push_back(&signal);
            if (signal.HasAttrs()) {
                attributed.push_back(&signal);
            }
        }
    }
    if (!signal.GetConstantValue().GetValue().IsEmpty()) {
        constants.push_back(&signal);
    }
    if (!signal.GetSignalIterator().IsAtEnd()) {
        aliased.push_back(&signal);
    }
}

bool IsWritable(Language language, std::string_view name) {
    return language == Language::Vhdl ? !IsOpen(name) : !name.empty();
}

bool RunsAgainstParent(const Signal& signal) {
    return signal.GetSignalType() == SignalTypeBusSlice && signal.GetWidth() != 1 &&
           !static_cast<const BusSlice&>(signal).IsSameDirectionAsParent();
}

} // namespace Orn_Hdl::Writers
