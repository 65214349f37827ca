#include "Writers/NetlistPass.h"

namespace Orn_Hdl::Writers {

void NetlistPass::Prepare() {
    netlist_.SortNetlist();
    netlist_.CreateVhdlDummySignals();
    passesInit_ = PassesInit(language_, netlist_);
}

void NetlistPass::WriteOpening() {
    if (options_.writeHeader) {
        HdlUtilities::WriteHeader(netlist_.GetName(), language_, options_, out_);
    }
    WriteComment(out_, language_, netlist_);
}

Attribute* NetlistPass::FindPassedInit(const GenericAttrs& attributes) const {
    return passesInit_ ? attributes.FindInit() : nullptr;
}

} // namespace Orn_Hdl::Writers
