// Names that meet in one scope, hide a library or a type, or bear the name of the design.

#include "Check/Context.h"
#include "HdlModel/Names/GeneratedNames.h"
#include "HdlModel/Names/Names.h"
#include "Port/Ascii.h"
#include "Writers/Generics.h"
#include "Writers/OneLine.h"
#include "Writers/Text.h"

#include <algorithm>
#include <functional>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

/// Something that bears a name in the scope of the design.
struct Declared {
    /// Null for a generic's or an attribute's name.
    const Object* object = nullptr;
    std::string what;
    /// The name as the Verilog writer spells it; empty when Verilog has no such name there.
    std::string verilogName;
    bool isInstance = false;
    Cause cause;
};

bool IsPort(const Declared& declared) {
    return declared.object != nullptr && declared.object->GetObjectType() == ObjectTypeSignal &&
           static_cast<const Signal*>(declared.object)->IsPort();
}

/// Words that begin a comment which a tool obeys, and what the tools make of it.
struct Directive {
    string_view words;
    string_view verdicts;
};
constexpr Directive Directives[] = {{"synopsys translate_off", "......wrm"},
                                    {"synthesis translate_off", "......wrm"},
                                    {"pragma translate_off", "........m"},
                                    {"synopsys translate_on", ".......w"},
                                    {"synthesis translate_on", ".......w"},
                                    {"synopsys full_case", "......wr."},
                                    {"synthesis full_case", "......wr."},
                                    {"synopsys parallel_case", "......wr."},
                                    {"synthesis parallel_case", "......wr."},
                                    {"synopsys", "......ww"},
                                    {"synthesis", "......ww"},
                                    {"verilator", "......r"}};

class Scopes {
public:
    explicit Scopes(Context& context)
        : context_(context), netlist_(context.netlist), options_(context.options) {}

    void CheckAll() {
        CheckBuses();
        CheckDummySignals();
        CheckMadeSignals();
        CheckOpenSignals();
        CheckGenerics();
        CheckAttributeNames();
        CheckComponents();
        CheckHidden();
        CheckComments();
    }

private:
    void CheckBuses();
    void CheckDummySignals();
    void CheckMadeSignals();
    void CheckOpenSignals();
    void CheckOpenPin(const Instance& instance, const Pin& pin);
    void CheckGenerics();
    void CheckAttributeNames();
    void CheckComponents();
    void CheckHidden();
    void CheckDesignName();
    void CheckHiddenBy(const Declared& declared);
    void CheckPredefined(string_view name);
    void CheckComments();
    void CheckComment(string_view comment);
    Declared DescribeSignal(const Signal& signal) const;
    void ReportClash(const Declared& one, const Declared& other, string_view inVerilog);
    void ForEachInScope(string_view name, const Declared& except,
                        const std::function<void(const Declared&)>& visit) const;

    Context& context_;
    const Netlist& netlist_;
    const HdlOptions& options_;
};

Declared Scopes::DescribeSignal(const Signal& signal) const {
    const string_view base = Names::BaseName(signal.GetNameView());
    Declared declared;
    declared.object = &signal;
    declared.what = (signal.IsPort() ? "the port " : "the signal ") + Quoted(signal.GetNameView());
    declared.verilogName = Spell(base, options_.verilog.signalCase);
    declared.cause = SignalCause(base);
    declared.cause.second = signal.GetSignalType() == SignalTypeBus ? "bus" : "scalar";
    return declared;
}

