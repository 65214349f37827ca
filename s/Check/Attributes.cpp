// Attributes and generics: their names, declarations, types and values.

#include "Check/Context.h"
#include "Check/Digits.h"
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

bool IsGeneric(const Attribute& attribute) {
    return attribute.GetGenericOption() != Attribute::GenericNone;
}

bool IsSynthesis(const Attribute& attribute) {
    return attribute.GetSynAttrOption() != Attribute::SynAttrNone;
}

/// The name of the attribute's type in VHDL, in small letters.
std::string TypeOf(const Attribute& attribute) {
    switch (attribute.GetValueType()) {
    case Attribute::Integer:
        return "integer";
    case Attribute::Float:
        return "real";
    case Attribute::Boolean:
        return "boolean";
    case Attribute::Bit:
        return "bit";
    case Attribute::BitVector:
        return "bit_vector";
    case Attribute::User:
        return Lower(static_cast<const AttributeUser&>(attribute).GetUserType().GetView());
    default:
        return "string";
    }
}

template <std::size_t N> bool IsOneOf(const string_view (&words)[N], string_view word) {
    return std::find(std::begin(words), std::end(words), word) != std::end(words);
}

/// Types that every netlist can see.
constexpr string_view VisibleTypes[] = {"bit",
                                        "bit_vector",
                                        "boolean",
                                        "character",
                                        "integer",
                                        "natural",
                                        "positive",
                                        "real",
                                        "signed",
                                        "std_logic",
                                        "std_logic_vector",
                                        "std_ulogic",
                                        "string",
                                        "time",
                                        "std_ulogic_vector",
                                        "unsigned",
                                        "severity_level",
                                        "x01",
                                        "x01z",
                                        "ux01",
                                        "ux01z",
                                        "delay_length"};

/// Attributes of the language, which no design can declare.
constexpr string_view PredefinedAttributes[] = {
    "active",     "ascending",   "base",   "delayed", "driving",       "driving_value",
    "element",    "event",       "high",   "image",   "instance_name", "last_active",
    "last_event", "last_value",  "left",   "leftof",  "length",        "low",
    "path_name",  "pos",         "pred",   "quiet",   "reverse_range", "right",
    "rightof",    "simple_name", "stable", "subtype", "succ",          "transaction",
    "val",        "value"};

bool IsNumber(string_view text, bool isReal) {
    if (!text.empty() && (text.front() == '-' || text.front() == '+')) {
        text.remove_prefix(1);
    }
    const bool hasPoint = text.find('.') != string_view::npos;
    return !text.empty() && Port::IsDigit(text.front()) && Port::IsDigit(text.back()) &&
           hasPoint == isReal && std::all_of(text.begin(), text.end(), [](char c) {
               return Port::IsDigit(c) || c == '.';
           });
}

bool IsQuotedBy(string_view text, char quote) {
    return text.size() >= 2 && text.front() == quote && text.back() == quote;
}

/// Whether a text can be a value of one of the visible types; of other types any text can.
bool CanBeValueOf(string_view type, string_view text) {
    if (type == "integer") {
        return IsNumber(text, false);
    }
    if (type == "natural" || type == "positive") {
        return IsNumber(text, false) && text.front() != '-' && (type == "natural" || text != "0");
    }
    if (type == "real") {
        return IsNumber(text, true);
    }
    if (type == "boolean") {
        return Port::EqualIgnoringCase(text, "true") || Port::EqualIgnoringCase(text, "false");
    }
    if (type == "bit") {
        return text == "'0'" || text == "'1'";
    }
    if (type == "std_logic" || type == "std_ulogic" || type == "character") {
        return text.size() == 3 && IsQuotedBy(text, '\'');
    }
    if (type == "string" || type == "bit_vector" || type == "std_logic_vector") {
        return text.empty() || (IsQuotedBy(text, '"') &&
                                text.substr(1, text.size() - 2).find('"') == string_view::npos);
    }
    return !text.empty();
}

/// Where the value of an attribute is written.
struct Places {
    bool verilogNumber = false;
    bool verilogComment = false;
    bool vhdl = false;
    /// Whether VHDL gets a literal of the type, otherwise a string.
    bool typed = false;
};

/// Who holds an attribute.
struct Holder {
    const AttributeHolder* attributes = nullptr;
    const Object* object = nullptr;
    Kind kind = Kind::ModuleAttribute;

