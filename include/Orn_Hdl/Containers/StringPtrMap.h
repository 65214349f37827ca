/// \file
/// `IStringPtrMap<T>`, a map from a name, letter case ignored, to a pointer that it does not own.
#pragma once

#include "Port/Ascii.h"
#include "Port/Export.h"

#include <memory>
#include <string_view>
#include <type_traits>

namespace Orn_Hdl {

/// The untyped map behind every `IStringPtrMap<T>`. It copies the names and never deletes what the
/// pointers point at. An empty map owns no memory.
class ORN_HDL_API IStringPtrMapBase {
public:
    /// An empty map.
    IStringPtrMapBase() noexcept;
    /// Copies the names and the pointers, not what they point at.
    IStringPtrMapBase(const IStringPtrMapBase& other);
    /// Replaces the contents by copies of the names and the pointers, not of what they point at.
    IStringPtrMapBase& operator=(const IStringPtrMapBase& other);
    /// Does not delete what the pointers point at.
    virtual ~IStringPtrMapBase();

    /// Adds a name, or replaces the pointer of a name that is present, which keeps its first
    /// spelling.
    void Add(std::string_view name, void* pointer);
    /// Adds a name, or replaces the pointer of a name that is present, which keeps its first
    /// spelling. A null name is read as "".
    void Add(const char* name, void* pointer) { Add(Port::ViewOf(name), pointer); }
    /// The pointer of a name; null if the name is absent.
    void* Get(std::string_view name) const noexcept;
    /// The pointer of a name; null if the name is absent. A null name is read as "".
    void* Get(const char* name) const noexcept { return Get(Port::ViewOf(name)); }
    /// Whether the name is present.
    bool Contains(std::string_view name) const noexcept;
    /// Whether the name is present. A null name is read as "".
    bool Contains(const char* name) const noexcept { return Contains(Port::ViewOf(name)); }
    /// Removes a name, if it is present.
    void Remove(std::string_view name) noexcept;
    /// Removes a name, if it is present. A null name is read as "".
    void Remove(const char* name) noexcept { Remove(Port::ViewOf(name)); }
    /// Whether there are no names.
    bool IsEmpty() const noexcept;
    /// Removes all names.
    void Empty() noexcept;

private:
    struct Table;
    std::unique_ptr<Table> table_;
};

/// The typed front: `T` is a pointer to an object or to a function.
template <class T> class IStringPtrMap : public IStringPtrMapBase {
public:
    static_assert(std::is_pointer<T>::value, "the map holds pointers");

    /// Adds a name, or replaces the pointer of a name that is present, which keeps its first
    /// spelling.
    void Add(std::string_view name, T pointer) { IStringPtrMapBase::Add(name, ToUntyped(pointer)); }
    /// Adds a name, or replaces the pointer of a name that is present, which keeps its first
    /// spelling. A null name is read as "".
    void Add(const char* name, T pointer) { Add(Port::ViewOf(name), pointer); }
    /// The pointer of a name; null if the name is absent.
    T Get(std::string_view name) const noexcept {
        return FromUntyped(IStringPtrMapBase::Get(name));
    }
    /// The pointer of a name; null if the name is absent. A null name is read as "".
    T Get(const char* name) const noexcept { return Get(Port::ViewOf(name)); }

private:
    static void* ToUntyped(T pointer) noexcept {
        if constexpr (std::is_function<std::remove_pointer_t<T>>::value) {
            return reinterpret_cast<void*>(pointer);
        } else {
            return const_cast<void*>(static_cast<const void*>(pointer));
        }
    }
    static T FromUntyped(void* pointer) noexcept {
        if constexpr (std::is_function<std::remove_pointer_t<T>>::value) {
            return reinterpret_cast<T>(pointer);
        } else {
            return static_cast<T>(pointer);
        }
    }
};

} // namespace Orn_Hdl
