/// \file
/// `ObjectName`, the compact name that every object of a design holds.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace Orn_Hdl {

struct ObjectDetails;

/// A name in 16 bytes. Up to 14 characters stand in the object itself; a longer name stands in a
/// block that copies share, so that the pins of a thousand instances hold a long pin name once.
/// The sixteenth byte is left to the owner, whose flags would otherwise cost eight.
///
/// It also leads to the parts of the owner that few objects have, so that the millions without them
/// pay nothing: an object that has details keeps its name there.
class ORN_HDL_API ObjectName {
public:
    ObjectName() noexcept : bytes_(), length_(0) {}
    /// As `Assign`.
    explicit ObjectName(std::string_view text) : ObjectName() { Assign(text); }
    /// \{
    /// Copies the name; the details and the owner's byte stay with their owner.
    ObjectName(const ObjectName& other) noexcept;
    ObjectName& operator=(const ObjectName& other) noexcept;
    /// \}
    ~ObjectName() { Release(); }

    /// Stores a text.
    void Assign(std::string_view text);

    /// The name, valid until it changes or the details are made.
    std::string_view GetView() const noexcept {
        return length_ <= InlineCapacity ? std::string_view(bytes_, length_) : LongView();
    }

    /// The owner's details; null when it has none.
    ObjectDetails* GetDetails() const noexcept {
        return length_ == DetailedLength ? static_cast<ObjectDetails*>(GetPointer()) : nullptr;
    }
    /// The same, made when there are none.
    ObjectDetails& MakeDetails();

    /// The owner's byte; copying a name does not copy it.
    std::uint8_t GetOwnerByte() const noexcept { return ownerByte_; }
    /// Sets the owner's byte.
    void SetOwnerByte(std::uint8_t value) noexcept { ownerByte_ = value; }

private:
    struct Shared;
    static constexpr std::size_t InlineCapacity = 14;
    /// What `length_` says of a name that stands elsewhere.
    static constexpr std::uint8_t SharedLength = 255;
    static constexpr std::uint8_t DetailedLength = 254;

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

    alignas(8) char bytes_[InlineCapacity];
    std::uint8_t length_;
    std::uint8_t ownerByte_ = 0;
};

static_assert(sizeof(ObjectName) == 16, "every object of a design holds one");

} // namespace Orn_Hdl
