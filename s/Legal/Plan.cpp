#include "Legal/Plan.h"

#include "Check/Identifier.h"
#include "Check/ReservedWords.h"
#include "HdlModel/Names/Names.h"
#include "Legal/Namer.h"
#include "Legal/Values.h"
#include "Port/Ascii.h"
#include "Writers/Text.h"

#include <algorithm>
#include <string_view>

namespace Orn_Hdl::Legal {

using Checking::Lower;
using Checking::RuleId;
using std::string_view;
using Kind = Check::Cause::Kind;

namespace {

bool Is(const Check::Finding& finding, RuleId rule) {
    return finding.rule == &Checking::GetRule(rule);
}

template <std::size_t N> bool IsOneOf(const Check::Finding& finding, const RuleId (&rules)[N]) {
    return std::any_of(std::begin(rules), std::end(rules),
                       [&](RuleId rule) { return Is(finding, rule); });
}

/// What no netlist can mend.
constexpr RuleId Unmendable[] = {RuleId::PinWidth,    RuleId::SliceOutside, RuleId::AliasWidth,
                                 RuleId::AliasBits,   RuleId::WideBus,      RuleId::AssignedInput,
                                 RuleId::DrivenInput, RuleId::TwoDrivers,   RuleId::GenericType};
/// These are no more than warnings, but two values meet on one net.
constexpr RuleId TwoValues[] = {RuleId::DrivenInput, RuleId::TwoDrivers};

constexpr RuleId OfConstants[] = {RuleId::ConstantDigits, RuleId::ConstantWidth,
                                  RuleId::ConstantLength, RuleId::ConstantCharacter,
                                  RuleId::ConstantLeftOut};
constexpr RuleId OfNames[] = {
    RuleId::ReservedWord,  RuleId::IllegalName,    RuleId::Underscores,
    RuleId::NameLength,    RuleId::ModuleName,     RuleId::OwnComponent,
    RuleId::HiddenLibrary, RuleId::PredefinedName, RuleId::PredefinedAttribute};
constexpr RuleId OfSpelling[] = {RuleId::ReservedWord, RuleId::IllegalName, RuleId::Underscores};
constexpr RuleId OfClauses[] = {RuleId::LibraryClause, RuleId::UseClause, RuleId::NoStdLogic,
                                RuleId::IncludeFile};
constexpr RuleId OfTypes[] = {RuleId::UserType, RuleId::UserValue, RuleId::AttributeTypes};

bool IsAttributeKind(Kind kind) {
    return kind == Kind::ModuleAttribute || kind == Kind::ComponentAttribute ||
           kind == Kind::InstanceAttribute || kind == Kind::SignalAttribute;
}

/// The attribute of a finding of the check of attributes, which comes after its holder.
const Attribute* AttributeOf(const Check::Finding& finding) {
    const Object* const last = finding.objects.empty() ? nullptr : finding.objects.back();
    return last != nullptr && last->GetObjectType() == ObjectTypeAttribute
               ? static_cast<const Attribute*>(last)
               : nullptr;
}

bool IsBeyondMending(const Check::Finding& finding) {
    const bool isFileWithQuote = Is(finding, RuleId::IncludeFile) &&
                                 finding.cause.first.find_first_not_of("\" ") != std::string::npos;
    return IsOneOf(finding, Unmendable) || isFileWithQuote ||
           (Is(finding, RuleId::CharacterInValue) && !CanBeEscaped(*AttributeOf(finding)));
}

/// Notes the names that are at fault by themselves.
void NoteName(const Check::Finding& finding, const Netlist& netlist, FaultyNames& faulty) {
    if (IsAttributeKind(finding.cause.kind)) {
        const Attribute* const attribute = AttributeOf(finding);
        if (finding.cause.kind == Kind::ModuleAttribute) {
            const Attribute* const own = netlist.GetAttr(finding.cause.second.c_str());
            if (own != nullptr) {
                faulty.objects.insert(own);
            }
            return;
        }
        const std::string name = Lower(finding.cause.second);
        const bool isGeneric = attribute != nullptr && IsGeneric(*attribute);
        const bool isSynthesis =
            attribute == nullptr || attribute->GetSynAttrOption() != Attribute::SynAttrNone;
        if (isGeneric) {
            faulty.generics.insert(name);
        }
        if (isSynthesis) {
            faulty.attributes.insert(name);
        }
        return;
    }
    const bool isDesign = finding.cause.kind == Kind::DesignName ||
                          Is(finding, RuleId::OwnComponent) || finding.objects.empty();
    const Object* const object = isDesign ? &netlist : finding.objects.front();
    const bool isNew = faulty.objects.insert(object).second;
    if (!IsOneOf(finding, OfSpelling)) {
        faulty.escapable.erase(object);
    } else if (isNew) {
        faulty.escapable.insert(object);
    }
}

} // namespace

const NewName* NewNames::Find(const Object& object) const {
    const auto own = objects.find(&object);
    if (own != objects.end()) {
        return &own->second;
    }
    if (object.GetObjectType() != ObjectTypeAttribute) {
        return nullptr;
    }
    const bool isGeneric = Writers::IsGeneric(static_cast<const Attribute&>(object));
    const auto& names = isGeneric ? generics : attributes;
    const auto found = names.empty() ? names.end() : names.find(Lower(object.GetNameView()));
    return found == names.end() ? nullptr : &found->second;
}

Plan::Plan(const Netlist& netlist, const HdlOptions& options) : netlist_(netlist) {
    Checking::Context context(netlist, options, Check::Targets::All());
    context.CheckAll();
    std::vector<Check::Finding> findings = context.TakeFindings();
    FindOpen();
    // A signal named open that is one gets another name, and its aliases are written then.
    const bool hasOpenSignal =
        open_ == nullptr && netlist.GetSignal(string_view("open")) != nullptr;
    const auto isFault = [&](const Check::Finding& finding) {
        return finding.GetSeverity() == Check::Severity::Error || IsOneOf(finding, TwoValues) ||
               (hasOpenSignal && Is(finding, RuleId::AliasBits));
    };
    findings.erase(std::remove_if(findings.begin(), findings.end(),
                                  [&](const Check::Finding& f) { return !isFault(f); }),
                   findings.end());
    if (findings.empty()) {
        return;
    }
    isNeeded_ = true;
    options_ = options;
    for (const auto& [component, used] : context.used) {
        used_.insert(component);
    }
    NoteOpen();
    FaultyNames faulty;
    if (hasOpenSignal) {
        faulty.objects.insert(netlist.GetSignal(string_view("open")));
    }
    for (const Check::Finding& finding : findings) {
        if (IsOneOf(finding, OfNames)) {
            NoteName(finding, netlist, faulty);
        }
    }
    for (const auto* misused : {&context.readOutputs, &context.drivenInputs}) {
        for (const Checking::Misused& each : *misused) {
            names_.inner.try_emplace(each.port);
        }
    }
    for (Check::Finding& finding : findings) {
        Note(finding);
    }
    options_.vhdl.openPin = true;
    if (std::any_of(findings.begin(), findings.end(), [](const Check::Finding& finding) {
            return finding.rule != nullptr && IsOneOf(finding, OfClauses);
        })) {
        MendClauses();
    }
    if (errors_.empty()) {
        Namer(context, *this, faulty, names_).NameAll();
    }
}

/// A signal named open is none unless it is a port, or has a constant or an alias.
void Plan::FindOpen() {
    const Signal* const open = netlist_.GetSignal(string_view("open"));
    const bool isNone = open != nullptr && open->GetSignalType() == SignalTypeScalar &&
                        !open->IsPort() && open->GetConstantValue().GetValue().IsEmpty() &&
                        open->GetSignalIterator().IsAtEnd();
    open_ = isNone ? open : nullptr;
}

/// Notes what nothing is wired to.
void Plan::NoteOpen() {
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (signal->GetSignalType() != SignalTypeCompoundBus) {
            continue;
        }
        std::vector<std::string> parts;
        for (const Signal* member :
             static_cast<const CompoundBus*>(signal)->GetBusMemberIterator()) {
            if (IsNothing(*member)) {
                parts.emplace_back();
            }
        }
        if (!parts.empty()) {
            names_.parts.emplace(signal, std::move(parts));
        }
    }
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        int count = 0;
        for (const Pin* pin : instance->GetPinIterator()) {
            ++count;
            const Signal* const signal = pin->GetSignal();
            if (pin->GetPolarity().GetValue() == Polarity::Input &&
                (signal == nullptr || IsNothing(*signal))) {
                names_.open.try_emplace(pin);
            }
        }
        const Component* const component = instance->GetComponent();
        if (component == nullptr) {
            continue;
        }
        for (const Pin* pin : component->GetPinIterator()) {
            --count;
            if (pin->GetPolarity().GetValue() == Polarity::Input &&
                instance->GetPin(pin->GetNameView()) == nullptr) {
                names_.late[instance].emplace_back(pin, "");
            }
        }
    }
}