/// Calls `visit` with what bears the name, letter case ignored, but for one object.
void Scopes::ForEachInScope(string_view name, const Declared& except,
                            const std::function<void(const Declared&)>& visit) const {
    const auto meet = [&](const Declared& declared) {
        if (declared.object == nullptr || declared.object != except.object) {
            visit(declared);
        }
    };
    const Signal* const signal = netlist_.GetSignal(name);
    if (signal != nullptr && signal->GetSignalType() == SignalTypeScalar) {
        meet(DescribeSignal(*signal));
    }
    if (const Bus* bus = netlist_.GetParentBus(std::string(name).c_str())) {
        meet(DescribeSignal(*bus));
    }
    if (const Instance* instance = netlist_.GetInstance(name)) {
        meet({instance, "the instance " + Quoted(instance->GetNameView()),
              Spell(instance->GetNameView(), options_.verilog.instanceCase), true,
              CauseOf(*instance)});
    }
    const Component* const component = netlist_.GetComponent(name);
    if (component != nullptr && context_.used.count(component) != 0) {
        meet({component, "the component " + Quoted(component->GetNameView()), "", false,
              CauseOf(*component)});
    }
}

/// \param inVerilog what the Verilog targets make of it when both are spelled alike.
void Scopes::ReportClash(const Declared& one, const Declared& other, string_view inVerilog) {
    const bool isInVerilog = !one.verilogName.empty() && one.verilogName == other.verilogName;
    Verdicts verdicts("...rr...r");
    if (isInVerilog) {
        verdicts.Worsen(Verdicts(inVerilog));
    }
    if (Finding* finding = context_.Add(RuleId::NameClash, verdicts, one.cause)) {
        for (const Object* object : {one.object, other.object}) {
            if (object != nullptr) {
                finding->objects.push_back(object);
            }
        }
        finding->message = one.what + " and " + other.what + " bear one name";
        finding->other = other.cause;
    }
}

void Scopes::CheckBuses() {
    for (const Signal* signal : context_.survey.GetSignals()) {
        if (signal->GetSignalType() != SignalTypeBus) {
            continue;
        }
        const string_view base = Names::BaseName(signal->GetNameView());
        // A signal that a write made for an open pin can bear the base name of another bus.
        if (!netlist_.IsNameUsed(base) &&
            netlist_.GetParentBus(std::string(base).c_str()) == signal) {
            continue;
        }
        const Declared bus = DescribeSignal(*signal);
        ForEachInScope(base, bus, [&](const Declared& other) {
            // Verilator takes two nets of one name for one.
            const bool isPort = IsPort(bus) && IsPort(other);
            // Icarus makes one net of both until a part of the bus is named.
            const bool isUnused = IsPort(bus) && !context_.uses.IsKnown(*signal);
            ReportClash(bus, other,
                        other.isInstance || isPort ? "rrr..rrr"
                        : isUnused                 ? "rrr..wwr"
                                                   : "rrr..rwr");
        });
    }
}

void Scopes::CheckDummySignals() {
    for (const auto& [name, port] : context_.dummies) {
        const Port::String whole = port->GetDummySignalName();
        Declared dummy;
        dummy.what = "the dummy signal " + Quoted(whole.GetView()) + " of the port " +
                     Quoted(port->GetNameView());
        dummy.verilogName = Spell(Names::BaseName(whole.GetView()), options_.verilog.signalCase);
        dummy.cause = SignalCause(Names::BaseName(port->GetNameView()));
        ForEachInScope(name, dummy, [&](const Declared& other) {
            ReportClash(dummy, other, other.isInstance ? "rrr..rrr" : "rrr..rwr");
        });
    }
}

/// With SET OPEN PIN false the VHDL writer wires open inputs to signals of their own.
void Scopes::CheckOpenSignals() {
    if (options_.vhdl.openPin || !context_.vhdl) {
        return;
    }
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        for (const Pin* pin : instance->GetPinIterator()) {
            if (pin->GetSignal() == nullptr && pin->GetPinType() != PinTypeBusIndex &&
                pin->GetPolarity().GetValue() == Polarity::Input) {
                CheckOpenPin(*instance, *pin);
            }
        }
    }
}

