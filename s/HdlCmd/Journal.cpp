#include "HdlCmd/Journal.h"

#include "Containers/EightBytes.h"
#include "HdlCmd/Catalogue.h"
#include "Port/Pool.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl {

namespace {

/// The first byte of a line is the number of its phrase, or this one if the words of the phrase are
/// packed like the others.
constexpr unsigned char NoPhrase = 255;

/// How many bytes a number takes at most.
constexpr std::size_t MostNumberSize = 10;

/// Writes a number, seven bits a byte. \return the place behind it.
char* PutNumber(char* place, std::size_t number) noexcept {
    for (; number >= 0x80; number >>= 7) {
        *place++ = static_cast<char>(number | 0x80);
    }
    *place++ = static_cast<char>(number);
    return place;
}

std::size_t TakeNumber(const char*& place) noexcept {
    std::size_t number = 0;
    for (unsigned shift = 0;; shift += 7) {
        const auto byte = static_cast<unsigned char>(*place++);
        number |= static_cast<std::size_t>(byte & 0x7F) << shift;
        if (byte < 0x80) {
            return number;
        }
    }
}

} // namespace

std::string_view Journal::Pack(const StringArray& words, const PhraseTable::Match& phrase,
                               std::string& room) {
    const bool isOwn = phrase.own != nullptr && phrase.words == phrase.own->words;
    const int first = isOwn ? phrase.words : 0;
    std::size_t most = 1 + MostNumberSize;
    for (int i = first; i < words.GetSize(); ++i) {
        most += MostNumberSize + words.GetView(i).size();
    }
    if (room.size() < most) {
        room.resize(most);
    }
    char* place = room.data();
    *place = isOwn ? static_cast<char>(phrase.own - GetRegisteredCommands().data())
                   : static_cast<char>(NoPhrase);
    place = PutNumber(place + 1, static_cast<std::size_t>(words.GetSize() - first));
    for (int i = first; i < words.GetSize(); ++i) {
        const std::string_view word = words.GetView(i);
        place = PutNumber(place, word.size());
        place = EightBytes::Copy(word.data(), word.size(), place);
    }
    return std::string_view(room.data(), static_cast<std::size_t>(place - room.data()));
}

void Journal::Add(std::string_view packed) {
    // Small designs get small blocks.
    constexpr std::size_t LeastBlock = 256;
    constexpr std::size_t MostBlock = std::size_t(64) << 10;
    if (blocks_.empty() || blocks_.back().room - blocks_.back().size < packed.size()) {
        const std::size_t doubled = blocks_.empty() ? LeastBlock : 2 * blocks_.back().room;
        const std::size_t room = std::max(packed.size(), std::min(doubled, MostBlock));
        std::unique_ptr<char, Free> text(
            static_cast<char*>(Port::Pool::AllocatePacked(room, Port::Pool::Commands)));
        blocks_.push_back({std::move(text), 0, room});
    }
    Block& block = blocks_.back();
    block.size += packed.copy(block.text.get() + block.size, packed.size());
    ++count_;
}

bool Journal::Next(Place& place, StringArray& words) const {
    if (place.block < blocks_.size() && place.offset == blocks_[place.block].size) {
        place = {place.block + 1, 0};
    }
    if (place.block >= blocks_.size()) {
        return false;
    }
    const char* const begin = blocks_[place.block].text.get();
    const char* next = begin + place.offset;
    words.Empty();
    const auto phrase = static_cast<unsigned char>(*next++);
    if (phrase != NoPhrase) {
        words.Parse(GetRegisteredCommands()[phrase].entry.info.phrase, " ", true, nullptr);
    }
    for (std::size_t count = TakeNumber(next); count > 0; --count) {
        const std::size_t length = TakeNumber(next);
        words.Add(std::string_view(next, length));
        next += length;
    }
    place.offset = static_cast<std::size_t>(next - begin);
    return true;
}

} // namespace Orn_Hdl
