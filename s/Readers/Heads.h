// What is known of modules before one of them is read: their ports and parameters.
#pragma once

#include "Orn_Hdl/Model/Pins.h"
#include "Readers/Place.h"
#include "Readers/Range.h"
#include "Readers/Value.h"

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class Component;
class Netlist;

namespace Readers {

struct PortHead {
    std::string name;
    /// A value of `Polarity`; `Polarity::Invalid` until the direction is known.
    int direction = Polarity::Invalid;
    /// Nothing for a port of one bit.
    std::optional<Range> range;
    /// Whether the range is known. That of a port of an undeclared module may not be.
    bool hasWidth = true;
    /// Whether the port has a value of its own when nothing is connected to it.
    bool hasDefault = false;
    /// Why no model can have the port; empty when one can.
    std::string problem;
    /// The parameters on which the range depends.
    std::vector<std::string> parameters;
    /// Where it is declared.
    Place place;

    std::uint64_t GetWidth() const noexcept { return range ? range->GetWidth() : 1; }
};

struct ParameterHead {
    std::string name;
    bool isLocal = false;
    /// Whether it is hidden from synthesis.
    bool isHidden = false;
    /// The name of its type, where the language has one; empty when it is not known.
    std::string typeName;
    /// The default value; nothing when it is no literal.
    std::optional<Value> value;
    /// The default value as a number, when it is a small integer.
    std::optional<std::int64_t> number;
};

/// Whether two names of a file are the same.
/// \param ignoresCase whether letter case makes no difference, but in names in backslashes.
bool IsSameName(std::string_view a, std::string_view b, bool ignoresCase) noexcept;
/// Whether a name begins and ends with a backslash.
bool IsExtended(std::string_view name) noexcept;

struct ModuleHead {
    /// Where a module is instantiated for the first time.
    struct Use {
        std::string name;
        Place place;
    };

    std::string name;
    Place place;
    /// Whether names that differ in letter case alone are the same.
    bool ignoresCase = false;
    /// The file that was opened to read it, which may include the one where it stands.
    std::uint32_t source = 0;
    /// A user-defined primitive has no named ports.
    bool isPrimitive = false;
    /// Whether the module may be the one to read when none is named.
    bool canBeTop = false;
    /// Whether a file declares the module. Otherwise its ports are those that connections name.
    bool isDeclared = true;
    /// Whether all parameters are known.
    bool hasParameters = true;
    std::vector<PortHead> ports;
    std::vector<ParameterHead> parameters;
    std::vector<Use> uses;
    /// The component that was made of the module; null as long as there is none.
    Component* component = nullptr;

    PortHead* FindPort(std::string_view portName) noexcept;
    /// The index of a port; `hint` is tried first. The number of ports if there is none.
    std::size_t FindPort(std::string_view portName, std::size_t hint) const noexcept;
    const ParameterHead* FindParameter(std::string_view parameterName) const noexcept;
};

/// The heads of all modules, by name.
class Heads {
public:
    explicit Heads(bool ignoresCase = false) : ignoresCase_(ignoresCase), byName_({ignoresCase}) {}

    /// The head of that name; null if there is none.
    ModuleHead* Find(std::string_view name) const;
    /// Adds a head. \return null if there is one of that name.
    ModuleHead* Add(std::string_view name, const Place& place);
    /// Adds the components of a netlist whose names are new.
    void Add(const Netlist& netlist) {
        Add(netlist, [](std::string_view name) { return name; });
    }
    /// Adds the components of a netlist.
    /// \param toFile gives the name in the file of one that a component or a pin has.
    void Add(const Netlist& netlist, std::string_view (*toFile)(std::string_view name));
    const std::vector<std::unique_ptr<ModuleHead>>& GetAll() const noexcept { return heads_; }

    /// Remembers the module in which a file ends, and where the module begins.
    void SetUnfinished(const ModuleHead& head, const Place& begin) {
        unfinished_ = &head;
        unfinishedPlace_ = begin;
    }
    const ModuleHead* GetUnfinished() const noexcept { return unfinished_; }
    const Place& GetUnfinishedPlace() const noexcept { return unfinishedPlace_; }

private:
    struct NameOrder {
        bool ignoresCase;
        bool operator()(std::string_view a, std::string_view b) const noexcept;
    };

    bool ignoresCase_;
    const ModuleHead* unfinished_ = nullptr;
    Place unfinishedPlace_;
    std::vector<std::unique_ptr<ModuleHead>> heads_;
    std::map<std::string_view, ModuleHead*, NameOrder> byName_;
};

} // namespace Readers
} // namespace Orn_Hdl
