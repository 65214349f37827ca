#include "Options/EffectiveAttrs.h"

#include "Orn_Hdl/Containers/StringPtrMap.h"

namespace Orn_Hdl {

int GetEffectiveAttrs(const Instance& instance, PtrArray<Attribute*>& attributes) {
    attributes.Empty();
    const Component* const component = instance.GetComponent();
    const bool canHide = component != nullptr && component->HasAttrs();
    if (!canHide && !instance.HasAttrs()) {
        return 0;
    }
    // Compares present names: a look-up in the instance finds a renamed attribute by its former
    // name.
    IStringPtrMap<const Attribute*> hiding;
    for (Attribute* attribute : instance.GetAttrIterator()) {
        attributes.Add(attribute);
        if (canHide) {
            hiding.Add(attribute->GetNameView(), attribute);
        }
    }
    const int own = attributes.GetSize();
    if (canHide) {
        for (Attribute* attribute : component->GetAttrIterator()) {
            if (!hiding.Contains(attribute->GetNameView())) {
                attributes.Add(attribute);
            }
        }
    }
    return own;
}

} // namespace Orn_Hdl