bool Plan::IsNothing(const Signal& signal) const noexcept {
    return &signal == open_ || signal.GetNameView().empty();
}

void Plan::Note(Check::Finding& finding) {
    if (IsBeyondMending(finding)) {
        Refuse(finding);
    } else if (IsAttributeKind(finding.cause.kind) && AttributeOf(finding) != nullptr &&
               (IsOneOf(finding, OfConstants) || Is(finding, RuleId::GenericDigits))) {
        NoteAttributeDigits(finding);
    } else if (IsOneOf(finding, OfConstants)) {
        NoteConstant(finding);
    } else if (IsOneOf(finding, OfTypes)) {
        options_.vhdl.useAttrType = false;
        if (!Is(finding, RuleId::AttributeTypes)) {
            texts_.insert(Lower(finding.cause.second));
        }
    } else if (Is(finding, RuleId::OutputRead)) {
        names_.inner.try_emplace(static_cast<const Signal*>(finding.objects.back()));
    } else if (Is(finding, RuleId::UndeclaredAttribute)) {
        // Nobody has looked whether its values are of one type.
        options_.vhdl.useAttrType = false;
        undeclared_.insert(Lower(finding.cause.second));
    } else if (Is(finding, RuleId::UndeclaredGeneric)) {
        NoteGeneric(finding);
    } else if (Is(finding, RuleId::DirectiveComment)) {
        hasDirectives_ = true;
    } else if (Is(finding, RuleId::UndeclaredComponent)) {
        options_.vhdl.suppressComponent = false;
    }
}

