#include "HdlCmd/Arguments.h"

#include "Port/Pool.h"

#include <algorithm>
#include <cstring>

namespace Orn_Hdl {

namespace {

/// Where the pointer to a block stands in the room. It is aligned there, so that leak checkers find
/// it.
constexpr std::size_t BlockOffset = 4;
constexpr std::size_t LeastRoom = BlockOffset + sizeof(char*);
constexpr std::size_t MostRoom = 4096;

} // namespace

std::size_t Arguments::RoomFor(const StringArray& tokens, std::size_t phraseLength) noexcept {
    std::size_t length = 0;
    for (int i = 0; i < tokens.GetSize(); ++i) {
        length += tokens.GetView(i).size() + 1;
    }
    const std::size_t behindPhrase = length - std::min(length, phraseLength + 1);
    return std::clamp(behindPhrase, LeastRoom, MostRoom);
}

Arguments::Arguments(std::size_t room) noexcept : room_(static_cast<std::uint16_t>(room)) {}

void Arguments::Release() noexcept {
    if ((count_ & OwnBlock) != 0) {
        Port::Pool::Free(const_cast<char*>(GetTexts()));
    }
    count_ = 0;
}

const char* Arguments::GetTexts() const noexcept {
    if ((count_ & OwnBlock) == 0) {
        return GetRoom();
    }
    const char* block = nullptr;
    std::memcpy(&block, GetRoom() + BlockOffset, sizeof block);
    return block;
}

char* Arguments::MakePlace(std::size_t size) {
    Release();
    if (size <= room_) {
        return GetRoom();
    }
    char* const block = static_cast<char*>(Port::Pool::AllocatePacked(size, Port::Pool::Commands));
    std::memcpy(GetRoom() + BlockOffset, &block, sizeof block);
    count_ = OwnBlock;
    return block;
}

void Arguments::Set(std::initializer_list<std::string_view> texts) {
    std::size_t size = 0;
    for (const std::string_view text : texts) {
        size += text.size() + 1;
    }
    char* place = MakePlace(size);
    for (const std::string_view text : texts) {
        // `Get` counts NULs, so a text must not contain one.
        place += text.copy(place, text.find('\0'));
        *place++ = '\0';
    }
    count_ = static_cast<std::uint8_t>(count_ | texts.size());
    flags_ = 0;
}

const char* Arguments::Get(int index) const noexcept {
    if (index < 0 || index >= (count_ & ~OwnBlock)) {
        return "";
    }
    const char* text = GetTexts();
    for (; index > 0; --index) {
        text += std::strlen(text) + 1;
    }
    return text;
}

} // namespace Orn_Hdl
