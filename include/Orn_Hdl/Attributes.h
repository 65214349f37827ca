/// \file
/// Attributes: named, typed values attached to the objects of a design.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringPtrMap.h"
#include "Orn_Hdl/Model/Object.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace Orn_Hdl {

class AttributeVisitor;
struct AttributeTable;

/// A bit-vector literal: its digits, and, when they were given, its base and its length in bits.
class ORN_HDL_API BitVectorValue {
public:
    BitVectorValue() = default;
    /// The literal that `SetValue` reads from a text.
    explicit BitVectorValue(const char* text) { SetValue(text); }

    /// Reads "LENGTH:BASE:DIGITS" with base B, O or H, such as "8:H:A5"; a text with fewer than
    /// three parts is taken as the digits alone. Null is read as "".
    void SetValue(const char* text);

    /// The digits.
    const Port::StringBase<char>& GetValue() const noexcept { return digits_; }
    /// 2, 8 or 16; 2 when none was given.
    int GetBase() const noexcept { return base_; }
    /// In bits; 1 when none was given.
    int GetLength() const noexcept { return length_; }
    /// Whether the text gave base and length.
    bool HasBaseAndLength() const noexcept { return hasBaseAndLength_; }

private:
    static int ConvertToBase(std::string_view text) noexcept;

    Port::StringBase<char> digits_;
    int base_ = 2;
    int length_ = 1;
    bool hasBaseAndLength_ = false;
};

/// An attribute: a name, a value of one of seven types, and two options that say how the writers
/// treat it.
class ORN_HDL_API Attribute : public Object {
public:
    /// The types of a value.
    enum ValueType { String, Integer, Float, Boolean, Bit, BitVector, User };
    /// Values of the generic option.
    enum GenericOption { GenericNone = 0, GenericNoSyn = 1, GenericSyn = 2 };
    /// Values of the synthesis-attribute option.
    enum SynAttrOption { SynAttrNone = 0, SynAttrAssign = 1, SynAttrAssignNoDec = 2 };

    /// The name of the type that an attribute gets when none is named.
    static constexpr const char* DEFAULT_ATTRTYPE = "String";
    /// The generic option of a new attribute.
    static constexpr int DEFAULT_GENERIC = GenericNone;
    /// The synthesis-attribute option of a new attribute.
    static constexpr int DEFAULT_SYNATTR = SynAttrNone;

    /// The holder drops the attribute, whoever destroys it.
    ~Attribute() override;
    void AcceptObject(ObjectVisitor& visitor) override;
    /// Calls the visit operation of this attribute's type.
    virtual void AcceptAttribute(AttributeVisitor& visitor);
    /// A new attribute of the same class with the same name, comment, options and value; the caller
    /// owns it.
    virtual Attribute* CloneAttribute() const = 0;
    /// Parses and stores a value text. No text is refused; null is read as "".
    virtual void SetValue(const char* text) = 0;
    /// The value as a text, spelt as the type spells it.
    virtual Port::StringBase<char> GetValueString() const = 0;
    /// The type of the value.
    virtual ValueType GetValueType() const = 0;

    /// The name of the type, such as "BitVector".
    Port::StringBase<char> GetValueTypeName() const;

    /// Sets the generic option from "NONE", "SYN" or "NOSYN", letter case ignored.
    /// \return false, the option unchanged, for any other text.
    bool SetGeneric(const char* text) noexcept;
    /// Sets the generic option.
    void SetGeneric(GenericOption option) noexcept { SetOption(GenericFlags, option); }
    /// The generic option as a text.
    Port::StringBase<char> GetGeneric() const;
    /// The generic option.
    GenericOption GetGenericOption() const noexcept {
        return static_cast<GenericOption>(GetOption(GenericFlags));
    }
    /// Sets the synthesis-attribute option from "NONE", "ASSIGN" or "ASSIGNNODEC", letter case
    /// ignored.
    /// \return false, the option unchanged, for any other text.
    bool SetSynAttr(const char* text) noexcept;
    /// Sets the synthesis-attribute option.
    void SetSynAttr(SynAttrOption option) noexcept { SetOption(SynAttrFlags, option); }
    /// The synthesis-attribute option as a text.
    Port::StringBase<char> GetSynAttr() const;
    /// The synthesis-attribute option.
    SynAttrOption GetSynAttrOption() const noexcept {
        return static_cast<SynAttrOption>(GetOption(SynAttrFlags));
    }