void Scopes::CheckOpenPin(const Instance& instance, const Pin& pin) {
    const string_view pinName = pin.GetNameView();
    const string_view pinBase = Writers::GetBaseName(pin);
    std::string base(instance.GetNameView());
    base.append("_").append(pinBase).append("_openSignal");
    const std::string name = base + std::string(pinName.substr(pinBase.size()));
    if (const Signal* taken = netlist_.GetSignal(string_view(name))) {
        if (Finding* finding =
                context_.Add(RuleId::OpenSignalTaken, SignalCause(Names::BaseName(name)))) {
            finding->objects = {taken, &instance, &pin};
            finding->message =
                "the open pin " +
                Quoted(std::string(instance.GetNameView()) + "." + std::string(pinName)) +
                " is wired to the signal " + Quoted(taken->GetNameView()) + " in VHDL";
        }
        return;
    }
    Declared open;
    open.what = "the signal " + Quoted(name) + " of an open pin";
    open.cause = Named(Kind::Instance, instance.GetNameView());
    ForEachInScope(base, open, [&](const Declared& other) { ReportClash(open, other, ""); });
}

/// A signal that an earlier write made can have the name of another object. Buses are looked at as
/// all others are.
void Scopes::CheckMadeSignals() {
    for (const Signal* signal : context_.survey.GetSignals()) {
        const string_view name = signal->GetNameView();
        if (signal->GetSignalType() != SignalTypeScalar || !Names::IsGenerated(name)) {
            continue;
        }
        const Declared made = DescribeSignal(*signal);
        ForEachInScope(name, made, [&](const Declared& other) {
            ReportClash(made, other, other.isInstance ? "rrr..rrr" : "rrr..rwr");
        });
    }
}

void Scopes::CheckGenerics() {
    for (const Attribute* attribute : netlist_.GetAttrIterator()) {
        if (!Writers::IsGeneric(*attribute)) {
            continue;
        }
        const string_view name = attribute->GetNameView();
        Declared generic;
        generic.what = "the generic " + Quoted(name);
        generic.verilogName = std::string(name);
        generic.cause = Named(Kind::ModuleAttribute, "", name);
        ForEachInScope(name, generic, [&](const Declared& other) {
            ReportClash(generic, other, other.isInstance || IsPort(other) ? "rrr..rr" : "rrr..rw");
        });
        const auto attributeOfName = context_.declaredAttributes.find(Lower(name));
        if (attributeOfName != context_.declaredAttributes.end()) {
            Declared other;
            other.what = "the attribute " + Quoted(name);
            other.cause = attributeOfName->second;
            ReportClash(other, generic, "");
        }
        const auto dummy = context_.dummies.find(Lower(name));
        if (dummy != context_.dummies.end()) {
            Declared other;
            other.what = "the dummy signal of the port " + Quoted(dummy->second->GetNameView());
            other.verilogName =
                Spell(dummy->second->GetDummySignalName().GetView(), options_.verilog.signalCase);
            other.cause = SignalCause(Names::BaseName(dummy->second->GetNameView()));
            ReportClash(generic, other, "rrr..rw");
        }
        Declared hiding = generic;
        CheckHiddenBy(hiding);
        CheckPredefined(name);
    }
}

void Scopes::CheckAttributeNames() {
    for (const auto& [name, cause] : context_.declaredAttributes) {
        Declared attribute;
        attribute.what = "the attribute " + Quoted(cause.second);
        attribute.cause = cause;
        ForEachInScope(name, attribute,
                       [&](const Declared& other) { ReportClash(attribute, other, ""); });
        const auto dummy = context_.dummies.find(name);
        if (dummy != context_.dummies.end()) {
            Declared other;
            other.what = "the dummy signal of the port " + Quoted(dummy->second->GetNameView());
            other.cause = SignalCause(Names::BaseName(dummy->second->GetNameView()));
            ReportClash(attribute, other, "");
        }
        CheckHiddenBy(attribute);
    }
}