    string_view GetName() const {
        return kind == Kind::ModuleAttribute   ? string_view()
               : kind == Kind::SignalAttribute ? Names::BaseName(object->GetNameView())
                                               : object->GetNameView();
    }
    Cause CauseOf(const Attribute& attribute) const {
        return Named(kind, kind == Kind::ModuleAttribute ? string_view() : object->GetNameView(),
                     attribute.GetNameView());
    }
    std::string Describe(const Attribute& attribute) const {
        std::string text = "the attribute " + Quoted(attribute.GetNameView()) + " of ";
        return text += kind == Kind::ModuleAttribute ? "the design" : Quoted(GetName());
    }
};

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
    bool IsHidden(const Holder& component, const Attribute& attribute) const;
    void NoteGeneric(const Holder& holder, const Attribute& attribute);
    void CheckGenericMap(const Instance& instance);
    void CheckAgainstPins(const Holder& holder, const Instance& instance,
                          const Attribute& attribute);
    void CheckNamesOf(const Holder& holder, const Attribute& attribute);
    void Declare(const Holder& holder, const Attribute& attribute);
    void CheckDeclared(const Holder& holder, const Attribute& attribute);
    bool IsDeclaredBy(const Holder& holder, const Attribute& attribute) const;
    void CheckValue(const Holder& holder, const Attribute& attribute, const Places& places);
    void CheckText(const Holder& holder, const Attribute& attribute, string_view text,
                   const Places& places);
    void CheckDigits(const Holder& holder, const Attribute& attribute, const Places& places);
    void CheckUser(const Holder& holder, const Attribute& attribute);
    Places PlacesOf(const Attribute& attribute) const;
    Finding* Add(RuleId rule, const Verdicts& verdicts, const Holder& holder,
                 const Attribute& attribute);

    Context& context_;
    const bool isTyped_;
    const bool isInBlockComment_;
    std::unordered_map<std::string, Declaration> declarations_;
    std::unordered_set<std::string> checkedNames_;
    bool hasHidden_ = false;
};

AttributeWalk::AttributeWalk(Context& context)
    : context_(context), isTyped_(context.options.vhdl.useAttrType),
      isInBlockComment_(
          context.options.verilog.synthesisType == HdlOptions::VerilogOption::SYNPLICITY ||
          context.options.verilog.synthesisType == HdlOptions::VerilogOption::SYNOPSYS) {}

Finding* AttributeWalk::Add(RuleId rule, const Verdicts& verdicts, const Holder& holder,
                            const Attribute& attribute) {
    Verdicts counted = verdicts;
    if (attribute.GetGenericOption() == Attribute::GenericNoSyn && rule != RuleId::CommentInValue &&
        rule != RuleId::HiddenGeneric) {
        // Yosys does not read what is kept from synthesis.
        counted.Set(Check::Target::Yosys, Check::Verdict::Accepts);
    }
    Finding* const finding = context_.Add(rule, counted, holder.CauseOf(attribute));
    if (finding != nullptr) {
        finding->objects = {holder.object, &attribute};
    }
    return finding;
}

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
        CheckValue(holder, *attribute, {true, false, true, true});
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
                CheckValue(holder, *attribute, {false, isInBlockComment_, true, isTyped_});
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
        CheckValue(holder, *attribute, places);
        if (places.verilogNumber && IsSynthesis(*attribute) && !isTyped_ &&
            attribute->GetValueType() != Attribute::String) {
            // The same value is a string elsewhere.
            places = {false, isInBlockComment_, true, false};
            CheckValue(holder, *attribute, places);
        }
    }
}

