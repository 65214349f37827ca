/// \file
/// `TextSet`: a set of texts that somebody else stores.
#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <stdexcept>
#include <string_view>
#include <vector>

namespace Port {

/// A set of texts, which the caller stores for as long as the set is used. It takes 16 bytes for
/// each text and a third more that are free, in one block, so a look-up reads one line of the
/// processor's cache besides the text.
/// \tparam Hash gives equal texts the same number, of which the upper 32 bits are used.
/// \tparam Equal whether two texts are the same.
template <class Hash, class Equal> class TextSet {
public:
    /// The number of texts.
    std::size_t GetSize() const noexcept { return count_; }

    /// Makes room for that many texts in all.
    void Reserve(std::size_t count) {
        std::size_t size = slots_.size() < SmallestSize ? SmallestSize : slots_.size();
        while (count * 4 > size * 3) {
            size += size / 2;
        }
        if (size > slots_.size()) {
            Grow(size);
        }
    }

    /// The text of the set that equals a text; null if there is none. It is valid until a text is
    /// added.
    const char* Find(std::string_view text) const noexcept {
        return slots_.empty() ? nullptr : slots_[Probe(text, Shorten(Hash()(text)))].text;
    }
    /// The text of the set that equals a text; empty if there is none.
    std::string_view Get(std::string_view text) const noexcept {
        return slots_.empty() ? std::string_view()
                              : slots_[Probe(text, Shorten(Hash()(text)))].GetView();
    }

    /// Adds a text unless the set has it.
    /// \param keep called with a text that is new; it returns the stored copy, which is not null.
    /// \return whether it was added.
    /// \throws std::length_error if the text has 4 GB or more; std::bad_alloc, nothing changed, if
    /// allocation fails.
    template <class Keep> bool Add(std::string_view text, const Keep& keep) {
        if (text.size() > std::numeric_limits<std::uint32_t>::max()) {
            throw std::length_error("a text is too long");
        }
        Reserve(count_ + 1);
        const std::uint32_t hash = Shorten(Hash()(text));
        Slot& slot = slots_[Probe(text, hash)];
        if (slot.text != nullptr) {
            return false;
        }
        slot.text = keep(text).data();
        slot.size = static_cast<std::uint32_t>(text.size());
        slot.hash = hash;
        ++count_;
        return true;
    }

private:
    static constexpr std::size_t SmallestSize = 16;

    /// A text, or a free slot.
    struct Slot {
        const char* text = nullptr;
        std::uint32_t size = 0;
        std::uint32_t hash = 0;

        std::string_view GetView() const noexcept { return std::string_view(text, size); }
    };

    static std::uint32_t Shorten(std::uint64_t hash) noexcept {
        return static_cast<std::uint32_t>(hash >> 32U);
    }
    std::size_t Home(std::uint32_t hash) const noexcept {
        return static_cast<std::size_t>((std::uint64_t(hash) * slots_.size()) >> 32U);
    }
    std::size_t Next(std::size_t place) const noexcept {
        return place + 1 == slots_.size() ? 0 : place + 1;
    }

    /// The slot of a text, or the free slot that it would get.
    std::size_t Probe(std::string_view text, std::uint32_t hash) const noexcept {
        std::size_t place = Home(hash);
        while (slots_[place].text != nullptr &&
               (slots_[place].hash != hash || !Equal()(slots_[place].GetView(), text))) {
            place = Next(place);
        }
        return place;
    }

    void Grow(std::size_t size) {
        std::vector<Slot> former(size);
        former.swap(slots_);
        for (const Slot& slot : former) {
            if (slot.text != nullptr) {
                std::size_t place = Home(slot.hash);
                while (slots_[place].text != nullptr) {
                    place = Next(place);
                }
                slots_[place] = slot;
            }
        }
    }

    std::vector<Slot> slots_;
    std::size_t count_ = 0;
};

} // namespace Port