void Plan::NoteConstant(Check::Finding& finding) {
    const auto& signal = *static_cast<const Signal*>(finding.objects.front());
    const auto width = static_cast<std::size_t>(std::max(signal.GetWidth(), 0));
    const std::optional<std::string> bits =
        FindBits(signal.GetConstantValue(), width, options_.dontCares);
    const bool isLeftOut = Is(finding, RuleId::ConstantLeftOut);
    if (!bits || (isLeftOut && bits->find_first_not_of("01-") != std::string::npos)) {
        Refuse(finding);
    } else {
        constants_.insert(&signal);
    }
}

void Plan::NoteAttributeDigits(Check::Finding& finding) {
    const Attribute& attribute = *AttributeOf(finding);
    if (!IsGeneric(attribute)) {
        options_.vhdl.useAttrType = false;
        return;
    }
    const BitVectorValue value =
        static_cast<const AttributeBitVector&>(attribute).GetBitVectorValue();
    if (!Is(finding, RuleId::ConstantCharacter) && FindBits(value)) {
        digits_.insert(&attribute);
    } else {
        Refuse(finding);
    }
}

/// The component gets a generic that each of its instances has; no other value is known for it.
void Plan::NoteGeneric(Check::Finding& finding) {
    const auto& instance = *static_cast<const Instance*>(finding.objects.front());
    const Attribute& attribute = *AttributeOf(finding);
    const Component* const component = instance.GetComponent();
    PtrArray<Instance*> instances;
    netlist_.GetInstances(component, instances);
    const auto hasIt = [&](const Instance* each) {
        const Attribute* const own = each->GetAttr(attribute.GetName().CStr());
        return own != nullptr && IsGeneric(*own) && own->GetValueType() == attribute.GetValueType();
    };
    for (const Instance* each : Iterator<Instance*>(&instances)) {
        if (!hasIt(each)) {
            Refuse(finding);
            return;
        }
    }
    std::vector<const Attribute*>& generics = newGenerics_[component];
    const bool isNew = std::none_of(generics.begin(), generics.end(), [&](const Attribute* known) {
        return Port::EqualIgnoringCase(known->GetNameView(), attribute.GetNameView());
    });
    if (isNew) {
        generics.push_back(&attribute);
    }
}