    /// Whether name, comment, type and both options are equal, and the value texts ignoring case.
    bool operator==(const Attribute& other) const;
    /// The opposite of `==`.
    bool operator!=(const Attribute& other) const { return !(*this == other); }

protected:
    /// An attribute with the default options.
    explicit Attribute(const char* name);
    /// Copies name, comment and options; the copy has no holder.
    Attribute(const Attribute& other);
    /// Copies name, comment and options; the holder stays.
    Attribute& operator=(const Attribute& other);

private:
    friend struct AttributeTable;

    /// The options stand in flags of the object, two bits each.
    static constexpr unsigned GenericFlags = 0x10;
    static constexpr unsigned SynAttrFlags = 0x40;

    int GetOption(unsigned flags) const noexcept {
        return (HasFlag(flags) ? 1 : 0) + (HasFlag(flags * 2) ? 2 : 0);
    }
    void SetOption(unsigned flags, int option) noexcept;

    /// The table that holds the attribute; null without a holder.
    AttributeTable* table_ = nullptr;
};

/// A text.
class ORN_HDL_API AttributeString : public Attribute {
public:
    /// Null texts are read as "".
    AttributeString(const char* name, const char* value);
    /// Makes a text attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return String; }
    /// The text.
    Port::StringBase<char> GetValue() const { return value_; }

private:
    Port::StringBase<char> value_;
};

/// A signed 32-bit integer, parsed by the rules of `atoi`, saturating.
class ORN_HDL_API AttributeInteger : public Attribute {
public:
    /// Null texts are read as "".
    AttributeInteger(const char* name, const char* value);
    /// Makes an integer attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return Integer; }
    /// The number.
    int GetValue() const noexcept { return value_; }

private:
    int value_ = 0;
};

/// A floating-point number that is written with as many decimals as its text had. A number that is
/// too small for a double is a zero of its sign; one that is not finite is 0.0.
class ORN_HDL_API AttributeFloat : public Attribute {
public:
    /// Null texts are read as "".
    AttributeFloat(const char* name, const char* value);
    /// Makes a floating-point attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return Float; }
    /// The number.
    double GetValue() const noexcept { return value_; }

private:
    double value_ = 0.0;
    int width_ = 3;
    int precision_ = 1;
};

/// True exactly for the text "true" in any letter case.
class ORN_HDL_API AttributeBoolean : public Attribute {
public:
    /// Null texts are read as "".
    AttributeBoolean(const char* name, const char* value);
    /// Makes a truth-value attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return Boolean; }
    /// The value.
    bool GetValue() const noexcept { return value_; }

private:
    bool value_ = false;
};

/// "1" for the text "1", else "0".
class ORN_HDL_API AttributeBit : public Attribute {
public:
    /// Null texts are read as "".
    AttributeBit(const char* name, const char* value);
    /// Makes a bit attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return Bit; }
    /// "1" or "0".
    Port::StringBase<char> GetValue() const { return GetValueString(); }

private:
    bool value_ = false;
};

/// A bit-vector literal.
class ORN_HDL_API AttributeBitVector : public Attribute {
public:
    /// Null texts are read as "".
    AttributeBitVector(const char* name, const char* value);
    /// Makes a bit-vector attribute on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    /// The digits alone.
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return BitVector; }
    /// The digits.
    Port::StringBase<char> GetValue() const { return value_.GetValue(); }
    /// The whole literal.
    BitVectorValue GetBitVectorValue() const { return value_; }

private:
    BitVectorValue value_;
};

/// A text of a type that the user names.
class ORN_HDL_API AttributeUser : public Attribute {
public:
    /// Null texts are read as "".
    AttributeUser(const char* name, const char* value);
    /// Makes an attribute of a user type on the heap; the caller owns it.
    static Attribute* CreateAttribute(const char* name, const char* value);
    void AcceptAttribute(AttributeVisitor& visitor) override;
    Attribute* CloneAttribute() const override;
    void SetValue(const char* text) override;
    Port::StringBase<char> GetValueString() const override;
    ValueType GetValueType() const override { return User; }
    /// The text.
    Port::StringBase<char> GetValue() const { return value_; }
    /// Names the type; null is read as "".
    void SetUserType(const char* type) { userType_ = type; }
    /// The name of the type; empty until it is set.
    Port::StringBase<char> GetUserType() const { return userType_; }

private:
    Port::StringBase<char> value_;
    Port::StringBase<char> userType_;
};

