#include "Proof/Parameters.h"

#include "Port/Ascii.h"
#include "Proof/Meaning.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace Orn_Hdl::Proving {

using std::string_view;

namespace {

using Attributes = std::vector<const Attribute*>;

bool IsHidden(const Attribute& attribute) {
    return attribute.GetGenericOption() == Attribute::GenericNoSyn;
}

/// The attributes of an instance, then those of its component of other names.
void FindEffective(const Instance& instance, Attributes& attributes) {
    attributes.clear();
    const Component* const component = instance.GetComponent();
    if (instance.HasAttrs()) {
        for (const Attribute* attribute : instance.GetAttrIterator()) {
            attributes.push_back(attribute);
        }
    }
    if (component == nullptr || !component->HasAttrs()) {
        return;
    }
    const std::size_t own = attributes.size();
    for (const Attribute* attribute : component->GetAttrIterator()) {
        const auto end = attributes.begin() + static_cast<std::ptrdiff_t>(own);
        const bool isOverridden =
            std::any_of(attributes.begin(), end, [attribute](const Attribute* present) {
                return Port::EqualIgnoringCase(present->GetNameView(), attribute->GetNameView());
            });
        if (!isOverridden) {
            attributes.push_back(attribute);
        }
    }
}

/// The first attribute of the name INIT with that option; null when there is none.
const Attribute* FindInit(const Attributes& attributes, Attribute::GenericOption option) {
    const auto found =
        std::find_if(attributes.begin(), attributes.end(), [option](const Attribute* attribute) {
            return attribute->GetNameView() == "INIT" && attribute->GetGenericOption() == option;
        });
    return found == attributes.end() ? nullptr : *found;
}

const Attribute* FindInit(const Attributes& attributes) {
    const Attribute* const seen = FindInit(attributes, Attribute::GenericSyn);
    return seen != nullptr ? seen : FindInit(attributes, Attribute::GenericNoSyn);
}

bool HasSynthesisOption(const Attribute& attribute) {
    return attribute.GetSynAttrOption() != Attribute::SynAttrNone;
}

string_view Trim(string_view text) {
    const std::size_t first = std::min(text.find_first_not_of(" \t"), text.size());
    text.remove_prefix(first);
    return text.substr(0, text.find_last_not_of(" \t") + 1);
}

std::string Show(const Readers::Value& value) {
    constexpr std::size_t Longest = 60;
    return "\"" + value.text.substr(0, Longest) + (value.text.size() > Longest ? "...\"" : "\"");
}

} // namespace

std::string Parameters::Holder::GetName() const {
    return instance != nullptr    ? std::string(instance->GetNameView())
           : component != nullptr ? std::string(component->GetNameView())
                                  : "the module";
}

Parameters::Parameters(const Netlist& design, const HdlOptions& options, Language language,
                       Findings& findings)
    : design_(design), options_(options), language_(language), findings_(findings),
      moduleName_(design.GetNameView()) {
    Attributes attributes;
    for (const Attribute* attribute : design.GetAttrIterator()) {
        attributes.push_back(attribute);
    }
    ExpectParameters(attributes, ofModule_);
    // A module that models a cell of a certain library passes its contents on.
    if (moduleName_.find("MHALVEX") != std::string::npos ||
        (language == Language::Verilog && moduleName_.find("HHALVEX") != std::string::npos)) {
        passed_ = FindInit(attributes);
    }
}

/// What synthesis sees comes first.
void Parameters::ExpectParameters(const Attributes& attributes, Expected& expected) {
    expected.Clear();
    const Attribute* const init = passed_ != nullptr ? FindInit(attributes) : nullptr;
    if (init != nullptr) {
        expected.attributes.push_back(passed_);
    }
    for (const auto option : {Attribute::GenericSyn, Attribute::GenericNoSyn}) {
        for (const Attribute* attribute : attributes) {
            // In Verilog, simulation gets a hidden one, too.
            const bool isPassed = attribute == init &&
                                  (option == Attribute::GenericSyn || language_ == Language::Vhdl);
            if (attribute->GetGenericOption() == option && !isPassed) {
                expected.attributes.push_back(attribute);
            }
        }
    }
}

