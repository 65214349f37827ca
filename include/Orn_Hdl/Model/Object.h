/// \file
/// `Object`, the base of every named thing of a design, and `ObjectVisitor`.
#pragma once

#include "Port/Export.h"
#include "Port/Pooled.h"
#include "Port/String.h"
#include "Port/TextArgument.h"

#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

class Attribute;
class BitVectorValue;
class Component;
class Instance;
class Netlist;
class ObjectName;
class ObjectVisitor;
class Pin;
class Signal;
struct ObjectDetails;

/// Which kind of thing an `Object` is.
enum ObjectType {
    ObjectTypeAttribute = 100,
    ObjectTypeSignal = 101,
    ObjectTypePin = 102,
    ObjectTypeComponent = 103,
    ObjectTypeInstance = 104,
    ObjectTypeNetlist = 105
};

/// A named thing: the netlist, a component, instance, pin, signal or attribute. It has a name,
/// stored normalised, and a comment of any number of lines.
///
/// The owner of an object destroys it: the netlist its components, instances and signals, a
/// component or an instance its pins, an attribute holder its attributes. Anybody else may `delete`
/// an object too: an object that is destroyed takes itself out of its owner and of every other
/// object's lists, so no list ever names a destroyed object.
class ORN_HDL_API Object : public Port::Pooled<Port::Pool::DesignObjects> {
public:
    virtual ~Object();
    /// The kind, an `ObjectType`.
    virtual int GetObjectType() const;
    /// Calls the visit operation of this object's kind with this object.
    virtual void AcceptObject(ObjectVisitor& visitor) = 0;
    /// Stores a name, normalised; null is read as "". No name is refused.
    ///
    /// A netlist goes on finding a component, an instance or a signal by the name under which it
    /// was added, and so does a holder an attribute. The name that the object had is therefore not
    /// free for another one, and the new name is not taken: a second net of that name can be
    /// declared. `Model::RenameComponent`, `RenameInstance` and `RenameSignal` check the new name,
    /// and the object is found by it afterwards.
    virtual void SetName(const char* name);
    /// Stores a name, given as any other kind of text, as the overload for a C text does.
    void SetName(const Port::TextArgument& name) { SetName(name.Get()); }

    /// The name, as a copy.
    Port::StringBase<char> GetName() const { return GetNameView(); }
    /// The name without a copy, valid until the object is changed or destroyed.
    std::string_view GetNameView() const noexcept;
    /// Whether the text, as it stands, equals the name ignoring case.
    bool IsNamed(const char* name) const noexcept;

    /// Appends the text, null read as "", and a line feed to the comment.
    void AddComment(const char* text);
    /// The comment, every line of it with its line feed.
    Port::StringBase<char> GetComment() const;
    /// The comment without a copy, valid until it changes.
    std::string_view GetCommentView() const noexcept;

    /// Whether comment, name and type are equal.
    bool operator==(const Object& other) const noexcept;
    /// The opposite of `==`.
    bool operator!=(const Object& other) const noexcept { return !(*this == other); }

    /// Turns every "[", "{" and "<" into "(", every "]", "}" and ">" into ")", and every "-" into
    /// ":".
    static void NormalizeName(Port::StringBase<char>& name);
    /// The normalised text before its first "(" when it holds "(" and ")" and no ","; otherwise the
    /// whole normalised text. Null gives "".
    static Port::StringBase<char> GetBaseName(const char* name);
    /// Whether the whole text is a letter, "'" or "_" followed by letters, digits and "_".
    static bool IsValidBaseName(const char* name) noexcept;
    /// Whether the whole text is digits with an optional sign.
    static bool IsValidIntegerString(const Port::StringBase<char>& text) noexcept;

protected:
    /// A nameless object without a comment. Its type is `ObjectTypeAttribute` unless a derived
    /// class overrides `GetObjectType`.
    Object() noexcept : Object(ObjectTypeAttribute) {}
    /// A nameless object of a kind.
    explicit Object(ObjectType type) noexcept;
    /// Copies name, comment and type.
    Object(const Object& other);
    /// Replaces name, comment and type by those of another object.
    Object& operator=(const Object& other);

    /// Stores a name as it stands.
    void SetNameVerbatim(std::string_view name);
    /// Shares the name of another object.
    void CopyNameFrom(const Object& other);
    /// Exchanges names and comments with another object, and everything else in the details.
    void SwapDetails(Object& other) noexcept;

    /// The parts that few objects have, made when first asked for.
    ORN_HDL_LOCAL ObjectDetails& MakeDetails();
    /// The parts that few objects have; null when this object has none of them.
    ORN_HDL_LOCAL ObjectDetails* GetDetails() const noexcept;

    /// A direction, as pins and signals have one: -1 to 2 stand in spare bits, where they cost
    /// nothing, any other number in the details.
    int GetDirection() const noexcept {
        return (bits_ & OddDirectionBit) != 0 ? GetOddDirection()
                                              : static_cast<int>((bits_ & DirectionMask) >> 5U) - 1;
    }
    /// Sets the direction.
    void SetDirection(int direction);

    /// Whether a flag of the derived classes is set; their flags stand in a spare byte. Classes
    /// without a direction have its bits too.
    bool HasFlag(unsigned flag) const noexcept { return (bits_ & flag) != 0; }
    /// Sets or clears a flag.
    void SetFlag(unsigned flag, bool on) noexcept;

private:
    friend class OwnedFlag;
    friend struct ObjectKey;

    static constexpr unsigned TypeMask = 0x07;
    static constexpr unsigned OwnedFlagBit = 0x08;
    // 0x10 is the derived classes', and 0x20 to 0x80 are those of classes without a direction.
    static constexpr unsigned DirectionMask = 0x60;
    static constexpr unsigned OddDirectionBit = 0x80;

    /// The type, less `ObjectTypeAttribute`.
    unsigned GetTypeBits() const noexcept { return bits_ & TypeMask; }
    ObjectName& Name() noexcept;
    const ObjectName& Name() const noexcept;
    int GetOddDirection() const noexcept;
    std::string_view GetKeyName() const noexcept;
    void KeepKeyName(std::string_view newName);
    void DropKeyName() noexcept;
    void SwapName(ObjectName& name) noexcept;

    /// Holds an `ObjectName`, whose class is private to the library.
    alignas(8) unsigned char nameStorage_[15];
    std::uint8_t bits_ = 0;
};

/// Visits objects by kind; every operation of the base does nothing.
class ORN_HDL_API ObjectVisitor {
public:
    ObjectVisitor() = default;
    ObjectVisitor(const ObjectVisitor&) = default;
    ObjectVisitor& operator=(const ObjectVisitor&) = default;
    virtual ~ObjectVisitor();
    /// Called for an attribute of any class.
    virtual void VisitAttribute(Attribute* attribute);
    /// Called for a signal of any class.
    virtual void VisitSignal(Signal* signal);
    /// Called for a component.
    virtual void VisitComponent(Component* component);
    /// Called for a pin of any class.
    virtual void VisitPin(Pin* pin);
    /// Called for an instance.
    virtual void VisitInstance(Instance* instance);
    /// Called for a netlist.
    virtual void VisitNetlist(Netlist* netlist);
};

} // namespace Orn_Hdl
