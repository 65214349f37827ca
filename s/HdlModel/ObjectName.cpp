#include "Orn_Hdl/Model/ObjectName.h"

#include <atomic>
#include <cstring>
#include <new>

namespace Orn_Hdl {

/// A long name, shared by copies; its characters follow it in memory.
struct ObjectName::Shared {
    std::atomic<std::uint32_t> users;
    std::size_t length;

    char* GetText() noexcept { return reinterpret_cast<char*>(this + 1); }
};

ObjectName::Shared* ObjectName::GetShared() const noexcept {
    Shared* shared = nullptr;
    std::memcpy(&shared, bytes_, sizeof shared);
    return shared;
}

std::string_view ObjectName::SharedView() const noexcept {
    Shared* const shared = GetShared();
    return std::string_view(shared->GetText(), shared->length);
}

void ObjectName::Release() noexcept {
    if (length_ == SharedLength) {
        Shared* const shared = GetShared();
        if (shared->users.fetch_sub(1, std::memory_order_acq_rel) == 1) {
            ::operator delete(shared);
        }
        length_ = 0;
    }
}

ObjectName::ObjectName(const ObjectName& other) noexcept : ObjectName() {
    *this = other;
}

ObjectName& ObjectName::operator=(const ObjectName& other) noexcept {
    if (this != &other) {
        if (other.length_ == SharedLength) {
            other.GetShared()->users.fetch_add(1, std::memory_order_relaxed);
        }
        Release();
        std::memcpy(bytes_, other.bytes_, sizeof bytes_);
        length_ = other.length_;
    }
    return *this;
}

void ObjectName::Assign(std::string_view text) {
    if (text.size() <= InlineCapacity) {
        // The text may be part of the name that it replaces.
        char copy[InlineCapacity];
        text.copy(copy, text.size());
        Release();
        std::memcpy(bytes_, copy, text.size());
        length_ = static_cast<std::uint8_t>(text.size());
        return;
    }
    void* const memory = ::operator new(sizeof(Shared) + text.size());
    Shared* const shared = ::new (memory) Shared{{1}, text.size()};
    text.copy(shared->GetText(), text.size());
    Release();
    std::memcpy(bytes_, &shared, sizeof shared);
    length_ = SharedLength;
}

} // namespace Orn_Hdl
