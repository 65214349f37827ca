#include "Writers/Generics.h"

namespace Orn_Hdl::Writers {

namespace {

Attribute* FindInitIn(const PtrArray<Attribute*>& attributes) {
    for (Attribute* attribute : Iterator<Attribute*>(&attributes)) {
        if (attribute->GetNameView() == "INIT") {
            return attribute;
        }
    }
    return nullptr;
}

} // namespace

void GenericAttrs::Split(const Iterator<Attribute*>& attributes) {
    syn.Empty();
    nosyn.Empty();
    for (Attribute* attribute : attributes) {
        if (attribute == nullptr) {
            continue;
        }
        if (attribute->GetGenericOption() == Attribute::GenericSyn) {
            syn.Add(attribute);
        } else if (attribute->GetGenericOption() == Attribute::GenericNoSyn) {
            nosyn.Add(attribute);
        }
    }
}

Attribute* GenericAttrs::FindInit() const {
    Attribute* const init = FindInitIn(syn);
    return init != nullptr ? init : FindInitIn(nosyn);
}

bool InitDefined(const Netlist& netlist) {
    return GenericAttrs(netlist.GetAttrIterator()).FindInit() != nullptr;
}

} // namespace Orn_Hdl::Writers
