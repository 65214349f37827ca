// Attributes and generics: their names, declarations, types and values.

#include "Check/AttributeValues.h"
#include "Check/Context.h"
#include "Check/NameCheck.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/Primitives.h"
#include "Port/Ascii.h"
#include "Writers/Generics.h"
#include "Writers/Text.h"

#include <algorithm>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

/// Attributes of the language, which no design can declare.
constexpr string_view PredefinedAttributes[] = {
    "active",     "ascending",   "base",   "delayed", "driving",       "driving_value",
    "element",    "event",       "high",   "image",   "instance_name", "last_active",
    "last_event", "last_value",  "left",   "leftof",  "length",        "low",
    "path_name",  "pos",         "pred",   "quiet",   "reverse_range", "right",
    "rightof",    "simple_name", "stable", "subtype", "succ",          "transaction",
    "val",        "value"};

bool IsPredefined(string_view name) {
    return std::find(std::begin(PredefinedAttributes), std::end(PredefinedAttributes), name) !=
           std::end(PredefinedAttributes);
}

/// The declaration that VHDL gets for the attributes of one name.
struct Declaration {
    std::string type;
    Cause cause;
    bool isDeclared = false;
};

class AttributeWalk {
public:
    explicit AttributeWalk(Context& context);

    void CheckAll();

private:
    void CheckModule();
    void CheckSignals(bool ports);
    void DeclareAll(const Holder& holder);
    void DeclareOfInstances();
    void CheckComponents();
    void CheckInstances();
    void CheckHolder(const Holder& holder);
    bool IsHidden(const Holder& component, const Attribute& attribute);
    void NoteGeneric(const Holder& holder, const Attribute& attribute);
    void CheckGenericMap(const Instance& instance);
    void CheckAgainstPins(const Holder& holder, const Instance& instance,
                          const Attribute& attribute);
    void CheckNamesOf(const Holder& holder, const Attribute& attribute);
    void Declare(const Holder& holder, const Attribute& attribute);
    void CheckDeclared(const Holder& holder, const Attribute& attribute);
    bool IsDeclaredBy(const Holder& holder, const Attribute& attribute) const;
    void CheckValueIn(const Holder& holder, const Attribute& attribute, Places places) const;
    Places PlacesOf(const Attribute& attribute) const;
    Finding* Add(RuleId rule, const Verdicts& verdicts, const Holder& holder,
                 const Attribute& attribute) {
        return AddFinding(context_, rule, verdicts, holder, attribute);
    }

    Context& context_;
    const bool isTyped_;
    const bool isInBlockComment_;
    std::unordered_map<std::string, Declaration> declarations_;
    std::unordered_set<std::string> checkedNames_;
    /// Made when it is first asked for.
    std::unordered_map<const Component*, std::vector<const Instance*>> instancesOf_;
    bool hasHidden_ = false;
};

AttributeWalk::AttributeWalk(Context& context)
    : context_(context), isTyped_(context.options.vhdl.useAttrType),
      isInBlockComment_(
          context.options.verilog.synthesisType == HdlOptions::VerilogOption::SYNPLICITY ||
          context.options.verilog.synthesisType == HdlOptions::VerilogOption::SYNOPSYS) {}

void AttributeWalk::CheckAll() {
    CheckModule();
    CheckSignals(true);
    CheckSignals(false);
    CheckComponents();
    CheckInstances();
    for (auto& [name, declaration] : declarations_) {
        if (declaration.isDeclared) {
            context_.declaredAttributes.emplace(name, declaration.cause);
        }
    }
}

/// The module's attributes are written when they are generics, and only then.
void AttributeWalk::CheckModule() {
    const Holder holder = {&context_.netlist, &context_.netlist, Kind::ModuleAttribute};
    for (const Attribute* attribute : context_.netlist.GetAttrIterator()) {
        if (!IsGeneric(*attribute)) {
            continue;
        }
        CheckNamesOf(holder, *attribute);
        CheckValueIn(holder, *attribute, {true, false, true, true});
        NoteGeneric(holder, *attribute);
    }
}

