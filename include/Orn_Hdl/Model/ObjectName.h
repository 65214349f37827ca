/// \file
/// `ObjectName`, the compact name that every object of a design holds.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

/// A name in 16 bytes. Up to 14 characters stand in the object itself; a longer name stands in a
/// block that copies share, so that the pins of a thousand instances hold a long pin name once.
/// The sixteenth byte is left to the owner, whose flags would otherwise cost eight.
class ORN_HDL_API ObjectName {
public:
    ObjectName() noexcept : bytes_(), length_(0) {}
    /// As `Assign`.
    explicit ObjectName(std::string_view text) : ObjectName() { Assign(text); }
    ObjectName(const ObjectName& other) noexcept;
    ObjectName& operator=(const ObjectName& other) noexcept;
    ~ObjectName() { Release(); }

    /// Stores a text.
    void Assign(std::string_view text);

    /// The name, valid until it changes.
    std::string_view GetView() const noexcept {
        return length_ <= InlineCapacity ? std::string_view(bytes_, length_) : SharedView();
    }

    /// The owner's byte; copying a name does not copy it.
    std::uint8_t GetOwnerByte() const noexcept { return ownerByte_; }
    /// Sets the owner's byte.
    void SetOwnerByte(std::uint8_t value) noexcept { ownerByte_ = value; }

private:
    struct Shared;
    static constexpr std::size_t InlineCapacity = 14;
    static constexpr std::uint8_t SharedLength = 255;

    std::string_view SharedView() const noexcept;
    Shared* GetShared() const noexcept;
    void Release() noexcept;

    alignas(8) char bytes_[InlineCapacity];
    std::uint8_t length_;
    std::uint8_t ownerByte_ = 0;
};

static_assert(sizeof(ObjectName) == 16, "every object of a design holds one");

} // namespace Orn_Hdl