/// Within a component, generics and pins share a scope.
void Scopes::CheckComponents() {
    for (const Component* component : netlist_.GetComponentIterator()) {
        if (context_.used.count(component) == 0) {
            continue;
        }
        if (Port::EqualIgnoringCase(component->GetNameView(), netlist_.GetNameView())) {
            const bool isSame = Spell(component->GetNameView(), options_.verilog.componentCase) ==
                                netlist_.GetNameView();
            const Verdicts verdicts(isSame ? "rrrrrrwrr" : "...rr...r");
            if (Finding* finding =
                    context_.Add(RuleId::OwnComponent, verdicts, CauseOf(*component))) {
                finding->objects = {component, &netlist_};
                finding->message =
                    "the component " + Quoted(component->GetNameView()) + " is the design itself";
                finding->other = Named(Kind::DesignName, "");
            }
        }
        for (const Attribute* attribute : component->GetAttrIterator()) {
            if (!Writers::IsGeneric(*attribute)) {
                continue;
            }
            for (const Pin* pin : component->GetPinIterator()) {
                const string_view base = Writers::GetBaseName(*pin);
                if (!Port::EqualIgnoringCase(base, attribute->GetNameView())) {
                    continue;
                }
                Declared generic;
                generic.what = "the generic " + Quoted(attribute->GetNameView());
                generic.verilogName = std::string(attribute->GetNameView());
                generic.cause = Named(Kind::ComponentAttribute, component->GetNameView(),
                                      attribute->GetNameView());
                Declared other;
                other.what = "the pin " + Quoted(pin->GetNameView()) + " of " +
                             Quoted(component->GetNameView());
                other.verilogName = std::string(base);
                other.cause = Named(Kind::Pin, component->GetNameView(), pin->GetNameView());
                // The cell itself is no part of the netlist, but it cannot be written either.
                ReportClash(generic, other, "rrr..rr");
            }
        }
    }
}

/// Looks only for the few names that hide something.
void Scopes::CheckHidden() {
    for (const string_view name : {netlist_.GetNameView(), string_view("ieee"),
                                   string_view("kestra"), string_view("work")}) {
        ForEachInScope(name, {}, [this](const Declared& declared) { CheckHiddenBy(declared); });
    }
    CheckDesignName();
    context_.usedTypes.insert("std_logic");
    context_.usedTypes.insert("std_logic_vector");
    for (const std::string& name : context_.usedTypes) {
        ForEachInScope(name, {}, [&](const Declared& declared) {
            const bool isLate = declared.isInstance;
            if (Finding* finding =
                    context_.Add(RuleId::PredefinedName,
                                 Verdicts(isLate ? "...ww...w" : "...rr...r"), declared.cause)) {
                finding->objects = {declared.object};
                finding->message = declared.what + " hides what VHDL knows by that name";
            }
        });
        CheckPredefined(name);
    }
}

/// The entity's own name hides types, and cannot be that of a library which a clause names.
void Scopes::CheckDesignName() {
    const std::string name = Lower(netlist_.GetNameView());
    const Cause cause = Named(Kind::DesignName, "");
    if (name == "std_logic" || name == "std_logic_vector" || context_.usedTypes.count(name) != 0) {
        if (Finding* finding = context_.Add(RuleId::PredefinedName, cause)) {
            finding->objects = {&netlist_};
            finding->message = "the name of the design hides what VHDL knows by that name";
        }
    }
    bool isLibrary = options_.vhdl.useDefaultLibrary && (name == "ieee" || name == "kestra");
    for (int i = 0; i < options_.vhdl.libraries.GetSize(); ++i) {
        isLibrary = isLibrary || Port::EqualIgnoringCase(options_.vhdl.libraries.GetView(i), name);
    }
    if (isLibrary) {
        if (Finding* finding = context_.Add(RuleId::HiddenLibrary, Verdicts("...rr...r"), cause)) {
            finding->objects = {&netlist_};
            finding->message = "the design bears the name of a library that it uses";
        }
    }
}

