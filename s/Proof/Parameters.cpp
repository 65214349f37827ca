#include "Proof/Parameters.h"

#include "Port/Ascii.h"
#include "Proof/Meaning.h"

#include <algorithm>

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

Parameters::Parameters(const Netlist& design, const HdlOptions& options, Findings& findings)
    : options_(options), findings_(findings), moduleName_(design.GetNameView()) {
    Attributes attributes;
    for (const Attribute* attribute : design.GetAttrIterator()) {
        attributes.push_back(attribute);
    }
    ExpectParameters(attributes, ofModule_);
    // A module that models a cell of a certain library passes its contents on.
    if (moduleName_.find("MHALVEX") != std::string::npos ||
        moduleName_.find("HHALVEX") != std::string::npos) {
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
            const bool isPassed = attribute == init && option == Attribute::GenericSyn;
            if (attribute->GetGenericOption() == option && !isPassed) {
                expected.attributes.push_back(attribute);
            }
        }
    }
}

void Parameters::AddSignal(const Signal& signal) {
    if (!signal.HasAttrs() ||
        options_.verilog.synthesisType == HdlOptions::VerilogOption::VERILOG2001) {
        return;
    }
    for (const Attribute* attribute : signal.GetAttrIterator()) {
        if (attribute->GetSynAttrOption() != Attribute::SynAttrNone) {
            ofSignals_.push_back({&signal, attribute});
        }
    }
}

void Parameters::BeginInstance(const Instance& instance) {
    instance_ = &instance;
    FindEffective(instance, effective_);
    if (effective_.empty() && ofInstance_.attributes.empty() && attributes_.attributes.empty()) {
        return;
    }
    ExpectParameters(effective_, ofInstance_);
    attributes_.Clear();
    for (const Attribute* attribute : effective_) {
        if (attribute->GetSynAttrOption() != Attribute::SynAttrNone &&
            options_.verilog.synthesisType != HdlOptions::VerilogOption::VERILOG2001) {
            attributes_.attributes.push_back(attribute);
        }
    }
}

Cause Parameters::CauseOf(const Instance* instance, const Attribute* attribute) const {
    if (attribute == nullptr) {
        return instance == nullptr
                   ? Cause{Kind::DesignName, "", ""}
                   : Cause{Kind::Instance, std::string(instance->GetNameView()), ""};
    }
    const std::string name(attribute->GetNameView());
    if (instance == nullptr || attribute == passed_) {
        return {Kind::ModuleAttribute, "", name};
    }
    const Component* const component = instance->GetComponent();
    if (component != nullptr && component->GetAttr(name) == attribute) {
        return {Kind::ComponentAttribute, std::string(component->GetNameView()), name};
    }
    return {Kind::InstanceAttribute, std::string(instance->GetNameView()), name};
}

Cause Parameters::CauseOf(const Signal& signal, const Attribute& attribute) const {
    return {Kind::SignalAttribute, std::string(signal.GetNameView()),
            std::string(attribute.GetNameView())};
}

void Parameters::Take(Expected& expected, const Instance* instance, const std::string& name,
                      const Readers::Value& value, bool isHidden, const Readers::Place& place) {
    const std::string owner =
        instance == nullptr ? "the module" : std::string(instance->GetNameView());
    const std::string what = "the parameter " + name + " of " + owner;
    const Attribute* const attribute = expected.TakeNext();
    if (attribute == nullptr) {
        findings_.Add(what + " is one that the design does not set there", place,
                      CauseOf(instance, nullptr));
    } else if (attribute->GetNameView() != name) {
        findings_.Add(what + " stands where the design has " +
                          std::string(attribute->GetNameView()),
                      place, CauseOf(instance, attribute));
    } else if ((IsHidden(*attribute) && !(attribute == passed_ && instance != nullptr)) !=
               isHidden) {
        findings_.Add(
            what + (isHidden ? " is hidden from synthesis" : " is not hidden from synthesis") +
                ", unlike in the design",
            place, CauseOf(instance, attribute));
    } else if (!IsSameInVerilog(*attribute, value, options_.legal)) {
        findings_.Add(
            what + " has the value " + Show(value) + ", in the design " +
                Show({Attribute::String, std::string(attribute->GetValueString().GetView())}),
            place, CauseOf(instance, attribute));
    }
}