/// Ports declare their attributes one after the other, so their order decides what is declared.
void AttributeWalk::CheckSignals(bool ports) {
    std::vector<const Signal*> signals;
    for (const Signal* signal : context_.survey.GetSignals()) {
        if (signal->HasAttrs() && signal->IsNeededToDeclared() && signal->IsPort() == ports &&
            !Writers::IsOpen(signal->GetNameView())) {
            signals.push_back(signal);
        }
    }
    std::stable_sort(signals.begin(), signals.end(), [](const Signal* a, const Signal* b) {
        const int ofA = a->GetPortPolarity().GetValue();
        const int ofB = b->GetPortPolarity().GetValue();
        return ofA != ofB ? ofA < ofB
                          : Names::CompareNatural(a->GetNameView(), b->GetNameView()) < 0;
    });
    if (!ports) {
        // The architecture declares all before it gives the first value.
        for (const Signal* signal : signals) {
            for (const Attribute* attribute : signal->GetAttrIterator()) {
                Declare({signal, signal, Kind::SignalAttribute}, *attribute);
            }
        }
        DeclareOfInstances();
    }
    for (const Signal* signal : signals) {
        const Holder holder = {signal, signal, Kind::SignalAttribute};
        for (const Attribute* attribute : signal->GetAttrIterator()) {
            if (ports) {
                Declare(holder, *attribute);
            }
        }
        for (const Attribute* attribute : signal->GetAttrIterator()) {
            if (IsSynthesis(*attribute)) {
                CheckNamesOf(holder, *attribute);
                CheckDeclared(holder, *attribute);
                CheckValueIn(holder, *attribute, {false, isInBlockComment_, true, isTyped_});
            }
        }
    }
}

void AttributeWalk::DeclareAll(const Holder& holder) {
    for (const Attribute* attribute : holder.attributes->GetAttrIterator()) {
        Declare(holder, *attribute);
    }
}

/// In the order of the instances' names, each component with its first instance. The order tells
/// which type is declared, and matters only where types do.
void AttributeWalk::DeclareOfInstances() {
    std::vector<const Instance*> instances;
    for (const Instance* instance : context_.survey.GetInstances()) {
        const Component* const component = instance->GetComponent();
        if (instance->HasAttrs() || (component != nullptr && component->HasAttrs())) {
            instances.push_back(instance);
        }
    }
    if (isTyped_) {
        std::stable_sort(instances.begin(), instances.end(),
                         [](const Instance* a, const Instance* b) {
                             return Names::CompareNatural(a->GetNameView(), b->GetNameView()) < 0;
                         });
    }
    std::unordered_set<const Component*> met;
    for (const Instance* instance : instances) {
        const Component* const component = instance->GetComponent();
        if (component != nullptr && met.insert(component).second) {
            DeclareAll({component, component, Kind::ComponentAttribute});
        }
        DeclareAll({instance, instance, Kind::InstanceAttribute});
    }
}

void AttributeWalk::CheckComponents() {
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        if (context_.used.count(component) == 0) {
            continue;
        }
        CheckHolder({component, component, Kind::ComponentAttribute});
        if (IsPrimitive(*component) && component->GetAttr("BOX_TYPE") == nullptr) {
            // The VHDL writer gives it this attribute.
            Declaration& declaration = declarations_["box_type"];
            if (!declaration.isDeclared) {
                declaration = {"string",
                               Named(Kind::ComponentAttribute, component->GetNameView(), "LEVEL"),
                               true};
                context_.usedTypes.insert("string");
            }
        }
    }
}

void AttributeWalk::CheckInstances() {
    for (const Instance* instance : context_.survey.GetInstances()) {
        if (instance->HasAttrs()) {
            CheckHolder({instance, instance, Kind::InstanceAttribute});
            CheckGenericMap(*instance);
        }
    }
}

Places AttributeWalk::PlacesOf(const Attribute& attribute) const {
    const bool isSynthesis = IsSynthesis(attribute);
    const bool isGeneric = IsGeneric(attribute);
    return {isGeneric, isSynthesis && isInBlockComment_, isSynthesis || isGeneric,
            isGeneric || isTyped_};
}