/// Attributes and generics of the name of a type that is used.
void Scopes::CheckPredefined(string_view name) {
    const std::string small = Lower(name);
    const auto attribute = context_.declaredAttributes.find(small);
    const bool isUsed =
        small == "std_logic" || small == "std_logic_vector" || context_.usedTypes.count(small) != 0;
    if (!isUsed) {
        return;
    }
    const Attribute* const generic = netlist_.GetAttr(small.c_str());
    const bool isGeneric =
        generic != nullptr && generic->GetGenericOption() != Attribute::GenericNone;
    if (attribute == context_.declaredAttributes.end() && !isGeneric) {
        return;
    }
    const Cause cause =
        isGeneric ? Named(Kind::ModuleAttribute, "", generic->GetNameView()) : attribute->second;
    if (Finding* finding = context_.Add(RuleId::PredefinedName, cause)) {
        finding->message = "the attribute " + Quoted(name) + " hides what VHDL knows by that name";
    }
}

void Scopes::CheckHiddenBy(const Declared& declared) {
    const string_view name = declared.object != nullptr
                                 ? Names::BaseName(declared.object->GetNameView())
                                 : string_view(declared.cause.second);
    if (Port::EqualIgnoringCase(name, netlist_.GetNameView())) {
        const bool isPort = IsPort(declared);
        const bool isSame = declared.verilogName == netlist_.GetNameView();
        const bool isComponent =
            declared.object != nullptr && declared.object->GetObjectType() == ObjectTypeComponent;
        if (isComponent) {
            return;
        }
        // An attribute of the port is then taken for one of the entity.
        const bool hasAttrs = isPort && static_cast<const Signal*>(declared.object)->HasAttrs();
        Verdicts verdicts(hasAttrs ? "........r" : "........w");
        verdicts.Worsen(Verdicts(isPort && isSame ? "......r" : ""));
        if (Finding* finding = context_.Add(RuleId::ModuleName, verdicts, declared.cause)) {
            if (declared.object != nullptr) {
                finding->objects = {declared.object, &netlist_};
            }
            finding->message = declared.what + " bears the name of the design";
            finding->other = Named(Kind::DesignName, "");
        }
    }
    for (const string_view library : {"ieee", "kestra", "work"}) {
        if (Port::EqualIgnoringCase(name, library)) {
            if (Finding* finding = context_.Add(RuleId::HiddenLibrary, declared.cause)) {
                finding->message = declared.what + " hides the library of that name";
            }
        }
    }
}

void Scopes::CheckComments() {
    CheckComment(netlist_.GetCommentView());
    for (const Signal* signal : context_.survey.GetSignals()) {
        if (signal->IsNeededToDeclared()) {
            CheckComment(signal->GetCommentView());
        }
    }
    for (const Instance* instance : context_.survey.GetInstances()) {
        CheckComment(instance->GetCommentView());
    }
    for (const auto& [component, used] : context_.used) {
        CheckComment(component->GetCommentView());
    }
}

void Scopes::CheckComment(string_view comment) {
    while (!comment.empty()) {
        const std::size_t end = std::min(comment.find('\n'), comment.size());
        const string_view line = comment.substr(0, end);
        comment.remove_prefix(std::min(end + 1, comment.size()));
        string_view words = line.substr(std::min(line.find_first_not_of(' '), line.size()));
        for (const Directive& directive : Directives) {
            const bool begins = words.substr(0, directive.words.size()) == directive.words;
            if (!begins) {
                continue;
            }
            if (Finding* finding =
                    context_.Add(RuleId::DirectiveComment, Verdicts(directive.verdicts),
                                 Named(Kind::Comment, line))) {
                finding->message =
                    "the comment " + Quoted(line.substr(0, 60)) + " is a command to a tool";
            }
            break;
        }
    }
}

} // namespace

void CheckScopes(Context& context) {
    Scopes(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
