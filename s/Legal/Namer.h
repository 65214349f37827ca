// Gives new names to what cannot bear its own.
#pragma once

#include "Check/Context.h"
#include "Legal/Plan.h"
#include "Legal/Scope.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl::Legal {

/// Whose names have to change because of themselves.
struct FaultyNames {
    /// Objects, and attributes of the module.
    std::unordered_set<const Object*> objects;
    /// \{
    /// Synthesis attributes, and generics of components and instances, by their names in small
    /// letters.
    std::unordered_set<std::string> attributes;
    std::unordered_set<std::string> generics;
    /// \}
    /// Of the objects, those whose name is only no identifier, or a reserved word.
    std::unordered_set<const Object*> escapable;
};

/// Names the objects of a design. A name that can stay does: all of these are claimed before the
/// first one changes. What changes is named in the order of the names, so that the order of the
/// commands does not show.
class Namer {
public:
    Namer(const Checking::Context& context, const Plan& plan, FaultyNames& faulty, NewNames& names)
        : context_(context), plan_(plan), faulty_(faulty), names_(names) {}

    /// Names everything that a netlist names.
    void NameAll();

private:
    /// Something whose name changes.
    struct Changing {
        int rank = 0;
        /// The name without a range.
        std::string_view name;
        /// The whole name, which tells apart what has the same one without it.
        std::string_view whole;
        /// Null for an attribute.
        const Object* object = nullptr;
        char initial = 'n';
    };
    /// Something that a write makes, such as the signal of an open pin.
    struct Made {
        std::string wanted;
        std::string* name = nullptr;
    };

    void ClaimBoxType();
    void ClaimComponents();
    void ClaimSignals(bool ports, bool buses);
    void ClaimModuleAttributes();
    void ClaimAttributes();
    void ClaimInstances();
    void ClaimOrChange(int rank, std::string_view whole, const Object& object, char initial);
    void ClaimPinsOf(const Component& component);
    void FindTakenGenerics();
    void BlockNames();
    void NameChanging();
    void NameDesign();
    bool Escapes(const Changing& changing);
    void NameAttributes();
    void NamePins();
    void NamePinsOf(const Component& component);
    void NameInner();
    void NameOpen();
    void NameMade();
    std::string SpellNew(const Object& object, std::string_view old) const;

    const Checking::Context& context_;
    const Plan& plan_;
    FaultyNames& faulty_;
    NewNames& names_;
    Scope scope_;
    /// The names of pins, whatever their components, and of attributes.
    Scope pinsAndAttributes_;
    std::vector<Changing> changing_;
    std::vector<Made> made_;
};

} // namespace Orn_Hdl::Legal
