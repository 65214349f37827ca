// The common part of the writers of all languages.
#pragma once

#include "HdlModel/Netlist/SignalsAhead.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Port/Prefetch.h"
#include "Writers/Generics.h"
#include "Writers/ItemWriter.h"
#include "Writers/SignalLists.h"
#include "Writers/Text.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <type_traits>
#include <vector>

namespace Orn_Hdl::Writers {

/// Where to begin a walk over instances.
class InstanceStarts {
public:
    using Cursor = Iterator<Instance*>::Cursor;

    explicit InstanceStarts(const Netlist& netlist);

    std::size_t GetCount() const noexcept { return count_; }
    /// The place of an instance.
    Cursor Find(std::size_t instance) const noexcept;

private:
    std::size_t distance_;
    /// The places of some instances, at equal distances.
    std::vector<Cursor> places_;
    std::size_t count_ = 0;
};

/// Writes instances by a writer that `MakeWriter` makes for a stream.
template <class MakeWriter>
class alignas(Port::CacheLine) InstanceWriter final : public ItemWriter {
public:
    InstanceWriter(const InstanceStarts& starts, const MakeWriter& makeWriter, OutStream& out)
        : starts_(starts), write_(makeWriter(out)) {}

    void GoTo(std::size_t item) override {
        constexpr int Lead = 4;
        present_ = starts_.Find(item);
        ahead_.emplace(present_, Lead);
    }
    void WriteNext() override {
        ahead_->Step();
        write_(**present_);
        ++present_;
    }

private:
    const InstanceStarts& starts_;
    std::invoke_result_t<const MakeWriter&, OutStream&> write_;
    InstanceStarts::Cursor present_;
    std::optional<SignalsAhead> ahead_;
};

/// Writes signals by a writer that `MakeWriter` makes for a stream.
template <class MakeWriter> class alignas(Port::CacheLine) SignalWriter final : public ItemWriter {
public:
    SignalWriter(const std::vector<Signal*>& signals, const MakeWriter& makeWriter, OutStream& out)
        : signals_(signals), write_(makeWriter(out)) {}

    void GoTo(std::size_t item) override { present_ = item; }
    void WriteNext() override { write_(*signals_[present_++]); }

private:
    const std::vector<Signal*>& signals_;
    std::invoke_result_t<const MakeWriter&, OutStream&> write_;
    std::size_t present_ = 0;
};

/// One write of one netlist: first the netlist is prepared, then it is only read. The writer of
/// each language derives from it.
class NetlistPass {
public:
    NetlistPass(const NetlistPass&) = delete;
    NetlistPass& operator=(const NetlistPass&) = delete;

protected:
    NetlistPass(Language language, OutStream& out, Netlist& netlist,
                const HdlOptions& options) noexcept
        : out_(out), netlist_(netlist), options_(options), language_(language) {}
    /// Writes parts of what `whole` writes to a stream of their own.
    NetlistPass(OutStream& out, const NetlistPass& whole) noexcept
        : out_(out), netlist_(whole.netlist_), options_(whole.options_), language_(whole.language_),
          passesInit_(whole.passesInit_) {}
    ~NetlistPass() = default;

    /// Sorts the netlist and makes the dummy signals that it needs.
    void Prepare();
    /// Writes the header, if the options ask for it, and the netlist's comment.
    void WriteOpening();
    /// Calls `write` between two comments that hide its output from synthesis.
    template <class Write> void WriteHidden(const Write& write);
    /// Calls `writeConstant` for each signal that has a constant, then `writeAlias` for each signal
    /// and each of its aliases.
    template <class WriteConstant, class WriteAlias>
    void WriteAssignments(const SignalLists& signals, const WriteConstant& writeConstant,
                          const WriteAlias& writeAlias) const;
    /// Writes the instances. `makeWriter(out)` makes what writes an instance to a stream by the
    /// call `(instance)`. Several of them may be in use at once.
    template <class MakeWriter> void WriteEachInstance(const MakeWriter& makeWriter);
    /// Writes signals, each by the call `(signal)` of what `makeWriter(out)` makes, in the way in
    /// which instances are written.
    template <class MakeWriter>
    void WriteEachSignal(const std::vector<Signal*>& signals, const MakeWriter& makeWriter);
    /// The attribute INIT of an instance whose value is the module's own INIT; null if there is
    /// none, or if this netlist does not pass it on.
    Attribute* FindPassedInit(const GenericAttrs& attributes) const;

    OutStream& out_;
    Netlist& netlist_;
    const HdlOptions& options_;

private:
    void Sort();

    const Language language_;
    bool passesInit_ = false;
};

template <class Write> void NetlistPass::WriteHidden(const Write& write) {
    Writers::WriteHidden(out_, language_, write);
}

template <class WriteConstant, class WriteAlias>
void NetlistPass::WriteAssignments(const SignalLists& signals, const WriteConstant& writeConstant,
                                   const WriteAlias& writeAlias) const {
    for (Signal* signal : signals.constants) {
        writeConstant(*signal);
    }
    for (Signal* signal : signals.aliased) {
        for (Signal* alias : signal->GetSignalIterator()) {
            if (IsWritable(language_, alias->GetNameView())) {
                writeAlias(*signal, *alias);
            }
        }
    }
}

template <class MakeWriter> void NetlistPass::WriteEachInstance(const MakeWriter& makeWriter) {
    const InstanceStarts starts(netlist_);
    WriteItems(out_, starts.GetCount(), options_.threads, [&](OutStream& out) {
        return std::make_unique<InstanceWriter<MakeWriter>>(starts, makeWriter, out);
    });
}

template <class MakeWriter>
void NetlistPass::WriteEachSignal(const std::vector<Signal*>& signals,
                                  const MakeWriter& makeWriter) {
    WriteItems(out_, signals.size(), options_.threads, [&](OutStream& out) {
        return std::make_unique<SignalWriter<MakeWriter>>(signals, makeWriter, out);
    });
}

} // namespace Orn_Hdl::Writers