void Parameters::AddSignal(const Signal& signal) {
    if (!signal.HasAttrs() ||
        (language_ == Language::Verilog &&
         options_.verilog.synthesisType == HdlOptions::VerilogOption::VERILOG2001)) {
        return;
    }
    for (const Attribute* attribute : signal.GetAttrIterator()) {
        if (HasSynthesisOption(*attribute)) {
            ofSignals_.push_back({&signal, attribute});
        }
    }
}

void Parameters::BeginComponent(const Component& component, const Readers::ModuleHead& head,
                                const Readers::Place& place) {
    EndInstance(place);
    holder_ = {&component, nullptr};
    Attributes attributes;
    for (const Attribute* attribute : component.GetAttrIterator()) {
        attributes.push_back(attribute);
    }
    // A component passes nothing on.
    const Attribute* const passed = std::exchange(passed_, nullptr);
    ExpectParameters(attributes, ofHolder_);
    passed_ = passed;
    attributes_.Clear();
    std::copy_if(attributes.begin(), attributes.end(), std::back_inserter(attributes_.attributes),
                 [](const Attribute* attribute) { return HasSynthesisOption(*attribute); });
    for (const Readers::ParameterHead& parameter : head.parameters) {
        Take(ofHolder_, holder_, parameter.name, parameter.value.value_or(Readers::Value()),
             parameter.isHidden, place);
    }
}

void Parameters::BeginInstance(const Instance& instance) {
    holder_ = {nullptr, &instance};
    FindEffective(instance, effective_);
    if (effective_.empty() && ofHolder_.attributes.empty() && attributes_.attributes.empty()) {
        return;
    }
    ExpectParameters(effective_, ofHolder_);
    attributes_.Clear();
    if (language_ == Language::Vhdl ||
        options_.verilog.synthesisType == HdlOptions::VerilogOption::VERILOG2001) {
        return;
    }
    std::copy_if(effective_.begin(), effective_.end(), std::back_inserter(attributes_.attributes),
                 [](const Attribute* attribute) { return HasSynthesisOption(*attribute); });
}

/// What an instance has in common with its component is written with the component.
void Parameters::ExpectOfInstances() {
    hasOfInstances_ = true;
    for (const Instance* instance : design_.GetInstanceIterator()) {
        for (const Attribute* attribute : instance->GetAttrIterator()) {
            const Attribute* const shared = instance->GetComponentAttr(attribute->GetName().CStr());
            if (HasSynthesisOption(*attribute) && (shared == nullptr || *shared != *attribute)) {
                ofInstances_.push_back({instance, attribute});
            }
        }
    }
}

/// Whether an attribute has a name of the netlist. A reader leaves the mark of an escaped name out,
/// and in comments the blank that ends it.
bool Parameters::IsNamed(const Attribute& attribute, string_view name) const {
    const string_view own = attribute.GetNameView();
    return own == name || (language_ == Language::Verilog && !own.empty() && own.front() == '\\' &&
                           (NameInVerilog(own) == name || own.substr(0, own.find(' ')) == name));
}

Cause Parameters::CauseOf(const Holder& holder, const Attribute* attribute) const {
    const bool isModule = holder.instance == nullptr && holder.component == nullptr;
    const std::string name(attribute == nullptr ? string_view() : attribute->GetNameView());
    if (isModule || attribute == passed_) {
        return attribute == nullptr ? Cause{Kind::DesignName, "", ""}
                                    : Cause{Kind::ModuleAttribute, "", name};
    }
    const Component* const component =
        holder.instance != nullptr ? holder.instance->GetComponent() : holder.component;
    const bool isComponents =
        component != nullptr && (holder.instance == nullptr ||
                                 (attribute != nullptr && component->GetAttr(name) == attribute));
    if (isComponents) {
        return {attribute == nullptr ? Kind::Component : Kind::ComponentAttribute,
                std::string(component->GetNameView()), name};
    }
    return {attribute == nullptr ? Kind::Instance : Kind::InstanceAttribute, holder.GetName(),
            name};
}

Cause Parameters::CauseOf(const Signal& signal, const Attribute& attribute) const {
    return {Kind::SignalAttribute, std::string(signal.GetNameView()),
            std::string(attribute.GetNameView())};
}