/// Whether each instance of the component has an attribute of that name in its place. Verilog has
/// parameters of instances only.
bool AttributeWalk::IsHidden(const Holder& component, const Attribute& attribute) const {
    const auto* const used = static_cast<const Component*>(component.object);
    if (context_.used.at(used).hasPlainInstance) {
        return false;
    }
    for (const Instance* instance : context_.survey.GetInstances()) {
        if (instance->GetComponent() == used &&
            instance->GetAttr(attribute.GetName().CStr()) == nullptr) {
            return false;
        }
    }
    return true;
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
    if (isSynthesis && IsOneOf(PredefinedAttributes, Lower(attribute.GetNameView()))) {
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
    return TypeOf(attribute) == type || !IsOneOf(VisibleTypes, type) ||
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

void AttributeWalk::CheckValue(const Holder& holder, const Attribute& attribute,
                               const Places& places) {
    if (places.vhdl && places.typed) {
        context_.usedTypes.insert(TypeOf(attribute));
        if (attribute.GetValueType() == Attribute::Boolean) {
            context_.usedTypes.insert(Lower(attribute.GetValueString().GetView()));
        }
    }
    switch (attribute.GetValueType()) {
    case Attribute::String:
        CheckText(holder, attribute, Writers::GetUnquotedValue(attribute).GetView(), places);
        break;
    case Attribute::User: {
        const Port::String text = attribute.GetValueString();
        Places asText = places;
        asText.vhdl = places.vhdl && !places.typed;
        CheckText(holder, attribute,
                  places.verilogNumber ? text.GetView()
                                       : Writers::GetUnquotedValue(attribute).GetView(),
                  asText);
        if (places.vhdl && places.typed &&
            (IsGeneric(attribute) || IsDeclaredBy(holder, attribute))) {
            CheckUser(holder, attribute);
        }
        break;
    }
    case Attribute::BitVector:
        if (places.verilogNumber || places.typed) {
            CheckDigits(holder, attribute, places);
        } else {
            CheckText(holder, attribute, Writers::GetUnquotedValue(attribute).GetView(), places);
        }
        break;
    default:
        break;
    }
}

bool IsControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || (byte >= 0x7F && byte < 0xA0);
}

void AttributeWalk::CheckText(const Holder& holder, const Attribute& attribute, string_view text,
                              const Places& places) {
    if (context_.isMended) {
        return;
    }
    if (text.find('"') != string_view::npos && (places.verilogNumber || places.vhdl)) {
        Verdicts verdicts(places.verilogNumber ? "rrr..rrr" : "");
        verdicts.Worsen(Verdicts(places.vhdl ? "...rr...r" : ""));
        if (Finding* finding = Add(RuleId::QuoteInValue, verdicts, holder, attribute)) {
            finding->message =
                "the value of " + holder.Describe(attribute) + " holds a double quote";
        }
    }
    const bool endsComment = text.find("*/") != string_view::npos ||
                             attribute.GetNameView().find("*/") != string_view::npos;
    if (places.verilogComment && endsComment) {
        if (Finding* finding = Add(RuleId::CommentInValue, GetRule(RuleId::CommentInValue).verdicts,
                                   holder, attribute)) {
            finding->message = holder.Describe(attribute) + " holds */, which ends its comment";
        }
    }
    if (places.verilogNumber && text.find('\\') != string_view::npos) {
        const bool isLast = text.back() == '\\';
        if (Finding* finding = Add(RuleId::BackslashInValue,
                                   Verdicts(isLast ? "rrr..rrr" : "mmm..mmm"), holder, attribute)) {
            finding->message = "the value of " + holder.Describe(attribute) +
                               (isLast ? " ends in a backslash, which hides the closing quote"
                                       : " holds a backslash");
        }
    }
    if (places.vhdl && std::any_of(text.begin(), text.end(), IsControl)) {
        if (Finding* finding = Add(RuleId::CharacterInValue,
                                   GetRule(RuleId::CharacterInValue).verdicts, holder, attribute)) {
            finding->message =
                "the value of " + holder.Describe(attribute) + " holds a control character";
        }
    }
}

void AttributeWalk::CheckDigits(const Holder& holder, const Attribute& attribute,
                                const Places& places) {
    const Digits digits(static_cast<const AttributeBitVector&>(attribute).GetBitVectorValue());
    Verdicts characters(places.vhdl && places.typed && !digits.IsVhdlBitVector() ? "...rr...r"
                                                                                 : "");
    const bool isNumber = digits.IsVerilogNumber();
    characters.Worsen(Verdicts(places.verilogNumber && !isNumber ? "rrr..rrr" : ""));
    if (Finding* finding = Add(RuleId::ConstantCharacter, characters, holder, attribute)) {
        finding->message = "the value " + Quoted(digits.digits) + " of " +
                           holder.Describe(attribute) + " has a character that is no digit";
    }
    if (!places.verilogNumber || !isNumber) {
        return;
    }
    Verdicts verdicts;
    RuleId rule = RuleId::ConstantLength;
    if (digits.hasLength) {
        const bool isCut =
            digits.length > 0 && digits.GetNeededBits() > static_cast<std::size_t>(digits.length);
        verdicts = Verdicts(digits.length == 0  ? "rrr..r.r"
                            : digits.length < 0 ? "mmm..mmm"
                            : isCut             ? "mmm..mrm"
                                                : "");
    } else {
        rule = RuleId::GenericDigits;
        const BitText read = digits.ReadVerilog(digits.digits.size());
        const bool isLong = digits.GetNeededBits() > 32;
        const bool differs = !read || *read != digits.digits || isLong;
        verdicts = Verdicts(!differs ? "" : isLong ? "mmm..mrm" : "mmm..mmm");
    }
    if (Finding* finding = Add(rule, verdicts, holder, attribute)) {
        finding->message =
            "the value " + Quoted(digits.digits) + " of " + holder.Describe(attribute) +
            (digits.hasLength ? " does not fit its length" : " is a decimal number in Verilog");
    }
}

void AttributeWalk::CheckUser(const Holder& holder, const Attribute& attribute) {
    const std::string type = TypeOf(attribute);
    const bool isVisible = IsOneOf(VisibleTypes, type);
    if (type.empty() || !isVisible) {
        const bool mayBeDeclared = !type.empty() && context_.options.vhdl.useClauses.GetSize() > 0;
        if (Finding* finding =
                Add(RuleId::UserType, Verdicts(mayBeDeclared ? "...ww...w" : "...rr...r"), holder,
                    attribute)) {
            finding->message =
                holder.Describe(attribute) +
                (type.empty() ? " has no type's name"
                              : " has the type " + Quoted(type) + ", which nothing declares");
        }
        return;
    }
    const Port::String value = attribute.GetValueString();
    if (!CanBeValueOf(type, value.GetView())) {
        if (Finding* finding =
                Add(RuleId::UserValue, GetRule(RuleId::UserValue).verdicts, holder, attribute)) {
            finding->message = "the value " + Quoted(value.GetView()) + " of " +
                               holder.Describe(attribute) + " is none of the type " + type;
        }
    }
}

} // namespace

void CheckAttributes(Context& context) {
    AttributeWalk(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
