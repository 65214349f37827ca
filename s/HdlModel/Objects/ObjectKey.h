// What the owners of objects need to know of them: whether they have an owner, and the name under
// which they are found.
#pragma once

#include "Orn_Hdl/Model/Object.h"

#include <string_view>

namespace Orn_Hdl {

/// Whether an object has an owner that finds it by name. An object never gets a second one.
class OwnedFlag {
public:
    static bool Get(const Object& object) noexcept { return object.HasFlag(Object::OwnedFlagBit); }
    static void Set(Object& object) noexcept { object.SetFlag(Object::OwnedFlagBit, true); }
    static void Clear(Object& object) noexcept { object.SetFlag(Object::OwnedFlagBit, false); }
};

/// The name that an object had when its owner took it.
struct ObjectKey {
    static std::string_view Get(const Object& object) noexcept { return object.GetKeyName(); }
    /// Makes the current name the key name. Called when the owner releases the object.
    static void Drop(Object& object) noexcept { object.DropKeyName(); }
    /// Swaps the name with another one, which becomes the key name.
    static void Replace(Object& object, ObjectName& name) noexcept { object.SwapName(name); }
};

} // namespace Orn_Hdl