void Parameters::Take(Expected& expected, const Holder& holder, const std::string& name,
                      const Readers::Value& value, bool isHidden, const Readers::Place& place) {
    const std::string what = "the parameter " + name + " of " + holder.GetName();
    const Attribute* const attribute = expected.TakeNext();
    const bool isPassed = attribute == passed_ && holder.instance != nullptr;
    if (attribute == nullptr) {
        findings_.Add(what + " is one that the design does not set there", place,
                      CauseOf(holder, nullptr));
    } else if (!IsNamed(*attribute, name)) {
        findings_.Add(what + " stands where the design has " +
                          std::string(attribute->GetNameView()),
                      place, CauseOf(holder, attribute));
    } else if ((IsHidden(*attribute) && !isPassed) != isHidden) {
        findings_.Add(
            what + (isHidden ? " is hidden from synthesis" : " is not hidden from synthesis") +
                ", unlike in the design",
            place, CauseOf(holder, attribute));
    } else if (!IsSameValue(*attribute, value, language_, options_.legal)) {
        findings_.Add(
            what + " has the value " + Show(value) + ", in the design " +
                Show({Attribute::String, std::string(attribute->GetValueString().GetView()), {}}),
            place, CauseOf(holder, attribute));
    }
}

void Parameters::TakeOfModule(const std::string& name, const Readers::Value& value, bool isHidden,
                              const Readers::Place& place) {
    Take(ofModule_, Holder(), name, value, isHidden, place);
}

void Parameters::TakeOfInstance(const std::string& name, const Readers::Value& value, bool isHidden,
                                const Readers::Place& place) {
    if (holder_.instance != nullptr) {
        Take(ofHolder_, holder_, name, value, isHidden, place);
    }
}

/// Comments hold texts as they are. In three dialects these have no quotes of their own, so that
/// blanks around them say nothing.
bool Parameters::IsSame(const Attribute& attribute, const Readers::Value& value) const {
    if (language_ == Language::Vhdl) {
        return options_.vhdl.useAttrType ? IsSameValue(attribute, value, language_, options_.legal)
                                         : IsSameText(attribute, value, language_, options_.legal);
    }
    const int dialect = options_.verilog.synthesisType;
    const bool isBare = dialect == HdlOptions::VerilogOption::EXEMPLAR ||
                        dialect == HdlOptions::VerilogOption::PRECISION ||
                        dialect == HdlOptions::VerilogOption::SYNPLICITY;
    return IsSameText(attribute, value, language_, false) ||
           (isBare && value.text == Trim(TextOf(attribute)));
}

void Parameters::CompareAttribute(const Holder& holder, const Attribute* attribute,
                                  const std::string& name, const Readers::Value& value,
                                  bool isDeclared, const Readers::Place& place) {
    const std::string what = "the attribute " + name + " of " + holder.GetName();
    if (attribute == nullptr) {
        findings_.Add(what + " is one that the design does not have there", place,
                      CauseOf(holder, nullptr));
    } else if (!IsNamed(*attribute, name)) {
        findings_.Add(what + " stands where the design has " +
                          std::string(attribute->GetNameView()),
                      place, CauseOf(holder, attribute));
    } else if (!IsSame(*attribute, value)) {
        findings_.Add(what + " is " + Show(value) + ", in the design " +
                          Show({Attribute::String, TextOf(*attribute), {}}),
                      place, CauseOf(holder, attribute));
    } else if (!isDeclared && attribute->GetSynAttrOption() == Attribute::SynAttrAssign) {
        findings_.Add(what + " is not declared", place, CauseOf(holder, attribute));
    }
}

