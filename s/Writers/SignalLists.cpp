#include "Writers/SignalLists.h"

#include "Writers/Text.h"

namespace Orn_Hdl::Writers {

SignalLists::SignalLists(const Netlist& netlist, Language language) {
    for (Signal* signal : netlist.GetSignalIterator()) {
        if (!IsWritable(language, signal->GetNameView())) {
            continue;
        }
        if (signal->IsNeededToDeclared()) {
            (signal->IsPort() ? ports : internals).push_back(signal);
        }
        if (!signal->GetConstantValue().GetValue().IsEmpty()) {
            constants.push_back(signal);
        }
        if (!signal->GetSignalIterator().IsAtEnd()) {
            aliased.push_back(signal);
        }
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