void AttributeWalk::CheckHolder(const Holder& holder) {
    for (const Attribute* attribute : holder.attributes->GetAttrIterator()) {
        if (!IsSynthesis(*attribute) && !IsGeneric(*attribute)) {
            continue;
        }
        CheckNamesOf(holder, *attribute);
        if (IsSynthesis(*attribute)) {
            CheckDeclared(holder, *attribute);
        }
        Places places = PlacesOf(*attribute);
        if (holder.kind == Kind::ComponentAttribute && IsHidden(holder, *attribute)) {
            places.verilogNumber = places.verilogComment = false;
        }
        NoteGeneric(holder, *attribute);
        CheckValueIn(holder, *attribute, places);
        if (places.verilogNumber && IsSynthesis(*attribute) && !isTyped_ &&
            attribute->GetValueType() != Attribute::String) {
            // The same value is a string elsewhere.
            places = {false, isInBlockComment_, true, false};
            CheckValueIn(holder, *attribute, places);
        }
    }
}

/// Whether each instance of the component has an attribute of that name in its place. Verilog has
/// parameters of instances only.
bool AttributeWalk::IsHidden(const Holder& component, const Attribute& attribute) {
    const auto* const used = static_cast<const Component*>(component.object);
    if (context_.used.at(used).hasPlainInstance) {
        return false;
    }
    if (instancesOf_.empty()) {
        for (const Instance* instance : context_.survey.GetInstances()) {
            instancesOf_[instance->GetComponent()].push_back(instance);
        }
    }
    const std::vector<const Instance*>& instances = instancesOf_[used];
    return std::all_of(instances.begin(), instances.end(), [&](const Instance* instance) {
        return instance->GetAttr(attribute.GetName().CStr()) != nullptr;
    });
}

/// Tells of the first generic that is kept from synthesis, and of numbers that Yosys cannot hold.
void AttributeWalk::NoteGeneric(const Holder& holder, const Attribute& attribute) {
    if (attribute.GetGenericOption() == Attribute::GenericNoSyn && !hasHidden_) {
        hasHidden_ = true;
        if (Finding* finding = Add(RuleId::HiddenGeneric, GetRule(RuleId::HiddenGeneric).verdicts,
                                   holder, attribute)) {
            finding->message = holder.Describe(attribute) + " is kept from synthesis";
        }
    }
    const bool isOfModule = holder.kind == Kind::ModuleAttribute;
    if (IsGeneric(attribute) && attribute.GetValueType() == Attribute::Float && !isOfModule) {
        if (Finding* finding = Add(RuleId::FloatGeneric, GetRule(RuleId::FloatGeneric).verdicts,
                                   holder, attribute)) {
            finding->message =
                holder.Describe(attribute) + " is a number that Yosys takes for a text";
        }
    }
}

/// The instance's own generics must be the component's.
void AttributeWalk::CheckGenericMap(const Instance& instance) {
    const Holder holder = {&instance, &instance, Kind::InstanceAttribute};
    for (const Attribute* attribute : instance.GetAttrIterator()) {
        if (!IsGeneric(*attribute)) {
            continue;
        }
        CheckAgainstPins(holder, instance, *attribute);
        const Attribute* const formal = instance.GetComponentAttr(attribute->GetName().CStr());
        if (formal == nullptr || !IsGeneric(*formal)) {
            if (Finding* finding =
                    Add(RuleId::UndeclaredGeneric, GetRule(RuleId::UndeclaredGeneric).verdicts,
                        holder, *attribute)) {
                finding->message = holder.Describe(*attribute) +
                                   " is a generic that the component " +
                                   Quoted(instance.GetComponentName().GetView()) + " has not";
            }
        } else if (TypeOf(*formal) != TypeOf(*attribute)) {
            if (Finding* finding = Add(RuleId::GenericType, GetRule(RuleId::GenericType).verdicts,
                                       holder, *attribute)) {
                finding->message = holder.Describe(*attribute) + " has the type " +
                                   TypeOf(*attribute) + ", the component's has " + TypeOf(*formal);
                finding->other =
                    Named(Kind::ComponentAttribute, instance.GetComponentName().GetView(),
                          attribute->GetNameView());
            }
        }
    }
}

/// The cell can have no parameter of the name of a port.
void AttributeWalk::CheckAgainstPins(const Holder& holder, const Instance& instance,
                                     const Attribute& attribute) {
    for (const Pin* pin : instance.GetPinIterator()) {
        if (Writers::GetBaseName(*pin) != attribute.GetNameView()) {
            continue;
        }
        if (Finding* finding = Add(RuleId::NameClash, Verdicts("rrr..rr"), holder, attribute)) {
            finding->message = holder.Describe(attribute) + " and the pin " +
                               Quoted(pin->GetNameView()) + " bear one name";
        }
    }
}

