// The attributes of one holder.
#pragma once

#include "Orn_Hdl/Attributes.h"

#include <memory>

namespace Orn_Hdl {

/// Owns the attributes of a holder and finds them by name. The holder creates it with its
/// first attribute, or when it gets an owner.
struct AttributeTable {
    OwnPtrArray<Attribute*> attributes;
    IStringPtrMap<Attribute*> byName;
    /// The owner of the holder; see `OwnerLink`.
    void* owner = nullptr;
    /// Whether two attributes of one name have been held.
    bool hasNamesakes = false;
    /// Where an attribute was replaced last: the next one is often beside it.
    int lastPlace = 0;

    AttributeTable() = default;
    AttributeTable(const AttributeTable&) = delete;
    AttributeTable& operator=(const AttributeTable&) = delete;
    ~AttributeTable();

    /// Takes an attribute that has no owner.
    void Add(std::unique_ptr<Attribute> attribute);
    /// Whether the attribute is one of these.
    bool Holds(const Attribute& attribute) const noexcept { return attribute.table_ == this; }
    /// Takes an attribute out without destroying it.
    static void LetGo(Attribute& attribute) noexcept;
    /// Puts an attribute in the place of another one of the same name, which is destroyed.
    /// \param present one that a table holds.
    /// \param attribute one that has no owner.
    static void Replace(Attribute& present, std::unique_ptr<Attribute> attribute);
    /// Lets its table drop an attribute that is about to be destroyed.
    static void Leave(Attribute& attribute) noexcept {
        if (attribute.table_ != nullptr) {
            LetGo(attribute);
        }
    }

private:
    int FindPlace(const Attribute& attribute) const noexcept;
    Attribute* FindNamesake(const Attribute& attribute) const noexcept;
};

} // namespace Orn_Hdl
