// The signals of an imported design: which bit belongs to which of them, and how bits are referred
// to.
#pragma once

#include "ImportComponents.h"
#include "ImportContext.h"
#include "ImportDesign.h"
#include "ImportNames.h"
#include "ImportSink.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// Gives every bit that is used one home: a port, or the best of the nets that share it. Output
/// ports that share a bit with another port become aliases, so that no bit gets a second driver,
/// and no output port is read for the sake of another.
class Nets {
public:
    /// \throws Error when ports contradict each other, or something is driven by an x or z that
    ///         stands for nothing.
    Nets(Context& context, const Components& components);

    std::size_t GetCount() const noexcept { return signals_.size(); }

    /// Names that can stay are claimed before others are made that resemble theirs.
    void ClaimLegalNames(NameTable& names);
    void ClaimOtherNames(NameTable& names);
    /// Takes care that `GetReference` can name the constants among the bits.
    void NeedConstants(const Span& bits, NameTable& names);

    /// Whether a connection, given by its index, hangs on nothing: none of its bits has another
    /// pin, a port, or a name that someone gave it.
    bool IsOpen(std::uint32_t connection) const { return open_[connection]; }
    /// Whether a connection consists of constants.
    bool IsConstant(const Span& bits) const;
    /// The digits of a connection that is constant, leftmost first.
    std::string GetDigits(const Span& bits) const;
    /// The name of all bits together: a signal, a part of one, or a compound. The word "-" when a
    /// bit is of no use to anything.
    std::string GetReference(const Span& bits) const;

    void Emit(Sink& sink) const;

    /// Visits the name, with its range, of each signal that was a net of the file, and that net.
    template <class Visit> void ForEachNet(Visit visit) const {
        for (const Signal& signal : signals_) {
            if (signal.net != nullptr) {
                visit(GetFullName(signal), *signal.net);
            }
        }
    }
    /// Visits each port of the file with its name.
    template <class Visit> void ForEachPort(Visit visit) const {
        for (const Signal& signal : signals_) {
            if (signal.port != nullptr) {
                visit(signal.name, *signal.port);
            }
        }
    }
    /// For each net of the file, by its index: the name, without a range, of the signal that it
    /// became; empty for a net that shares all its bits with others.
    std::vector<std::string_view> GetNetNames() const;

private:
    static constexpr std::uint32_t NoIndex = 0xFFFFFFFF;

    struct Signal {
        /// Until the names are claimed, the name wanted.
        std::string name;
        bool named = false;
        const ModulePort* port = nullptr;
        const Net* net = nullptr;
        Range range;
        std::uint32_t width = 1;
        /// The part that is declared.
        std::uint32_t lowest = NoIndex;
        std::uint32_t highest = 0;

        bool IsScalar() const noexcept { return width == 1 && range.offset == 0; }
    };
    /// Where a bit is to be found.
    struct Home {
        std::uint32_t signal = NoIndex;
        std::uint32_t position = 0;
    };
    /// What ports, pins and names say of a bit.
    struct Use {
        bool inout : 1 = false;
        bool input : 1 = false;
        bool output : 1 = false;
        bool outputs : 1 = false;
        bool pin : 1 = false;
        bool pins : 1 = false;
        bool publicName : 1 = false;
        bool needed : 1 = false;
    };
    /// A net that may become the home of bits, and how well it would suit.
    struct Candidate {
        const Net* net = nullptr;
        bool illegal = false;
    };

    template <class Visit> void ForEachNetBit(const Span& bits, Visit visit) {
        for (std::uint32_t i = 0; i < bits.count; ++i) {
            const Bit bit = context_.GetBit(bits, i);
            if (IsNet(bit)) {
                visit(uses_[bit]);
            }
        }
    }
    void CountPort(const ModulePort& port);
    /// An output port that shares a bit with another one becomes an alias as a whole.
    void ShareWholePort(const ModulePort& port);
    void CountPins();
    void NeedPins(const Components& components);
    bool HangsOnNothing(const Span& bits) const;
    void FindCandidates();
    void AddPorts();
    void AddNets(const std::vector<Candidate>& candidates);
    void AddSharedOutputs();
    void AddNamelessBits();
    bool IsHomeOf(const ModulePort& port, const Use& use) const noexcept;
    void Settle(std::uint32_t index, Bit bit, std::uint32_t position);
    void AddSignal(Signal signal, const Span& bits);
    std::uint32_t AddScalar(std::string_view name);

    Bit GetBit(const Span& bits, std::uint32_t i) const {
        return context_.Settle(context_.GetBit(bits, i));
    }
    /// The bits from the position `left` to the position `right` of a signal.
    static std::string GetText(const Signal& signal, std::uint32_t left, std::uint32_t right);
    static std::string GetFullName(const Signal& signal) {
        return GetText(signal, signal.highest, signal.lowest);
    }
    void EmitPortBits(Sink& sink, const Signal& signal, std::uint32_t index) const;
    void EmitConstant(Sink& sink, const Signal& signal, std::uint32_t& left) const;
    void EmitAlias(Sink& sink, const Signal& signal, std::uint32_t& left) const;

    Context& context_;
    const Module& top_;
    std::vector<Use> uses_;
    std::vector<Home> homes_;
    std::vector<bool> open_;
    std::unordered_map<std::string_view, const Net*> portNets_;
    std::vector<Candidate> publicNets_;
    std::vector<Candidate> hiddenNets_;
    std::vector<Signal> signals_;
    /// The signals that carry the constants 0 and 1.
    std::uint32_t constants_[2] = {NoIndex, NoIndex};
};

} // namespace Tool::Import
