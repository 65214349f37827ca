// What has to be changed in a design before its netlist is legal.
#pragma once

#include "Check/Context.h"
#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Writers/Generics.h"

#include <string>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace Orn_Hdl::Legal {

using Writers::IsGeneric;

/// A name as it is written: both are the same unless names are escaped.
struct NewName {
    std::string verilog;
    std::string vhdl;

    const std::string& Get(Language language) const noexcept {
        return language == Language::Vhdl ? vhdl : verilog;
    }
};

/// The names that change. A name without an entry stays.
struct NewNames {
    /// By the netlist, a component, an instance, a scalar signal, a bus, a pin of a component or an
    /// attribute of the module. That of a bus or of a bus pin is without the range.
    std::unordered_map<const Object*, NewName> objects;
    /// \{
    /// By the former name in small letters: of synthesis attributes, and of the generics of
    /// components and instances.
    std::unordered_map<std::string, NewName> attributes;
    std::unordered_map<std::string, NewName> generics;
    /// \}
    /// Internal signals for ports that are used against their direction.
    std::unordered_map<const Signal*, std::string> inner;
    /// Signals for the input pins of instances that nothing is wired to.
    std::unordered_map<const Pin*, std::string> open;
    /// Signals for inputs that an instance did not get when it was made; by the instance and the
    /// component's pin.
    std::unordered_map<const Instance*, std::vector<std::pair<const Pin*, std::string>>> late;
    /// Signals for the parts of compounds that are open, leftmost first.
    std::unordered_map<const Signal*, std::vector<std::string>> parts;

    /// The new name of an object; null when it keeps its own.
    const NewName* Find(const Object& object) const;
};

/// What has to be changed in a design before its netlist is legal.
class Plan {
public:
    /// Checks the design. The plan is valid as long as the design does not change.
    Plan(const Netlist& netlist, const HdlOptions& options);

    /// Whether the design cannot be written as it stands.
    bool IsNeeded() const noexcept { return isNeeded_; }
    /// What no netlist can mend.
    const std::vector<Check::Finding>& GetErrors() const noexcept { return errors_; }
    const NewNames& GetNames() const noexcept { return names_; }
    /// The options of the legal netlist.
    const HdlOptions& GetOptions() const noexcept { return options_; }

    /// Whether the signal stands for no signal, and is not written.
    bool IsNothing(const Signal& signal) const noexcept;
    bool IsUsed(const Component& component) const { return used_.count(&component) != 0; }
    /// Whether the constant of the signal has to be written with its bits.
    bool HasFaultyConstant(const Signal& signal) const { return constants_.count(&signal) != 0; }
    /// Whether the attribute's value has to be written with its bits.
    bool NeedsBits(const Attribute& attribute) const { return digits_.count(&attribute) != 0; }
    /// Whether the attributes of a name lose the type that the user names, and are texts.
    bool IsText(const Attribute& attribute) const;
    /// Whether the attribute has to be declared although its option says that it is not.
    bool NeedsDeclaration(const Attribute& attribute) const;
    /// Whether comments can hold commands to tools.
    bool HasDirectives() const noexcept { return hasDirectives_; }
    /// The generics that a component gets from its instances.
    std::vector<const Attribute*> GetNewGenerics(const Component& component) const;

private:
    void Note(Check::Finding& finding);
    void Refuse(Check::Finding& finding) { errors_.push_back(std::move(finding)); }
    void NoteConstant(Check::Finding& finding);
    void NoteAttributeDigits(Check::Finding& finding);
    void NoteGeneric(Check::Finding& finding);
    void FindOpen();
    void NoteOpen();
    void MendClauses();

    const Netlist& netlist_;
    const Signal* open_ = nullptr;
    bool isNeeded_ = false;
    bool hasDirectives_ = false;
    HdlOptions options_;
    NewNames names_;
    std::vector<Check::Finding> errors_;
    std::unordered_set<const Component*> used_;
    std::unordered_set<const Signal*> constants_;
    std::unordered_set<const Attribute*> digits_;
    std::unordered_set<std::string> texts_;
    std::unordered_set<std::string> undeclared_;
    std::unordered_map<const Component*, std::vector<const Attribute*>> newGenerics_;
};

} // namespace Orn_Hdl::Legal
