#include "HdlModel/Objects/ObjectName.h"

#include "Containers/EightBytes.h"
#include "HdlModel/Objects/ObjectDetails.h"

#include <atomic>
#include <cstring>
#include <memory>
#include <new>
#include <utility>

namespace Orn_Hdl {

/// A long name, shared by copies; its characters follow it in memory.
struct ObjectName::Shared {
    std::atomic<std::uint32_t> users;
    std::size_t length;

    char* GetText() noexcept { return reinterpret_cast<char*>(this + 1); }
};

ObjectName::Shared* ObjectName::GetShared() const noexcept {
    return static_cast<Shared*>(GetPointer());
}

/// The name itself. It is stored in the details if there are any.
const ObjectName& ObjectName::GetPlain() const noexcept {
    const ObjectDetails* const details = GetDetails();
    return details == nullptr ? *this : details->name;
}

ObjectName& ObjectName::GetPlain() noexcept {
    ObjectDetails* const details = GetDetails();
    return details == nullptr ? *this : details->name;
}

std::string_view ObjectName::LongView() const noexcept {
    const ObjectName& plain = GetPlain();
    if (plain.length_ != SharedLength) {
        return std::string_view(plain.bytes_, plain.length_);
    }
    Shared* const shared = plain.GetShared();
    return std::string_view(shared->GetText(), shared->length);
}

ObjectDetails& ObjectName::MakeDetails() {
    if (GetDetails() == nullptr) {
        auto details = std::make_unique<ObjectDetails>();
        details->name = *this;
        Release();
        SetPointer(details.release(), DetailedLength);
    }
    return *GetDetails();
}

void ObjectName::Release() noexcept {
    if (length_ == SharedLength) {
        Shared* const shared = GetShared();
        if (shared->users.fetch_sub(1, std::memory_order_acq_rel) == 1) {
            ::operator delete(shared);
        }
    } else if (length_ == DetailedLength) {
        delete GetDetails();
    }
    length_ = 0;
}

/// Copies a name where one of both is not stored in its object.
void ObjectName::CopyLong(const ObjectName& other) noexcept {
    ObjectName& to = GetPlain();
    const ObjectName& from = other.GetPlain();
    if (&to != &from) {
        if (from.length_ == SharedLength) {
            from.GetShared()->users.fetch_add(1, std::memory_order_relaxed);
        }
        to.Release();
        std::memcpy(to.bytes_, from.bytes_, sizeof bytes_);
        to.length_ = from.length_;
    }
}

void ObjectName::Swap(ObjectName& other) noexcept {
    std::swap(bytes_, other.bytes_);
    std::swap(length_, other.length_);
}

void ObjectName::Assign(std::string_view text) {
    ObjectName& name = GetPlain();
    if (text.size() <= InlineCapacity) {
        // The text may be part of the name that it replaces.
        char copy[InlineCapacity] = {};
        EightBytes::Copy(text.data(), text.size(), copy);
        name.Release();
        std::memcpy(name.bytes_, copy, sizeof copy);
        name.length_ = static_cast<std::uint8_t>(text.size());
        return;
    }
    void* const memory = ::operator new(sizeof(Shared) + text.size());
    Shared* const shared = ::new (memory) Shared{{1}, text.size()};
    text.copy(shared->GetText(), text.size());
    name.Release();
    name.SetPointer(shared, SharedLength);
}

} // namespace Orn_Hdl
