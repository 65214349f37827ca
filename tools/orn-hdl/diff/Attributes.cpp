#include "diff/Attributes.h"

#include "diff/Names.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <string_view>

namespace Tool::Diff {

namespace {

using Orn_Hdl::Attribute;

bool Counts(const Attribute& attribute, const Rules& rules) {
    return rules.hasExactAttributes || attribute.GetGenericOption() != Attribute::GenericNone ||
           (rules.hasSynthesisAttributes && attribute.GetSynAttrOption() != Attribute::SynAttrNone);
}

std::string GetText(const Attribute& attribute) {
    return std::string(attribute.GetValueString().GetView());
}

/// A number as bits without leading zeros.
std::string ToBits(unsigned number) {
    std::string bits;
    for (; number != 0; number /= 2) {
        bits.insert(bits.begin(), number % 2 == 0 ? '0' : '1');
    }
    return bits.empty() ? "0" : bits;
}

/// A value as every language can say it: a number as its bits, anything else as its text. A bit
/// vector is a number in one format and a string of digits in another.
std::string GetPlainValue(const Attribute& attribute) {
    std::string text = GetText(attribute);
    switch (attribute.GetValueType()) {
    case Attribute::BitVector: {
        const auto& vector = static_cast<const Orn_Hdl::AttributeBitVector&>(attribute);
        const Orn_Hdl::BitVectorValue value = vector.GetBitVectorValue();
        const auto perDigit = value.GetBase() == 16 ? 4U : value.GetBase() == 8 ? 3U : 1U;
        const std::vector<std::uint32_t> ties =
            GetTies(value, value.HasBaseAndLength() && value.GetLength() > 0 &&
                                   value.GetLength() < static_cast<int>(MostBits)
                               ? static_cast<std::size_t>(value.GetLength())
                               : text.size() * perDigit);
        std::string bits;
        for (const std::uint32_t tie : ties) {
            if (tie != Graph::TiedToZero && tie != Graph::TiedToOne) {
                return text;
            }
            bits += tie == Graph::TiedToOne ? '1' : '0';
        }
        const std::size_t one = bits.find('1');
        return one == std::string::npos ? "0" : bits.substr(one);
    }
    case Attribute::Integer:
        return static_cast<const Orn_Hdl::AttributeInteger&>(attribute).GetValue() < 0
                   ? text
                   : ToBits(static_cast<unsigned>(
                         static_cast<const Orn_Hdl::AttributeInteger&>(attribute).GetValue()));
    default:
        std::transform(text.begin(), text.end(), text.begin(), Port::ToLower);
        return text;
    }
}

std::string GetUserType(const Attribute& attribute) {
    return attribute.GetValueType() == Attribute::User
               ? std::string(
                     static_cast<const Orn_Hdl::AttributeUser&>(attribute).GetUserType().GetView())
               : std::string();
}

bool IsExactlyEqual(const Attribute& a, const Attribute& b) {
    if (a.GetValueType() != b.GetValueType() || a.GetGenericOption() != b.GetGenericOption() ||
        a.GetSynAttrOption() != b.GetSynAttrOption() || GetText(a) != GetText(b) ||
        GetUserType(a) != GetUserType(b)) {
        return false;
    }
    if (a.GetValueType() != Attribute::BitVector) {
        return true;
    }
    const auto valueA = static_cast<const Orn_Hdl::AttributeBitVector&>(a).GetBitVectorValue();
    const auto valueB = static_cast<const Orn_Hdl::AttributeBitVector&>(b).GetBitVectorValue();
    return valueA.GetBase() == valueB.GetBase() && valueA.GetLength() == valueB.GetLength();
}

/// A netlist says some values as a number, and some as a string of the same digits.
bool AreEqual(const Attribute& a, const Attribute& b, const Rules& rules) {
    return rules.hasExactAttributes ? IsExactlyEqual(a, b)
                                    : GetPlainValue(a) == GetPlainValue(b) ||
                                          Port::EqualIgnoringCase(a.GetValueString().GetView(),
                                                                  b.GetValueString().GetView());
}

void SortByName(AttributeList& list) {
    std::stable_sort(list.begin(), list.end(), [](const Attribute* a, const Attribute* b) {
        return Port::OrderIgnoringCase(a->GetNameView(), b->GetNameView()) < 0;
    });
}

} // namespace

AttributeList ListAttributes(const Orn_Hdl::AttributeHolder& holder, const Rules& rules) {
    AttributeList list;
    if (holder.HasAttrs()) {
        for (const Attribute* attribute : holder.GetAttrIterator()) {
            if (Counts(*attribute, rules)) {
                list.push_back(attribute);
            }
        }
    }
    SortByName(list);
    return list;
}

AttributeList ListEffective(const Orn_Hdl::Instance& instance, const Rules& rules) {
    AttributeList list;
    for (const Attribute* attribute : instance.GetAttrIterator()) {
        list.push_back(attribute);
    }
    const Orn_Hdl::Component* const component = instance.GetComponent();
    if (component != nullptr && component->HasAttrs()) {
        for (const Attribute* attribute : component->GetAttrIterator()) {
            const std::string name(attribute->GetNameView());
            if (instance.GetAttr(name.c_str()) == nullptr) {
                list.push_back(attribute);
            }
        }
    }
    list.erase(
        std::remove_if(list.begin(), list.end(),
                       [&](const Attribute* attribute) { return !Counts(*attribute, rules); }),
        list.end());
    SortByName(list);
    return list;
}

std::vector<AttributePair> CompareAttributes(const AttributeList& a, const AttributeList& b,
                                             const Rules& rules) {
    std::vector<AttributePair> pairs;
    for (std::size_t i = 0, j = 0; i < a.size() || j < b.size();) {
        const int order = i == a.size() ? 1
                          : j == b.size()
                              ? -1
                              : Port::OrderIgnoringCase(a[i]->GetNameView(), b[j]->GetNameView());
        if (order < 0) {
            pairs.emplace_back(a[i++], nullptr);
        } else if (order > 0) {
            pairs.emplace_back(nullptr, b[j++]);
        } else {
            if (!AreEqual(*a[i], *b[j], rules)) {
                pairs.emplace_back(a[i], b[j]);
            }
            ++i;
            ++j;
        }
    }
    return pairs;
}

std::string DescribeAttribute(const Attribute& attribute, const Rules& rules) {
    std::string text;
    if (attribute.GetValueType() == Attribute::BitVector) {
        const auto value =
            static_cast<const Orn_Hdl::AttributeBitVector&>(attribute).GetBitVectorValue();
        if (value.HasBaseAndLength()) {
            const char* const base = value.GetBase() == 16  ? ":H:"
                                     : value.GetBase() == 8 ? ":O:"
                                                            : ":B:";
            text.append(std::to_string(value.GetLength())).append(base);
        }
    }
    text.append(GetText(attribute));
    if (!rules.hasExactAttributes) {
        return text;
    }
    const std::string user = GetUserType(attribute);
    text.append(" (").append(user.empty() ? attribute.GetValueTypeName().GetView() : user);
    if (attribute.GetGenericOption() != Attribute::GenericNone) {
        text.append(", generic ").append(attribute.GetGeneric().GetView());
    }
    if (attribute.GetSynAttrOption() != Attribute::SynAttrNone) {
        text.append(", synthesis ").append(attribute.GetSynAttr().GetView());
    }
    return text.append(")");
}

Likeness GetLikeness(const Graph& graph, const Rules& rules) {
    Likeness likeness;
    if (!rules.attributes) {
        return likeness;
    }
    likeness.assign(graph.GetInstanceCount(), 0);
    for (std::uint32_t row = 0; row < graph.GetInstanceCount(); ++row) {
        const Orn_Hdl::Instance& instance = *graph.GetInstances()[row].instance;
        const Orn_Hdl::Component* const component = instance.GetComponent();
        if (!instance.HasAttrs() &&
            (rules.hasExactAttributes || component == nullptr || !component->HasAttrs())) {
            continue;
        }
        for (const Attribute* attribute : ListEffective(instance, rules)) {
            likeness[row] = Mix(
                likeness[row], Mix(HashName(attribute->GetNameView()),
                                   HashName(rules.hasExactAttributes ? GetText(*attribute)
                                                                     : GetPlainValue(*attribute))));
        }
    }
    return likeness;
}

} // namespace Tool::Diff
