#include "Containers/PlaceOf.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/AttributeTable.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Objects/OwnerLink.h"
#include "Orn_Hdl/Attributes.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl {

AttributeTable::~AttributeTable() {
    while (Attribute* const last = attributes.GetTail()) {
        attributes.RemoveTail();
        last->table_ = nullptr;
        delete last;
    }
}

void AttributeTable::Add(std::unique_ptr<Attribute> attribute) {
    const std::string_view name = attribute->GetNameView();
    attributes.AddNew(attribute.get());
    Attribute* const added = attribute.release();
    added->table_ = this;
    OwnedFlag::Set(*added);
    hasNamesakes = hasNamesakes || byName.Contains(name);
    byName.Add(name, added);
}

Attribute* AttributeTable::FindNamesake(const Attribute& attribute) const noexcept {
    for (int i = attributes.GetSize() - 1; i >= 0; --i) {
        Attribute* const other = attributes.GetAt(i);
        if (other != &attribute &&
            Port::EqualIgnoringCase(ObjectKey::Get(*other), ObjectKey::Get(attribute))) {
            return other;
        }
    }
    return nullptr;
}

void AttributeTable::LetGo(Attribute& attribute) noexcept {
    AttributeTable& table = *attribute.table_;
    const std::string_view name = ObjectKey::Get(attribute);
    if (table.byName.Get(name) == &attribute) {
        Attribute* const namesake = table.hasNamesakes ? table.FindNamesake(attribute) : nullptr;
        if (namesake == nullptr) {
            table.byName.Remove(name);
        } else {
            // The name exists already, so nothing is allocated.
            table.byName.Add(name, namesake);
        }
    }
    table.attributes.RemoveAt(PlaceOf<Attribute>(table.attributes, &attribute));
    attribute.table_ = nullptr;
    OwnedFlag::Clear(attribute);
    ObjectKey::Drop(attribute);
}

/// Where an attribute of this table is; looks from the last place on in both directions.
int AttributeTable::FindPlace(const Attribute& attribute) const noexcept {
    int below = std::min(lastPlace, attributes.GetSize() - 1);
    for (int above = below + 1; attributes.GetAt(below) != &attribute; ++above, --below) {
        if (attributes.GetAt(above) == &attribute) {
            return above;
        }
    }
    return below;
}

void AttributeTable::Replace(Attribute& present, std::unique_ptr<Attribute> attribute) {
    AttributeTable& table = *present.table_;
    const std::string_view name = ObjectKey::Get(present);
    const bool isFound = table.byName.Get(name) == &present;
    const int place = table.FindPlace(present);
    if (isFound) {
        // The name exists already, so nothing is allocated.
        table.byName.Add(name, attribute.get());
    }
    table.attributes.SetAt(place, attribute.get());
    table.lastPlace = place;
    Attribute* const added = attribute.release();
    added->table_ = &table;
    OwnedFlag::Set(*added);
    present.table_ = nullptr;
    OwnedFlag::Clear(present);
    delete &present;
}

AttributeHolder::AttributeHolder() noexcept = default;

AttributeHolder::AttributeHolder(const AttributeHolder& other) {
    try {
        for (const Attribute* attribute : other.GetAttrIterator()) {
            AttributeHolder::AddAttr(attribute->CloneAttribute());
        }
    } catch (...) {
        delete GetTable();
        throw;
    }
}

AttributeHolder& AttributeHolder::operator=(const AttributeHolder& other) {
    if (this != &other) {
        AttributeHolder copy(other);
        SwapAttrs(copy);
    }
    return *this;
}

AttributeHolder::~AttributeHolder() {
    delete GetTable();
}

void AttributeHolder::SwapAttrs(AttributeHolder& other) noexcept {
    void* const owner = OwnerLink::Get<void>(*this);
    void* const ownerOfOther = OwnerLink::Get<void>(other);
    std::swap(link_, other.link_);
    OwnerLink::Set(*this, owner);
    OwnerLink::Set(other, ownerOfOther);
}

AttributeTable& AttributeHolder::MakeTable() {
    AttributeTable* table = GetTable();
    if (table == nullptr) {
        table = new AttributeTable;
        table->owner = OwnerLink::Get<void>(*this);
        link_ = table;
    }
    return *table;
}

bool AttributeHolder::HasAttrsInTable() const noexcept {
    return !GetTable()->attributes.IsEmpty();
}

void AttributeHolder::AddAttr(Attribute* attribute) {
    if (attribute != nullptr && !OwnedFlag::Get(*attribute)) {
        std::unique_ptr<Attribute> taken(attribute);
        MakeTable().Add(std::move(taken));
    }
}

void AttributeHolder::RemoveAttr(Attribute* attribute) noexcept {
    DetachAttr(attribute).reset();
}

std::unique_ptr<Attribute> AttributeHolder::DetachAttr(Attribute* attribute) noexcept {
    const AttributeTable* const table = GetTable();
    if (table == nullptr || attribute == nullptr || !table->Holds(*attribute)) {
        return nullptr;
    }
    AttributeTable::LetGo(*attribute);
    return std::unique_ptr<Attribute>(attribute);
}

Attribute* AttributeHolder::GetAttr(const char* name) const {
    const AttributeTable* const table = GetTable();
    return table == nullptr
               ? nullptr
               : table->byName.Get(Names::NormalizedText(Port::ViewOf(name)).GetView());
}

Iterator<Attribute*> AttributeHolder::GetAttrIterator() const noexcept {
    // The first attribute creates the table, and an assignment replaces it.
    return Iterator<Attribute*>(this, [](const void* holder) -> const PtrArray<Attribute*>* {
        const AttributeTable* const table = static_cast<const AttributeHolder*>(holder)->GetTable();
        return table == nullptr ? nullptr : &table->attributes;
    });
}

} // namespace Orn_Hdl