/// Visits attributes by value type; every operation of the base does nothing.
class ORN_HDL_API AttributeVisitor {
public:
    AttributeVisitor() = default;
    AttributeVisitor(const AttributeVisitor&) = default;
    AttributeVisitor& operator=(const AttributeVisitor&) = default;
    virtual ~AttributeVisitor();
    /// Called for an attribute of a class that does not override `AcceptAttribute`.
    virtual void VisitAttribute(Attribute* attribute);
    /// Called for a text.
    virtual void VisitAttributeString(AttributeString* attribute);
    /// Called for an integer.
    virtual void VisitAttributeInteger(AttributeInteger* attribute);
    /// Called for a floating-point number.
    virtual void VisitAttributeFloat(AttributeFloat* attribute);
    /// Called for a bit.
    virtual void VisitAttributeBit(AttributeBit* attribute);
    /// Called for a bit-vector literal.
    virtual void VisitAttributeBitVector(AttributeBitVector* attribute);
    /// Called for a truth value.
    virtual void VisitAttributeBoolean(AttributeBoolean* attribute);
    /// Called for a text of a type that the user names.
    virtual void VisitAttributeUser(AttributeUser* attribute);
};

/// Owns attributes, in the order in which they were added. A holder without attributes owns no
/// table.
class ORN_HDL_API AttributeHolder {
public:
    AttributeHolder() noexcept;
    /// Clones every attribute.
    AttributeHolder(const AttributeHolder& other);
    /// Destroys the attributes and clones those of another holder. If allocation fails, nothing
    /// changes.
    AttributeHolder& operator=(const AttributeHolder& other);
    /// Destroys the attributes.
    virtual ~AttributeHolder();

    /// Takes ownership, also when it throws for want of memory. Null is ignored, and so is an
    /// attribute that has an owner. A second attribute of one name is held and iterated too, and
    /// `GetAttr` then finds the later one.
    virtual void AddAttr(Attribute* attribute);
    /// Destroys an attribute of this holder, as `delete` does. Null, and an attribute that this
    /// holder does not own, are ignored.
    void RemoveAttr(Attribute* attribute) noexcept;
    /// Takes an attribute out without destroying it.
    /// \return the attribute, which the caller owns; null when this holder does not own it.
    std::unique_ptr<Attribute> DetachAttr(Attribute* attribute) noexcept;
    /// The attribute of that name, normalised and letter case ignored; null when there is none.
    virtual Attribute* GetAttr(const char* name) const;
    /// The attribute of that name, given as any other kind of text; null when there is none.
    Attribute* GetAttr(const Port::TextArgument& name) const { return GetAttr(name.Get()); }

    /// The attributes, in the order in which they were added, those included that are added or
    /// assigned while it walks. The holder must outlive it.
    Iterator<Attribute*> GetAttrIterator() const noexcept;
    /// Whether there are any.
    bool HasAttrs() const noexcept { return GetTable() != nullptr && HasAttrsInTable(); }

protected:
    /// Exchanges the attributes with those of another holder.
    void SwapAttrs(AttributeHolder& other) noexcept;

private:
    friend class OwnerLink;

    /// Whether `link_` leads to the owner of the holder, which is marked by an odd address.
    bool IsLinkToOwner() const noexcept {
        return (reinterpret_cast<std::uintptr_t>(link_) & 1) != 0;
    }
    AttributeTable* GetTable() const noexcept {
        return IsLinkToOwner() ? nullptr : static_cast<AttributeTable*>(link_);
    }
    AttributeTable& MakeTable();
    bool HasAttrsInTable() const noexcept;

    /// The table of the attributes; without one, the owner of the holder, or null. Most objects
    /// have no attributes, so that knowing its owner costs an object no memory.
    void* link_ = nullptr;
};

/// Makes attributes by the name of their type.
class ORN_HDL_API AttributeFactory {
public:
    /// Makes an attribute that the caller owns.
    using Creator = Attribute* (*)(const char* name, const char* value);

    /// The table of the seven types, shared by the whole process and never changed once made.
    static const IStringPtrMap<Creator>& GetCreators();
};

} // namespace Orn_Hdl