void Parameters::TakeAttribute(const Readers::Owner& owner, const std::string& name,
                               const Readers::Value& value, bool isDeclared,
                               const Readers::Place& place) {
    if (owner.kind == Readers::Owner::Component &&
        (holder_.component == nullptr || holder_.component->GetNameView() != owner.name)) {
        findings_.Add("the attribute " + name + " of " + std::string(owner.name) +
                          " does not follow that component",
                      place, {});
        return;
    }
    if (owner.kind == Readers::Owner::Component || language_ == Language::Verilog) {
        if (holder_.component != nullptr || holder_.instance != nullptr) {
            CompareAttribute(holder_, attributes_.TakeNext(), name, value, isDeclared, place);
        }
        return;
    }
    if (!hasOfInstances_) {
        ExpectOfInstances();
    }
    const OfInstance* const next =
        readOfInstances_ < ofInstances_.size() ? &ofInstances_[readOfInstances_++] : nullptr;
    if (next == nullptr || next->instance->GetNameView() != owner.name) {
        findings_.Add(
            "the attribute " + name + " of " + std::string(owner.name) +
                " is one that the design does not have there",
            place, next == nullptr ? Cause() : CauseOf({nullptr, next->instance}, next->attribute));
        return;
    }
    CompareAttribute({nullptr, next->instance}, next->attribute, name, value, isDeclared, place);
}

void Parameters::TakeAttribute(const Signal& signal, const std::string& name,
                               const Readers::Value& value, bool isDeclared,
                               const Readers::Place& place) {
    const std::string what = "the attribute " + name + " of " + std::string(signal.GetNameView());
    if (readOfSignals_ == ofSignals_.size()) {
        findings_.Add(what + " is one that the design does not have there", place,
                      {Kind::Signal, std::string(signal.GetNameView()), ""});
        return;
    }
    const OfSignal& expected = ofSignals_[readOfSignals_++];
    const Attribute& attribute = *expected.attribute;
    if (expected.signal != &signal || !IsNamed(attribute, name)) {
        findings_.Add(what + " stands where the design has " +
                          std::string(attribute.GetNameView()) + " of " +
                          std::string(expected.signal->GetNameView()),
                      place, CauseOf(*expected.signal, attribute));
    } else if (!IsSame(attribute, value)) {
        findings_.Add(what + " is " + Show(value) + ", in the design " +
                          Show({Attribute::String, TextOf(attribute), {}}),
                      place, CauseOf(signal, attribute));
    } else if (!isDeclared && attribute.GetSynAttrOption() == Attribute::SynAttrAssign) {
        findings_.Add(what + " is not declared", place, CauseOf(signal, attribute));
    }
}

void Parameters::ReportLeft(const Expected& expected, const Holder& holder, const char* what,
                            const Readers::Place& place) {
    if (expected.read < expected.attributes.size()) {
        const Attribute* const attribute = expected.attributes[expected.read];
        findings_.Add(std::string("the ") + what + " " + std::string(attribute->GetNameView()) +
                          " of " + holder.GetName() + " is not in the netlist",
                      place, CauseOf(holder, attribute));
    }
}

void Parameters::EndInstance(const Readers::Place& place) {
    if (holder_.instance == nullptr && holder_.component == nullptr) {
        return;
    }
    ReportLeft(attributes_, holder_, "attribute", place);
    ReportLeft(ofHolder_, holder_, "parameter", place);
    attributes_.read = attributes_.attributes.size();
    ofHolder_.read = ofHolder_.attributes.size();
    holder_ = Holder();
}

void Parameters::End(const Readers::Place& place) {
    EndInstance(place);
    ReportLeft(ofModule_, Holder(), "parameter", place);
    if (readOfSignals_ < ofSignals_.size()) {
        const OfSignal& expected = ofSignals_[readOfSignals_];
        findings_.Add("the attribute " + std::string(expected.attribute->GetNameView()) + " of " +
                          std::string(expected.signal->GetNameView()) + " is not in the netlist",
                      place, CauseOf(*expected.signal, *expected.attribute));
    }
    if (language_ == Language::Vhdl && !hasOfInstances_) {
        ExpectOfInstances();
    }
    if (readOfInstances_ < ofInstances_.size()) {
        const OfInstance& expected = ofInstances_[readOfInstances_];
        const Holder holder{nullptr, expected.instance};
        findings_.Add("the attribute " + std::string(expected.attribute->GetNameView()) + " of " +
                          holder.GetName() + " is not in the netlist",
                      place, CauseOf(holder, expected.attribute));
    }
}

} // namespace Orn_Hdl::Proving
