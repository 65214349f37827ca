// Makes the objects of a netlist by the names that they have in a file.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Readers.h"
#include "Readers/Heads.h"
#include "Readers/NetlistSink.h"
#include "Readers/Range.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl::Readers {

/// How names of a language are compared, and which of them are special.
struct NameRules {
    /// Whether names that differ in letter case alone are the same. If so, names in backslashes,
    /// which they begin and end with, are compared exactly.
    bool ignoresCase = false;
    /// Whether "$" can stand in a name without an escape.
    bool allowsDollar = true;
    /// Tells which names need an escape.
    bool (*isReserved)(std::string_view name) = nullptr;
    /// Tells which simple names stay; empty when all do.
    std::function<bool(std::string_view name)> keeps = {};
};

/// A net, a part of one, or constant bits.
struct Piece {
    /// Null for a constant.
    Signal* signal = nullptr;
    std::string bits;
};

/// A name that the netlist cannot have, because of its characters or of another name that differs
/// in letter case alone, is replaced, and found by the one of the file.
class NetlistMaker {
public:
    /// \param netlist an empty one, not owned.
    /// \param sink not owned. When there is one, it gets what is read; the netlist only gets
    ///        components without pins, and the parts of nets that the sink does not know.
    NetlistMaker(Netlist& netlist, ReaderNames names, const NameRules& rules,
                 NetlistSink* sink = nullptr);
    NetlistMaker(const NetlistMaker&) = delete;
    NetlistMaker& operator=(const NetlistMaker&) = delete;

    /// Whether the writers leave a pin open that is connected to a signal of this name.
    static bool IsOpenWord(std::string_view name) noexcept;

    Netlist& GetNetlist() noexcept { return netlist_; }
    /// Who gets what is read; null when the netlist does.
    NetlistSink* GetSink() const noexcept { return sink_; }
    /// Sets whether x becomes a don't care when there is no sink; otherwise it is an error.
    void KeepDontCares(bool keep) noexcept { keepsDontCares_ = keep; }
    /// What becomes of x and z. A sink judges them by itself.
    Unknowns GetUnknowns() const noexcept {
        return sink_ != nullptr  ? Unknowns::Keep
               : keepsDontCares_ ? Unknowns::DontCare
                                 : Unknowns::Refuse;
    }
    /// Sets the place of what is made next, for the sink.
    void SetPlace(const Place& place) noexcept { place_ = place; }
    const Place& GetPlace() const noexcept { return place_; }
    /// The owner that a holder is, for the sink.
    Owner GetOwner(const AttributeHolder& holder) const noexcept;
    void SetName(const std::string& name);
    /// Makes a component with the ports of a module, unless there is one.
    /// \return an empty text, or why no component can be made.
    std::string MakeComponent(ModuleHead& head);
    /// Declares a signal or a bus. \return null when the name is declared already.
    Signal* DeclareSignal(const std::string& name, const std::optional<Range>& range);
    /// Declares a port. \return null when the name is declared already.
    Signal* DeclarePort(const PortHead& port);
    /// Adds an instance of a module that is a component. With a sink, it lives until the next one
    /// is added. \return null when the name is declared already.
    Instance* AddInstance(const std::string& name, const ModuleHead& head);

    /// The signal or bus of that name in the file; null when there is none.
    Signal* FindSignal(const std::string& name) const;
    /// The instance of that name in the file; null when there is none.
    Instance* FindInstance(const std::string& name) const;
    /// The range of a bus.
    static Range GetRange(const Bus& bus);