/// Each name once for each way in which it is written.
void AttributeWalk::CheckNamesOf(const Holder& holder, const Attribute& attribute) {
    const bool isGeneric = IsGeneric(attribute);
    const bool isSynthesis = IsSynthesis(attribute) && holder.kind != Kind::ModuleAttribute;
    std::string key(attribute.GetNameView());
    const bool isHidden = attribute.GetGenericOption() == Attribute::GenericNoSyn;
    key.push_back(isHidden ? 'h' : isGeneric ? 'g' : '-');
    key.push_back(isSynthesis ? 's' : '-');
    if (!checkedNames_.insert(std::move(key)).second) {
        return;
    }
    NameUse use;
    use.name = attribute.GetNameView();
    use.what = "an attribute";
    use.kind = holder.kind;
    const Cause cause = holder.CauseOf(attribute);
    use.first = cause.first;
    use.second = cause.second;
    use.object = &attribute;
    use.isInVerilog = isGeneric;
    use.isHiddenFromYosys = isHidden;
    CheckName(context_, use);
    if (isSynthesis && IsPredefined(Lower(attribute.GetNameView()))) {
        if (Finding* finding =
                Add(RuleId::PredefinedAttribute, GetRule(RuleId::PredefinedAttribute).verdicts,
                    holder, attribute)) {
            finding->message =
                Quoted(attribute.GetNameView()) + " is a predefined attribute of VHDL";
        }
    }
}

/// The first attribute of a name that asks for it is declared, with its type.
void AttributeWalk::Declare(const Holder& holder, const Attribute& attribute) {
    if (attribute.GetSynAttrOption() != Attribute::SynAttrAssign) {
        return;
    }
    Declaration& declaration = declarations_[Lower(attribute.GetNameView())];
    if (!declaration.isDeclared) {
        declaration.isDeclared = true;
        declaration.type = isTyped_ ? TypeOf(attribute) : "string";
        declaration.cause = holder.CauseOf(attribute);
        context_.usedTypes.insert(declaration.type);
    }
}

/// Whether the attribute's value can be one of the declared type: a value of a user type is written
/// as it is.
bool FitsType(const Attribute& attribute, const std::string& type) {
    if (attribute.GetValueType() != Attribute::User) {
        return TypeOf(attribute) == type;
    }
    return TypeOf(attribute) == type || !IsVisibleType(type) ||
           CanBeValueOf(type, attribute.GetValueString().GetView());
}

void AttributeWalk::CheckDeclared(const Holder& holder, const Attribute& attribute) {
    const auto found = declarations_.find(Lower(attribute.GetNameView()));
    if (found == declarations_.end() || !found->second.isDeclared) {
        const bool mayBeDeclared = context_.options.vhdl.useClauses.GetSize() > 0;
        if (Finding* finding =
                Add(RuleId::UndeclaredAttribute,
                    Verdicts(mayBeDeclared ? "...ww...w" : "...rr...r"), holder, attribute)) {
            finding->message = holder.Describe(attribute) + " is not declared before its use";
        }
    } else if (isTyped_ && !FitsType(attribute, found->second.type)) {
        if (Finding* finding = Add(RuleId::AttributeTypes, GetRule(RuleId::AttributeTypes).verdicts,
                                   holder, attribute)) {
            finding->message = holder.Describe(attribute) + " has the type " + TypeOf(attribute) +
                               ", but is declared with the type " + found->second.type;
            finding->other = found->second.cause;
        }
    }
}

/// Whether the attribute is the one that declares its name, with its type.
bool AttributeWalk::IsDeclaredBy(const Holder& holder, const Attribute& attribute) const {
    const auto found = declarations_.find(Lower(attribute.GetNameView()));
    return found != declarations_.end() && found->second.isDeclared &&
           found->second.cause.kind == holder.kind &&
           found->second.cause.first == holder.CauseOf(attribute).first;
}

void AttributeWalk::CheckValueIn(const Holder& holder, const Attribute& attribute,
                                 Places places) const {
    places.bound = attribute.GetValueType() == Attribute::User &&
                   (IsGeneric(attribute) || IsDeclaredBy(holder, attribute));
    CheckValue(context_, holder, attribute, places);
}

} // namespace

void CheckAttributes(Context& context) {
    AttributeWalk(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
