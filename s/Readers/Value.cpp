#include "Readers/Value.h"

#include "HdlModel/Objects/AttributeTable.h"
#include "Port/Ascii.h"
#include "Readers/Limits.h"
#include "Readers/Place.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <system_error>
#include <utility>
#include <vector>

namespace Orn_Hdl::Readers {

std::string DecimalBits(std::string digits) {
    if (digits.size() > MostDecimalDigits) {
        throw LiteralProblem{"a decimal number of more than " + std::to_string(MostDecimalDigits) +
                             " digits"};
    }
    std::string bits;
    while (!digits.empty()) {
        int remainder = 0;
        std::string half;
        for (const char digit : digits) {
            if (!Port::IsDigit(digit)) {
                throw LiteralProblem{std::string("the digit ") + digit + " in a decimal number"};
            }
            const int present = remainder * 10 + (digit - '0');
            remainder = present % 2;
            if (!half.empty() || present > 1) {
                half += static_cast<char>('0' + present / 2);
            }
        }
        bits += static_cast<char>('0' + remainder);
        digits = std::move(half);
    }
    std::reverse(bits.begin(), bits.end());
    bits.erase(0, std::min(bits.find('1'), bits.size()));
    return bits;
}

std::string WithoutExponent(const std::string& text) {
    const std::size_t e = text.find_first_of("eE");
    if (e == std::string::npos) {
        return text;
    }
    const char* first = text.data() + e + 1;
    first += *first == '+' ? 1 : 0;
    int exponent = 0;
    const auto result = std::from_chars(first, text.data() + text.size(), exponent);
    constexpr int MostDigits = 300;
    if (result.ec != std::errc() || result.ptr != text.data() + text.size() ||
        exponent > MostDigits || exponent < -MostDigits) {
        throw LiteralProblem{"the number " + text + " is too large or too small"};
    }
    std::string digits = text.substr(0, e);
    std::size_t point = std::min(digits.find('.'), digits.size());
    if (point < digits.size()) {
        digits.erase(point, 1);
    }
    if (exponent < 0) {
        const auto places = static_cast<std::size_t>(-exponent);
        if (point <= places) {
            digits.insert(0, places - point + 1, '0');
            point += places - point + 1;
        }
        point -= places;
    } else {
        point += static_cast<std::size_t>(exponent);
        digits.append(point > digits.size() ? point - digits.size() : 0, '0');
    }
    digits.insert(point, ".");
    return digits.back() == '.' ? digits + "0" : digits;
}

std::string MakeConstant(const std::string& bits, bool isBare) {
    return isBare ? bits : std::to_string(bits.size()) + ":B:" + bits;
}

bool HasDontCares(const Netlist& netlist) {
    const Iterator<Signal*> signals = netlist.GetSignalIterator();
    return std::any_of(signals.begin(), signals.end(), [](const Signal* signal) {
        const std::string_view digits = signal->GetConstantValue().GetValue();
        return digits.find('-') != std::string_view::npos;
    });
}

Value Value::OfBits(const std::string& bits) {
    return {Attribute::BitVector, MakeConstant(bits, false), {}};
}

Value Value::GetZero() const {
    switch (type) {
    case Attribute::Integer:
    case Attribute::Bit:
        return {type, "0", {}};
    case Attribute::Float:
        return {type, "0.0", {}};
    case Attribute::BitVector: {
        const int length = BitVectorValue(text.c_str()).GetLength();
        return OfBits(std::string(static_cast<std::size_t>(length), '0'));
    }
    default:
        return {type, "", {}};
    }
}

std::unique_ptr<Attribute> Value::MakeAttribute(const char* name) const {
    switch (type) {
    case Attribute::Integer:
        return std::make_unique<AttributeInteger>(name, text.c_str());
    case Attribute::Float:
        return std::make_unique<AttributeFloat>(name, text.c_str());
    case Attribute::Boolean:
        return std::make_unique<AttributeBoolean>(name, text.c_str());
    case Attribute::Bit:
        return std::make_unique<AttributeBit>(name, text.c_str());
    case Attribute::BitVector:
        return std::make_unique<AttributeBitVector>(name, text.c_str());
    case Attribute::User: {
        auto attribute = std::make_unique<AttributeUser>(name, text.c_str());
        attribute->SetUserType(userType.c_str());
        return attribute;
    }
    default:
        return std::make_unique<AttributeString>(name, text.c_str());
    }
}

std::string SetAttribute(AttributeHolder& holder, const std::string& name, const Value& value,
                         const char* generic, const char* synthesis) {
    std::unique_ptr<Attribute> attribute = value.MakeAttribute(name.c_str());
    Attribute* const present = holder.GetAttr(name.c_str());
    if (present == nullptr) {
        if (attribute->GetNameView() != name) {
            return "a model has no attribute of this name";
        }
        attribute->SetGeneric(generic == nullptr ? "NONE" : generic);
        attribute->SetSynAttr(synthesis == nullptr ? "NONE" : synthesis);
        holder.AddAttr(attribute.release());
        return "";
    }
    if (present->GetNameView() != name) {
        return "a model does not tell it from " + Quoted(present->GetNameView());
    }
    const bool wasSet = generic != nullptr ? present->GetGenericOption() != Attribute::GenericNone
                                           : present->GetSynAttrOption() != Attribute::SynAttrNone;
    if (!wasSet && present->GetValueString() != attribute->GetValueString()) {
        return "there is an attribute and a parameter of this name, with different values, and a "
               "model has one of both";
    }
    // The form of a parameter's value says more than that of an attribute in a comment.
    if (!wasSet && generic == nullptr) {
        present->SetSynAttr(synthesis);
        return "";
    }
    attribute->SetGeneric(generic != nullptr ? generic : present->GetGeneric().CStr());
    attribute->SetSynAttr(synthesis != nullptr ? synthesis : present->GetSynAttr().CStr());
    if (present->GetValueType() == attribute->GetValueType()) {
        present->SetValue(value.text.c_str());
        present->SetGeneric(attribute->GetGeneric().CStr());
        present->SetSynAttr(attribute->GetSynAttr().CStr());
        return "";
    }
    AttributeTable::Replace(*present, std::move(attribute));
    return "";
}

} // namespace Orn_Hdl::Readers