    /// A bit of a bus, which has it.
    Signal* GetBit(Bus& bus, int index);
    /// A part of a bus, which has it and runs in its direction; the bus itself when it is all of
    /// it.
    Signal* GetSlice(Bus& bus, const Range& range);
    /// The concatenation of two or more signals.
    Signal* GetConcatenation(const std::vector<Signal*>& members);
    /// The signal that pieces are from left to right; what of it is constant comes from nets that
    /// carry the constants.
    Signal* GetSignal(const std::vector<Piece>& pieces);
    /// The members of that signal, for a sink; valid until the next call.
    const Members& GetMembers(const std::vector<Piece>& pieces);
    /// A net of one bit that carries a constant: 0, 1, or "-" for a don't care. With a sink, any
    /// other bit is 0.
    Signal* GetConstantNet(char bit);
    /// Connects a pin to a signal of its own that carries a constant.
    void ConnectConstant(const Instance& instance, Pin& pin, const std::string& constant);

    std::vector<ReaderRenaming>& GetRenamings() noexcept { return renamings_; }

private:
    /// The renamings by the name in the file.
    struct RenamingHash {
        using is_transparent = void; // NOLINT(readability-identifier-naming)
        const std::vector<ReaderRenaming>* renamings;
        bool ignoresCase;
        std::size_t operator()(std::string_view name) const noexcept;
        std::size_t operator()(std::uint32_t index) const noexcept {
            return (*this)((*renamings)[index].name);
        }
    };
    struct RenamingEqual {
        using is_transparent = void; // NOLINT(readability-identifier-naming)
        const std::vector<ReaderRenaming>* renamings;
        bool ignoresCase;
        bool operator()(std::uint32_t a, std::uint32_t b) const noexcept { return a == b; }
        bool operator()(std::string_view name, std::uint32_t index) const noexcept {
            return IsSameName((*renamings)[index].name, name, ignoresCase);
        }
        bool operator()(std::uint32_t index, std::string_view name) const noexcept {
            return (*this)(name, index);
        }
    };

    Signal* FindPart(const std::string& name) const;
    std::string MakeStandIn(ModuleHead& head);
    const std::string& Plain(const std::string& name) const;
    bool MayBeEscaped(std::string_view name) const noexcept;
    bool CanKeep(std::string_view name, bool isBus, bool isEscaped = true) const;
    bool IsTaken(const std::string& name) const;
    bool IsDeclared(const std::string& name, bool isTaken) const;
    const std::string* FindRenamed(std::string_view name) const;
    std::string MakeUnique(const std::string& name);
    /// The name in the netlist for an object that is about to be declared.
    const std::string& MakeName(const std::string& name, bool isBus, bool isTaken,
                                ReaderRenaming::Kind kind);
    std::string MakePinName(const PortHead& port, const ModuleHead& head,
                            const Component& component) const;
    void AddRenaming(const std::string& name, const std::string& newName,
                     ReaderRenaming::Kind kind);
    Signal* FindByNewName(const std::string& name, bool isExact) const;
    /// Whether an object that was not renamed can have the name.
    bool CanBeFound(std::string_view plain, bool isBasic) const;
    bool IsRenamedTo(std::string_view newName) const;
    std::string MakePins(const ModuleHead& head, Component& component);

    Netlist& netlist_;
    const ReaderNames names_;
    const NameRules rules_;
    std::vector<ReaderRenaming> renamings_;
    std::unordered_set<std::uint32_t, RenamingHash, RenamingEqual> renamed_;
    /// The new names of the objects that were renamed, in small letters.
    std::unordered_set<std::string> newNames_;
    std::unordered_map<std::string, unsigned> lastSuffixes_;
    /// The signals that the file does not have.
    std::unordered_set<const Signal*> made_;
    /// Of 0, 1 and don't cares.
    Signal* constantNets_[3] = {nullptr, nullptr, nullptr};
    NetlistSink* const sink_;
    bool keepsDontCares_ = false;
    Place place_;
    /// \{
    /// The present instance, when there is a sink, and its name in the file.
    std::unique_ptr<Instance> instance_;
    std::string instanceName_;
    /// \}
    /// Room for names, kept so that most objects cost no allocation.
    std::string newName_;
    mutable std::string plain_;
    std::string text_;
    Members members_;
};

} // namespace Orn_Hdl::Readers