void Parameters::TakeOfModule(const std::string& name, const Readers::Value& value, bool isHidden,
                              const Readers::Place& place) {
    Take(ofModule_, nullptr, name, value, isHidden, place);
}

void Parameters::TakeOfInstance(const std::string& name, const Readers::Value& value, bool isHidden,
                                const Readers::Place& place) {
    if (instance_ != nullptr) {
        Take(ofInstance_, instance_, name, value, isHidden, place);
    }
}

/// In three dialects the text has no quotes of its own, so that blanks around it say nothing.
bool Parameters::IsSameText(const Attribute& attribute, const Readers::Value& value) const {
    const std::string text = TextOf(attribute);
    const int dialect = options_.verilog.synthesisType;
    const bool isBare = dialect == HdlOptions::VerilogOption::EXEMPLAR ||
                        dialect == HdlOptions::VerilogOption::PRECISION ||
                        dialect == HdlOptions::VerilogOption::SYNPLICITY;
    return (value.type == Attribute::String && value.text == text) ||
           (isBare && value.text == Trim(text));
}

void Parameters::TakeAttribute(const std::string& name, const Readers::Value& value,
                               const Readers::Place& place) {
    if (instance_ == nullptr) {
        return;
    }
    const std::string what =
        "the attribute " + name + " of " + std::string(instance_->GetNameView());
    const Attribute* const attribute = attributes_.TakeNext();
    if (attribute == nullptr) {
        findings_.Add(what + " is one that the design does not have there", place,
                      CauseOf(instance_, nullptr));
    } else if (attribute->GetNameView() != name) {
        findings_.Add(what + " stands where the design has " +
                          std::string(attribute->GetNameView()),
                      place, CauseOf(instance_, attribute));
    } else if (!IsSameText(*attribute, value)) {
        findings_.Add(what + " is " + Show(value) + ", in the design " +
                          Show({Attribute::String, TextOf(*attribute)}),
                      place, CauseOf(instance_, attribute));
    }
}

void Parameters::TakeAttribute(const Signal& signal, const std::string& name,
                               const Readers::Value& value, const Readers::Place& place) {
    const std::string what = "the attribute " + name + " of " + std::string(signal.GetNameView());
    if (readOfSignals_ == ofSignals_.size()) {
        findings_.Add(what + " is one that the design does not have there", place,
                      {Kind::Signal, std::string(signal.GetNameView()), ""});
        return;
    }
    const OfSignal& expected = ofSignals_[readOfSignals_++];
    if (expected.signal != &signal || expected.attribute->GetNameView() != name) {
        findings_.Add(what + " stands where the design has " +
                          std::string(expected.attribute->GetNameView()) + " of " +
                          std::string(expected.signal->GetNameView()),
                      place, CauseOf(*expected.signal, *expected.attribute));
    } else if (!IsSameText(*expected.attribute, value)) {
        findings_.Add(what + " is " + Show(value) + ", in the design " +
                          Show({Attribute::String, TextOf(*expected.attribute)}),
                      place, CauseOf(signal, *expected.attribute));
    }
}

void Parameters::ReportLeft(const Expected& expected, const char* what,
                            const Readers::Place& place) {
    if (expected.read < expected.attributes.size()) {
        const Attribute* const attribute = expected.attributes[expected.read];
        const bool isModules = &expected == &ofModule_;
        findings_.Add(std::string("the ") + what + " " + std::string(attribute->GetNameView()) +
                          " of " +
                          (isModules ? "the module" : std::string(instance_->GetNameView())) +
                          " is not in the netlist",
                      place, CauseOf(isModules ? nullptr : instance_, attribute));
    }
}

void Parameters::EndInstance(const Readers::Place& place) {
    if (instance_ != nullptr) {
        ReportLeft(attributes_, "attribute", place);
        ReportLeft(ofInstance_, "parameter", place);
        attributes_.read = attributes_.attributes.size();
        ofInstance_.read = ofInstance_.attributes.size();
    }
}

void Parameters::End(const Readers::Place& place) {
    ReportLeft(ofModule_, "parameter", place);
    if (readOfSignals_ < ofSignals_.size()) {
        const OfSignal& expected = ofSignals_[readOfSignals_];
        findings_.Add("the attribute " + std::string(expected.attribute->GetNameView()) + " of " +
                          std::string(expected.signal->GetNameView()) + " is not in the netlist",
                      place, CauseOf(*expected.signal, *expected.attribute));
    }
}

} // namespace Orn_Hdl::Proving