bool Plan::IsText(const Attribute& attribute) const {
    return attribute.GetValueType() == Attribute::User &&
           texts_.count(Lower(attribute.GetNameView())) != 0;
}

bool Plan::NeedsDeclaration(const Attribute& attribute) const {
    return attribute.GetSynAttrOption() == Attribute::SynAttrAssignNoDec &&
           undeclared_.count(Lower(attribute.GetNameView())) != 0;
}

std::vector<const Attribute*> Plan::GetNewGenerics(const Component& component) const {
    const auto found = newGenerics_.find(&component);
    return found == newGenerics_.end() ? std::vector<const Attribute*>() : found->second;
}

namespace {

/// The pieces of a clause without blanks around them.
std::vector<std::string> Split(string_view text, char separator) {
    std::vector<std::string> pieces;
    while (true) {
        const std::size_t end = std::min(text.find(separator), text.size());
        string_view piece = text.substr(0, end);
        piece.remove_prefix(std::min(piece.find_first_not_of(' '), piece.size()));
        piece = piece.substr(0, piece.find_last_not_of(' ') + 1);
        pieces.emplace_back(piece);
        if (end == text.size()) {
            return pieces;
        }
        text.remove_prefix(end + 1);
    }
}

bool IsVhdlIdentifier(string_view name) {
    const Checking::Identifier form(name);
    return form.isVhdl && form.hasProperUnderscores &&
           Checking::FindReserved("", name).GetWorst() <= Check::Verdict::Warns;
}

bool IsSelected(const std::vector<std::string>& pieces) {
    const bool endsInAll = Port::EqualIgnoringCase(pieces.back(), "all");
    return pieces.size() >= 2 &&
           std::all_of(pieces.begin(), pieces.end() - (endsInAll ? 1 : 0), IsVhdlIdentifier);
}

/// A list of clauses, each with one name.
class ClauseList {
public:
    void Add(const std::string& name) {
        if (!Has(name)) {
            names_.push_back(name);
        }
    }
    bool Has(string_view name) const {
        return std::any_of(names_.begin(), names_.end(), [name](const std::string& known) {
            return Port::EqualIgnoringCase(known, name);
        });
    }
    StringArray Get() const {
        StringArray clauses;
        for (const std::string& name : names_) {
            clauses.Add(name);
        }
        return clauses;
    }

private:
    std::vector<std::string> names_;
};

} // namespace

/// Leaves out the clauses that name nothing, and declares the libraries that are used.
void Plan::MendClauses() {
    HdlOptions::VhdlOption& vhdl = options_.vhdl;
    ClauseList libraries;
    ClauseList used;
    for (int i = 0; i < vhdl.libraries.GetSize(); ++i) {
        for (const std::string& name : Split(vhdl.libraries.GetView(i), ',')) {
            if (IsVhdlIdentifier(name)) {
                libraries.Add(name);
            }
        }
    }
    for (int i = 0; i < vhdl.useClauses.GetSize(); ++i) {
        for (const std::string& name : Split(vhdl.useClauses.GetView(i), ',')) {
            const std::vector<std::string> pieces = Split(name, '.');
            if (!IsSelected(pieces)) {
                continue;
            }
            used.Add(name);
            const std::string& library = pieces.front();
            if (!Port::EqualIgnoringCase(library, "std") &&
                !Port::EqualIgnoringCase(library, "work")) {
                libraries.Add(library);
            }
        }
    }
    if (!vhdl.useDefaultLibrary && !used.Has("ieee.std_logic_1164.all")) {
        libraries.Add("ieee");
        used.Add("ieee.std_logic_1164.all");
    }
    vhdl.libraries = libraries.Get();
    vhdl.useClauses = used.Get();
    StringArray files;
    for (int i = 0; i < options_.verilog.includePaths.GetSize(); ++i) {
        const string_view file = options_.verilog.includePaths.GetView(i);
        if (file.find_first_not_of("\" ") != string_view::npos) {
            files.Add(file);
        }
    }
    options_.verilog.includePaths = files;
}

} // namespace Orn_Hdl::Legal
