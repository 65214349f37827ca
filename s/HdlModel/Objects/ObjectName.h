// The compact name that every object of a design holds.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace Orn_Hdl {

struct ObjectDetails;

/// A name in 15 bytes of any alignment. Up to 14 characters are stored in the object itself. A
/// longer name is stored in a block that copies share, so that the pins of a thousand instances
/// hold a long pin name once.
///
/// An object with details keeps its name there, and a pointer to the details in these 15 bytes, so
/// that details cost an object without them no memory.
class ObjectName {
public:
    ObjectName() noexcept : bytes_(), length_(0) {}
    /// Copies the name; the details stay with their owner.
    ObjectName(const ObjectName& other) noexcept : ObjectName() { *this = other; }
    /// Copies the name; the details stay with their owner.
    // A name that is assigned to itself moves to where it is.
    // NOLINTNEXTLINE(bugprone-unhandled-self-assignment)
    ObjectName& operator=(const ObjectName& other) noexcept {
        if (length_ <= InlineCapacity && other.length_ <= InlineCapacity) {
            std::memmove(bytes_, other.bytes_, sizeof bytes_);
            length_ = other.length_;
        } else {
            CopyLong(other);
        }
        return *this;
    }
    ~ObjectName() {
        if (length_ > InlineCapacity) {
            Release();
        }
    }

    /// Swaps names and details.
    void Swap(ObjectName& other) noexcept;
    /// Swaps the names and leaves the details where they are.
    void SwapText(ObjectName& other) noexcept { GetPlain().Swap(other.GetPlain()); }
    /// Stores a text. If allocation fails, the name stays as it was.
    void Assign(std::string_view text);

    /// The name, valid until it changes or the details are made.
    std::string_view GetView() const noexcept {
        return length_ <= InlineCapacity ? std::string_view(bytes_, length_) : LongView();
    }

    /// The details of the object that has the name; null if there are none.
    ObjectDetails* GetDetails() const noexcept {
        return length_ == DetailedLength ? static_cast<ObjectDetails*>(GetPointer()) : nullptr;
    }
    /// The details of the object that has the name; created if there are none.
    ObjectDetails& MakeDetails();

private:
    struct Shared;
    static constexpr std::size_t InlineCapacity = 14;
    /// The value of `length_` if `bytes_` hold a pointer to a shared name.
    static constexpr std::uint8_t SharedLength = 255;
    /// The value of `length_` if `bytes_` hold a pointer to the details.
    static constexpr std::uint8_t DetailedLength = 254;

    void CopyLong(const ObjectName& other) noexcept;
    std::string_view LongView() const noexcept;
    void* GetPointer() const noexcept {
        void* pointer = nullptr;
        std::memcpy(&pointer, bytes_, sizeof pointer);
        return pointer;
    }
    void SetPointer(void* pointer, std::uint8_t length) noexcept {
        std::memcpy(bytes_, &pointer, sizeof pointer);
        length_ = length;
    }
    Shared* GetShared() const noexcept;
    const ObjectName& GetPlain() const noexcept;
    ObjectName& GetPlain() noexcept;
    void Release() noexcept;

    char bytes_[InlineCapacity];
    std::uint8_t length_;
};

} // namespace Orn_Hdl
