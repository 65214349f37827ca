// Which ports, pins and net names use each bit of the top module.
#pragma once

#include "import/ImportedComponents.h"
#include "import/ImportedDesign.h"
#include "import/UnknownValues.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace Tool::Import {

enum class UseCount : std::uint8_t { None, Single, Many };

constexpr UseCount CountOneMore(UseCount count) noexcept {
    return count == UseCount::None ? UseCount::Single : UseCount::Many;
}

/// The uses of one bit, in one byte.
struct BitUse {
    bool inout : 1 = false;
    bool input : 1 = false;
    /// A port with any bit that several outputs share counts as `Many` for all its bits.
    UseCount outputs : 2 = UseCount::None;
    UseCount pins : 2 = UseCount::None;
    /// Whether the bit belongs to a net whose name no program generated.
    bool publicName : 1 = false;
    /// Whether the bit needs a signal.
    bool needed : 1 = false;
};

/// The uses of all bits.
class BitUses {
public:
    /// \param top must outlive the result, and so must `unknown`.
    /// \param portNames see `BitOwners::Choose`.
    /// \throws Error if ports contradict each other, or an x or z without a replacement is a
    /// driver.
    static BitUses Count(const Module& top, const ImportedComponents& components,
                         const UnknownValues& unknown, const std::vector<std::string>& portNames);

    const BitUse& Get(Bit bit) const { return uses_[bit]; }
    /// Whether a connection, given by its index, is left open: none of its bits has another pin, a
    /// port, or a name that no program generated.
    bool IsOpen(std::uint32_t connection) const { return open_[connection]; }

private:
    BitUses(const Module& top, const UnknownValues& unknown)
        : top_(top), unknown_(unknown), uses_(top.netBits), open_(top.connections.size()) {}

    template <class Visit> void ForEachNetBit(const Span& bits, Visit visit) {
        for (std::uint32_t i = 0; i < bits.count; ++i) {
            const Bit bit = top_.GetBit(bits, i);
            if (IsNet(bit)) {
                visit(uses_[bit]);
            }
        }
    }
    void CountPort(const ModulePort& port);
    void CheckConstant(const ModulePort& port, std::uint32_t i) const;
    void ShareWholePort(const ModulePort& port);
    void CountPins();
    void NeedBitsOf(const ModulePort& escapedPort);
    void CountNames();
    void CountConnections(const ImportedComponents& components);
    void CountConnection(const Cell& cell, std::uint32_t index, const ImportedPin& pin);
    bool IsUsedElsewhere(const Span& bits) const;

    const Module& top_;
    const UnknownValues& unknown_;
    std::vector<BitUse> uses_;
    std::vector<bool> open_;
};

} // namespace Tool::Import
