#include "Writers/Generics.h"

#include "Orn_Hdl/Containers/StringPtrMap.h"

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

void GetEffectiveAttrs(const Instance& instance, PtrArray<Attribute*>& attributes) {
    attributes.Empty();
    const Component* const component = instance.GetComponent();
    const bool canHide = component != nullptr && component->HasAttrs();
    // By their present names: the instance goes on finding a renamed attribute by its former one.
    IStringPtrMap<const Attribute*> hiding;
    for (Attribute* attribute : instance.GetAttrIterator()) {
        attributes.Add(attribute);
        if (canHide) {
            hiding.Add(attribute->GetNameView(), attribute);
        }
    }
    if (canHide) {
        for (Attribute* attribute : component->GetAttrIterator()) {
            if (!hiding.Contains(attribute->GetName().CStr())) {
                attributes.Add(attribute);
            }
        }
    }
}

bool InitDefined(const Netlist& netlist) {
    return GenericAttrs(netlist.GetAttrIterator()).FindInit() != nullptr;
}

} // namespace Orn_Hdl::Writers
