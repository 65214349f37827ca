// The signals of an imported design, and which of them owns each bit.
#pragma once

#include "import/BitUses.h"
#include "import/ImportedDesign.h"
#include "import/UniqueNames.h"
#include "import/Warnings.h"

#include <cstdint>
#include <limits>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

struct ImportedSignal {
    /// The wanted name until names are claimed.
    std::string name;
    /// The port in the file; null for an internal signal.
    const ModulePort* port = nullptr;
    /// The net in the file; null for a signal that the import adds.
    const Net* net = nullptr;
    BitRange range;
    std::uint32_t width = 1;
    /// The positions, from the right, of the outermost bits that are declared.
    std::uint32_t lowest = std::numeric_limits<std::uint32_t>::max();
    std::uint32_t highest = 0;

    bool IsScalar() const noexcept { return width == 1 && range.offset == 0; }
};

/// The signal that owns a bit, and the bit's position in it from the right.
struct BitOwner {
    static constexpr std::uint32_t NoSignal = 0xFFFFFFFF;

    std::uint32_t signal = NoSignal;
    std::uint32_t position = 0;
};

/// Assigns an owner to every used bit: a port, or the best of the nets that share it. An output
/// port that shares a bit with another port owns no bit, so that no bit gets a second driver and no
/// output port is read to drive another.
class BitOwners {
public:
    /// \param top must outlive the result.
    /// \param portNames the names that ports have already, in the order of the file; empty for a
    /// port without one. A port with an escaped name owns no bit, because the library takes such a
    /// name for no part of a concatenation.
    /// \param rules what names the nets may keep.
    static BitOwners Choose(const Module& top, const BitUses& uses,
                            const std::vector<std::string>& portNames, const NameRules& rules,
                            Warnings& warnings);

    /// The ports come first, in the order of the file.
    const std::vector<ImportedSignal>& GetSignals() const noexcept { return signals_; }
    /// The owner of a net bit.
    const BitOwner& Get(Bit bit) const { return owners_[bit]; }
    /// The signal that carries the constant `Zero`, `One` or `Unknown` inside compounds; null if
    /// none is needed.
    const ImportedSignal* GetConstant(Bit bit) const noexcept {
        const std::uint32_t index = constants_[bit - Zero];
        return index == BitOwner::NoSignal ? nullptr : &signals_[index];
    }

    /// Legal names are claimed before similar names are generated for others.
    void ClaimLegalNames(UniqueNames& names);
    void ClaimOtherNames(UniqueNames& names);
    /// Adds the signal that carries a constant unless there is one.
    void NeedConstant(Bit bit, UniqueNames& names);

private:
    /// A net that may become the owner of bits.
    struct Candidate {
        const Net* net = nullptr;
        bool illegal = false;
    };

    explicit BitOwners(const Module& top) : top_(top), owners_(top.netBits) {}

    void FindCandidates(const NameRules& rules);
    void AddPort(const ModulePort& port, const std::string& name, const BitUses& uses,
                 Warnings& warnings);
    void AddNets(const std::vector<Candidate>& candidates, const BitUses& uses);
    void AddSharedOutputs(const BitUses& uses);
    void AddNamelessBits(const BitUses& uses);
    void SetOwner(Bit bit, std::uint32_t index, std::uint32_t position);
    /// Adds a signal that owns the bits that need an owner and have none, if there are any.
    void AddSignal(ImportedSignal signal, const Span& bits, const BitUses& uses);
    std::uint32_t AddScalar(std::string_view name);

    const Module& top_;
    std::vector<BitOwner> owners_;
    std::vector<ImportedSignal> signals_;
    /// By signal: whether it has its final name.
    std::vector<bool> named_;
    /// The net of the same name as a port; null if there is none.
    std::unordered_map<std::string_view, const Net*> portNets_;
    std::vector<Candidate> publicNets_;
    std::vector<Candidate> hiddenNets_;
    std::uint32_t constants_[3] = {BitOwner::NoSignal, BitOwner::NoSignal, BitOwner::NoSignal};
};

} // namespace Tool::Import
