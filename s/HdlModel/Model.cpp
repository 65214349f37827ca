#include "Orn_Hdl/Model.h"

#include "Exception/Failure.h"
#include "HdlModel/ModelUse.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/Foresight.h"
#include "HdlModel/Objects/MakePacked.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Exception.h"
#include "Port/Ascii.h"

#include <cerrno>
#include <memory>
#include <string>
#include <utility>

namespace Orn_Hdl {

namespace {

using Port::ViewOf;

[[noreturn]] void FailInModel(int line, std::string_view message,
                              std::initializer_list<std::string_view> texts = {}) {
    Fail(ModelUnit, line, message, texts);
}

[[noreturn]] void FailNotFound(int line, const char* name) {
    FailInModel(line, "\"%s\" not found.\n", {ViewOf(name)});
}

[[noreturn]] void FailPinNotFound(int line, std::string_view pin) {
    FailInModel(line, "Pin \"%s\" not found.\n", {pin});
}

[[noreturn]] void FailSignalNotFound(int line, const char* name) {
    FailInModel(line, "Signal \"%s\" not found.\n", {ViewOf(name)});
}

void RequireName(int line, const char* name) {
    if (name == nullptr) {
        FailInModel(line, "Invalid Name.\n");
    }
}

/// Whether a text, and its normalised form too, has a shape; `parse` tells for one of them.
template <class Parse> bool HasShape(std::string_view text, Parse parse) {
    return parse(text) &&
           (Names::IsNormalized(text) || parse(Names::NormalizedText(text).GetView()));
}

bool IsBitName(std::string_view text) {
    Names::BitName bit;
    return HasShape(text, [&bit](std::string_view name) { return Names::ParseBit(name, bit); });
}

bool IsBusName(std::string_view text) {
    Names::BusName bus;
    return HasShape(text, [&bus](std::string_view name) { return Names::ParseBus(name, bus); });
}

bool IsCompoundName(std::string_view text) {
    return HasShape(text, Names::IsCompound);
}

/// A name with its base name spelled as the bus spells it.
std::string SpelledAs(const Bus& bus, std::string_view name) {
    std::string spelled(Names::BeforeParenthesis(bus.GetNameView()));
    return spelled.append(name.substr(Names::BeforeParenthesis(name).size()));
}

} // namespace

struct Model::Implementation {
    bool modified = false;
    Netlist netlist;
    HdlOptions options;
    CommandManager commands;
    CommandFactory* factory;
    const IStringPtrMap<AttributeFactory::Creator>& attributeCreators;
    /// The words of the line in hand; kept so that a line costs no allocation.
    StringArray words;
    OutputGuard* outputGuard = nullptr;
    int writeError = 0;
    Port::StringBase<char> writtenFileName;

    explicit Implementation(CommandFactory* commandFactory)
        : factory(commandFactory), attributeCreators(AttributeFactory::GetCreators()) {}
};

OutputGuard::~OutputGuard() = default;

const Port::Folder* OutputGuard::GetFolder(const char* /*fileName*/,
                                           Port::StringBase<char>& /*path*/) {
    return nullptr;
}

Model::Model(CommandFactory* factory)
    : implementation_(std::make_unique<Implementation>(factory)) {}

Model::~Model() {
    // A command that ends may use its model: all of it is still there.
    implementation_->commands.Clear();
}

void Model::Delete(std::unique_ptr<Model> model) noexcept {
    if (model != nullptr && model->uses_ > 0) {
        model->endsUnused_ = true;
        static_cast<void>(model.release());
    }
}

bool Model::IsModified() const noexcept {
    return implementation_->modified;
}

void Model::SetModifiedFlag(bool modified) noexcept {
    implementation_->modified = modified;
}

Netlist* Model::GetNetlist() noexcept {
    return &implementation_->netlist;
}

const Netlist* Model::GetNetlist() const noexcept {
    return &implementation_->netlist;
}

HdlOptions* Model::GetOptions() noexcept {
    return &implementation_->options;
}

CommandFactory* Model::GetCommandFactory() const noexcept {
    return implementation_->factory;
}

CommandManager* Model::GetCommandManager() noexcept {
    return &implementation_->commands;
}

Port::StringBase<char> Model::GetName() const {
    return implementation_->netlist.GetName();
}

void Model::SetName(const char* name) {
    implementation_->netlist.SetName(name == nullptr ? "HDL_NETLIST" : name);
}

Port::StringBase<char> Model::GetSourceFileName() const {
    return implementation_->netlist.GetSourceFileName();
}

void Model::SetSourceFileName(const char* name) {
    implementation_->netlist.SetSourceFileName(name);
}

bool Model::Execute(const char* text) {
    return ExecuteLine(ViewOf(text));
}

bool Model::ExecuteLine(std::string_view line) {
    const Use use(this);
    line = line.substr(0, line.find('\0'));
    // A command may run another line, so the words in hand are taken out while they are in use.
    StringArray words = std::move(implementation_->words);
    words.Empty();
    words.ParseCommandLine(line);
    const bool result = Execute(words);
    implementation_->words = std::move(words);
    return result;
}

bool Model::Execute(const StringArray& tokens) {
    return tokens.IsEmpty() ||
           implementation_->commands.CreateAndExecute(tokens, this, GetCommandFactory());
}

static_assert(Model::ForeseenLines == Foresight::Distance);

void Model::Foresee(const StringArray& words) noexcept {
    implementation_->netlist.Foresee(words);
}

bool Model::Read(const char* fileName) {
    const Use use(this);
    CommandReader reader(*this);
    if (!reader.Open(fileName)) {
        SetModifiedFlag(false);
        return false;
    }
    bool result = true;
    while (const StringArray* words = reader.Next()) {
        result = Execute(*words);
    }
    SetModifiedFlag(false);
    return result && reader.GetError() == 0;
}

bool Model::Write(const char* /*fileName*/) {
    SetModifiedFlag(false);
    return true;
}

void Model::SetOutputGuard(OutputGuard* guard) noexcept {
    implementation_->outputGuard = guard;
}

OutputGuard* Model::GetOutputGuard() const noexcept {
    return implementation_->outputGuard;
}

void Model::RecordWrite(const char* fileName, int error) {
    implementation_->writtenFileName = fileName;
    implementation_->writeError = error;
}

int Model::GetWriteError() const noexcept {
    return implementation_->writeError;
}

Port::StringBase<char> Model::GetWrittenFileName() const {
    return implementation_->writtenFileName;
}

Component* Model::GetComponent(const char* name) const {
    return implementation_->netlist.GetComponent(name);
}

Instance* Model::GetInstance(const char* name) const {
    return implementation_->netlist.GetInstance(name);
}

Signal* Model::GetSignal(const char* name) const {
    return implementation_->netlist.GetSignal(name);
}

Pin* Model::GetPin(const char* name, const Component* component) const {
    return component == nullptr ? nullptr : component->GetPin(name);
}

Pin* Model::GetPin(const char* name, const Instance* instance) const {
    return instance == nullptr ? nullptr : instance->GetPin(name);
}

Attribute* Model::GetAttr(const char* name, const AttributeHolder* holder) const {
    return holder == nullptr ? nullptr : holder->GetAttr(name);
}

bool Model::IsNamedUsed(const char* name) const {
    return implementation_->netlist.IsNameUsed(ViewOf(name));
}

bool Model::AddComponent(const char* name) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    implementation_->netlist.Add(new Component(name));
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPin(const char* name, const Polarity& polarity, const char* componentName,
                   const char* defaultValue) {
    RequireName(__LINE__, name);
    Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    if (component->GetPin(name) != nullptr) {
        FailInModel(__LINE__, "Component \"%s\" already has pin \"%s\".\n",
                    {ViewOf(componentName), name});
    }
    component->AddPin(name, polarity, defaultValue);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddInstance(const char* name, const char* componentName) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    const Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    implementation_->netlist.Add(MakePacked<Instance>(name, component).release());
    SetModifiedFlag(true);
    return true;
}

bool Model::AddSignal(const char* name) {
    DeclareSignal(name);
    SetModifiedFlag(true);
    return true;
}

void Model::DeclareSignal(const char* name) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    Netlist& netlist = implementation_->netlist;
    const Names::NormalizedText normalized{std::string_view(name)};
    Names::BusName parsed;
    const bool isBus = Names::ParseBus(normalized.GetView(), parsed);
    if (isBus && netlist.GetParentBus(name) != nullptr) {
        FailInModel(__LINE__, "Signal \"%s\" already declared.\n", {name});
    }
    if (isBus) {
        netlist.Add(new Bus(name));
    } else {
        netlist.Add(MakePacked<ScalarSignal>(name).release());
    }
}

Signal* Model::GetOrCreateSignal(const char* text) {
    const std::string_view name = ViewOf(text);
    if (Signal* signal = implementation_->netlist.GetSignal(name)) {
        return signal;
    }
    if (IsBitName(name)) {
        return CreateAndAddBusIndexSignal(name);
    }
    if (IsBusName(name)) {
        return CreateAndAddBusSliceSignal(name);
    }
    if (IsCompoundName(name)) {
        return CreateAndAddCompundSignal(name);
    }
    DeclareSignal(text == nullptr ? "" : text);
    return implementation_->netlist.GetSignal(name);
}

Signal* Model::CreateAndAddBusIndexSignal(std::string_view name) {
    Bus* const parent = implementation_->netlist.GetParentBus(std::string(name).c_str());
    if (parent == nullptr) {
        return nullptr;
    }
    Signal* const bit = new BusIndex(SpelledAs(*parent, name).c_str(), parent);
    implementation_->netlist.Add(bit);
    return bit;
}

Signal* Model::CreateAndAddBusSliceSignal(std::string_view name) {
    Netlist& netlist = implementation_->netlist;
    Bus* const present = netlist.GetParentBus(std::string(name).c_str());
    if (present == nullptr) {
        DeclareSignal(std::string(name).c_str());
        return netlist.GetSignal(name);
    }
    const std::string spelled = SpelledAs(*present, name);
    Names::BusName parsed;
    Names::ParseBus(spelled, parsed);
    if (present->GetWidth() > parsed.GetWidth()) {
        Signal* const slice = new BusSlice(spelled.c_str(), present);
        netlist.Add(slice);
        return slice;
    }
    auto wider = std::make_unique<Bus>(spelled.c_str());
    Bus* const result = wider.get();
    auto slice = std::make_unique<BusSlice>(present->GetName().CStr(), result);
    netlist.ReplaceBus(present, std::move(wider), std::move(slice));
    return result;
}

Signal* Model::GetOrCreateMember(std::string_view name) {
    Netlist& netlist = implementation_->netlist;
    Signal* member = netlist.GetSignal(name);
    if (member == nullptr && IsBitName(name)) {
        member = CreateAndAddBusIndexSignal(name);
    } else if (member == nullptr && IsBusName(name)) {
        member = CreateAndAddBusSliceSignal(name);
    }
    if (member == nullptr) {
        DeclareSignal(std::string(name).c_str());
        member = netlist.GetSignal(name);
    }
    return member;
}

Signal* Model::CreateAndAddCompundSignal(std::string_view name) {
    const Names::NormalizedText normalized(name);
    std::string_view piece;
    for (Names::CompoundPieces pieces(normalized.GetView()); pieces.Next(piece);) {
        GetOrCreateMember(piece);
    }
    // A later member may have put a wider bus in the place of an earlier one, so the members are
    // looked up when all of them are there.
    auto compound = std::make_unique<CompoundBus>(std::string(normalized.GetView()).c_str());
    for (Names::CompoundPieces pieces(normalized.GetView()); pieces.Next(piece);) {
        compound->AddBusMember(implementation_->netlist.GetSignal(piece));
    }
    Signal* const result = compound.get();
    implementation_->netlist.Add(compound.release());
    return result;
}

bool Model::Connect(Signal* signal, Pin* pin) {
    if (signal == nullptr || pin == nullptr) {
        return false;
    }
    signal->Connect(pin);
    SetModifiedFlag(true);
    return true;
}

bool Model::Connect(Signal* first, Signal* second) {
    if (first == nullptr || second == nullptr) {
        return false;
    }
    first->Connect(second);
    SetModifiedFlag(true);
    return true;
}

bool Model::ConnectSignalToPin(const char* signalName, const char* instanceName,
                               const char* pinName) {
    Signal* const signal = GetOrCreateSignal(signalName);
    if (signal == nullptr) {
        FailSignalNotFound(__LINE__, signalName);
    }
    const Instance* const instance = GetInstance(instanceName);
    if (instance == nullptr) {
        FailSignalNotFound(__LINE__, instanceName);
    }
    Pin* const pin = instance->GetPin(pinName);
    if (pin == nullptr) {
        FailPinNotFound(__LINE__,
                        std::string(ViewOf(instanceName)).append(".").append(ViewOf(pinName)));
    }
    return Connect(signal, pin);
}

bool Model::ConnectSignals(const char* firstName, const char* secondName) {
    const Signal* const created = GetOrCreateSignal(firstName);
    if (created == nullptr) {
        FailSignalNotFound(__LINE__, firstName);
    }
    // The second name may widen the bus that the first one named, which is then a slice's name. The
    // netlist goes on finding a renamed signal by the name under which it took it.
    const std::string storedName(ObjectKey::Get(*created));
    Signal* const second = GetOrCreateSignal(secondName);
    if (second == nullptr) {
        FailSignalNotFound(__LINE__, secondName);
    }
    return Connect(implementation_->netlist.GetSignal(std::string_view(storedName)), second);
}

bool Model::AssignConstant(Signal* signal, const char* value) {
    if (signal == nullptr) {
        return false;
    }
    signal->AssignConstantValue(value);
    SetModifiedFlag(true);
    return true;
}

bool Model::AssignConstant(Pin* pin, const char* value, const char* instanceName) {
    PinConstantSignalVisitor visitor(instanceName);
    pin->AcceptPin(visitor);
    const char* const name = visitor.GetName().CStr();
    if (GetSignal(name) == nullptr) {
        DeclareSignal(name);
    }
    Signal* const signal = GetSignal(name);
    AssignConstant(signal, value);
    pin->Connect(signal);
    return true;
}

bool Model::AssignConstantToSignal(const char* signalName, const char* value) {
    Signal* const signal = GetOrCreateSignal(signalName);
    if (signal == nullptr) {
        FailSignalNotFound(__LINE__, signalName);
    }
    return AssignConstant(signal, value);
}

bool Model::AssignConstantToPin(const char* instanceName, const char* pinName, const char* value) {
    const Instance* const instance = GetInstance(instanceName);
    if (instance == nullptr) {
        FailSignalNotFound(__LINE__, instanceName);
    }
    Pin* const pin = instance->GetPin(pinName);
    if (pin == nullptr) {
        FailPinNotFound(__LINE__, ViewOf(pinName));
    }
    return AssignConstant(pin, value, instance->GetName().CStr());
}

Component* Model::FindComponent(const char* name) const {
    Component* const component = GetComponent(name);
    if (component == nullptr) {
        FailNotFound(__LINE__, name);
    }
    return component;
}

Instance* Model::FindInstance(const char* name) const {
    Instance* const instance = GetInstance(name);
    if (instance == nullptr) {
        FailNotFound(__LINE__, name);
    }
    return instance;
}

Signal* Model::FindSignal(const char* name) const {
    Signal* const signal = GetSignal(name);
    if (signal == nullptr) {
        FailNotFound(__LINE__, name);
    }
    return signal;
}

Pin* Model::FindComponentPin(const char* component, const char* pinName) const {
    Pin* const pin = GetPin(pinName, GetComponent(component));
    if (pin == nullptr) {
        FailPinNotFound(__LINE__, ViewOf(pinName));
    }
    return pin;
}

Pin* Model::FindInstancePin(const char* instance, const char* pinName) const {
    Pin* const pin = GetPin(pinName, GetInstance(instance));
    if (pin == nullptr) {
        FailPinNotFound(__LINE__, ViewOf(pinName));
    }
    return pin;
}

bool Model::AddAttr(AttributeHolder* holder, const char* name, const char* value,
                    const char* type) {
    if (holder == nullptr) {
        return false;
    }
    if (Attribute* present = holder->GetAttr(name)) {
        present->SetValue(value);
    } else {
        const auto creator = implementation_->attributeCreators.Get(
            type == nullptr ? Attribute::DEFAULT_ATTRTYPE : type);
        if (creator == nullptr) {
            FailInModel(__LINE__, "Invalid attribute type.\n");
        }
        holder->AddAttr(creator(name, value));
    }
    SetModifiedFlag(true);
    return true;
}

bool Model::AddModuleAttr(const char* name, const char* value, const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(&implementation_->netlist, name, value, type);
}

bool Model::AddComponentAttr(const char* component, const char* name, const char* value,
                             const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(FindComponent(component), name, value, type);
}

bool Model::AddInstanceAttr(const char* instance, const char* name, const char* value,
                            const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(FindInstance(instance), name, value, type);
}

bool Model::AddSignalAttr(const char* signal, const char* name, const char* value,
                          const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(FindSignal(signal), name, value, type);
}

bool Model::AddComponentPinAttr(const char* component, const char* pin, const char* name,
                                const char* value, const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(FindComponentPin(component, pin), name, value, type);
}

bool Model::AddInstancePinAttr(const char* instance, const char* pin, const char* name,
                               const char* value, const char* type) {
    RequireName(__LINE__, name);
    return AddAttr(FindInstancePin(instance, pin), name, value, type);
}

Attribute* Model::GetInstanceOrComponentAttr(const char* name, const Instance* instance) const {
    Attribute* const own = GetAttr(name, instance);
    return own != nullptr || instance == nullptr ? own : instance->GetComponentAttr(name);
}

Attribute* Model::FindAttr(const char* name, const AttributeHolder* holder) const {
    Attribute* const attribute = GetAttr(name, holder);
    if (attribute == nullptr) {
        FailInModel(__LINE__, "Attribute \"%s\" not found.\n", {ViewOf(name)});
    }
    return attribute;
}

Attribute* Model::FindInstanceAttr(const char* instance, const char* name) const {
    Attribute* const attribute = GetInstanceOrComponentAttr(name, FindInstance(instance));
    if (attribute == nullptr) {
        FailInModel(__LINE__, "Attribute \"%s\" not found.\n", {ViewOf(name)});
    }
    return attribute;
}

bool Model::SetAttrValue(Attribute* attribute, const char* value) {
    attribute->SetValue(value);
    SetModifiedFlag(true);
    return true;
}

bool Model::SetGenericAttrValue(Attribute* attribute, const char* value) {
    if (!attribute->SetGeneric(value)) {
        FailInModel(__LINE__, "Invalid generic value.\n");
    }
    SetModifiedFlag(true);
    return true;
}

bool Model::SetSynAttrValue(Attribute* attribute, const char* value) {
    if (!attribute->SetSynAttr(value)) {
        FailInModel(__LINE__, "Invalid generic value.\n");
    }
    SetModifiedFlag(true);
    return true;
}

bool Model::SetUserType(Attribute* attribute, const char* type) {
    auto* const user = dynamic_cast<AttributeUser*>(attribute);
    if (user == nullptr) {
        FailInModel(__LINE__, "Invalid attribute type.\n");
    }
    user->SetUserType(type);
    SetModifiedFlag(true);
    return true;
}

bool Model::SetAttrValue(AttributeHolder* holder, const char* attribute, const char* value) {
    return holder != nullptr && SetAttrValue(FindAttr(attribute, holder), value);
}

bool Model::SetModuleAttrValue(const char* attribute, const char* value) {
    return SetAttrValue(FindAttr(attribute, &implementation_->netlist), value);
}

bool Model::SetComponentAttrValue(const char* component, const char* attribute, const char* value) {
    return SetAttrValue(FindAttr(attribute, FindComponent(component)), value);
}

bool Model::SetInstanceAttrValue(const char* instance, const char* attribute, const char* value) {
    return SetAttrValue(FindInstanceAttr(instance, attribute), value);
}

bool Model::SetSignalAttrValue(const char* signal, const char* attribute, const char* value) {
    return SetAttrValue(FindAttr(attribute, FindSignal(signal)), value);
}

bool Model::SetComponentPinAttrValue(const char* component, const char* pin, const char* attribute,
                                     const char* value) {
    return SetAttrValue(FindAttr(attribute, FindComponentPin(component, pin)), value);
}

bool Model::SetInstancePinAttrValue(const char* instance, const char* pin, const char* attribute,
                                    const char* value) {
    return SetAttrValue(FindAttr(attribute, FindInstancePin(instance, pin)), value);
}

bool Model::SetGenericAttrValue(AttributeHolder* holder, const char* attribute, const char* value) {
    return holder != nullptr && SetGenericAttrValue(FindAttr(attribute, holder), value);
}

bool Model::SetModuleGenericAttrValue(const char* attribute, const char* value) {
    return SetGenericAttrValue(FindAttr(attribute, &implementation_->netlist), value);
}

bool Model::SetComponentGenericAttrValue(const char* component, const char* attribute,
                                         const char* value) {
    return SetGenericAttrValue(FindAttr(attribute, FindComponent(component)), value);
}

bool Model::SetInstanceGenericAttrValue(const char* instance, const char* attribute,
                                        const char* value) {
    return SetGenericAttrValue(FindInstanceAttr(instance, attribute), value);
}

bool Model::SetSignalGenericAttrValue(const char* signal, const char* attribute,
                                      const char* value) {
    return SetGenericAttrValue(FindAttr(attribute, FindSignal(signal)), value);
}

bool Model::SetComponentPinGenericAttrValue(const char* component, const char* pin,
                                            const char* attribute, const char* value) {
    return SetGenericAttrValue(FindAttr(attribute, FindComponentPin(component, pin)), value);
}

bool Model::SetInstancePinGenericAttrValue(const char* instance, const char* pin,
                                           const char* attribute, const char* value) {
    return SetGenericAttrValue(FindAttr(attribute, FindInstancePin(instance, pin)), value);
}

bool Model::SetSynAttrValue(AttributeHolder* holder, const char* attribute, const char* value) {
    return holder != nullptr && SetSynAttrValue(FindAttr(attribute, holder), value);
}

bool Model::SetModuleSynAttrValue(const char* attribute, const char* value) {
    return SetSynAttrValue(FindAttr(attribute, &implementation_->netlist), value);
}

bool Model::SetComponentSynAttrValue(const char* component, const char* attribute,
                                     const char* value) {
    return SetSynAttrValue(FindAttr(attribute, FindComponent(component)), value);
}

bool Model::SetInstanceSynAttrValue(const char* instance, const char* attribute,
                                    const char* value) {
    return SetSynAttrValue(FindInstanceAttr(instance, attribute), value);
}

bool Model::SetSignalSynAttrValue(const char* signal, const char* attribute, const char* value) {
    return SetSynAttrValue(FindAttr(attribute, FindSignal(signal)), value);
}

bool Model::SetComponentPinSynAttrValue(const char* component, const char* pin,
                                        const char* attribute, const char* value) {
    return SetSynAttrValue(FindAttr(attribute, FindComponentPin(component, pin)), value);
}

bool Model::SetInstancePinSynAttrValue(const char* instance, const char* pin, const char* attribute,
                                       const char* value) {
    return SetSynAttrValue(FindAttr(attribute, FindInstancePin(instance, pin)), value);
}

bool Model::SetUserType(AttributeHolder* holder, const char* attribute, const char* type) {
    return holder != nullptr && SetUserType(FindAttr(attribute, holder), type);
}

bool Model::SetModuleUserType(const char* attribute, const char* type) {
    return SetUserType(FindAttr(attribute, &implementation_->netlist), type);
}

bool Model::SetComponentUserType(const char* component, const char* attribute, const char* type) {
    return SetUserType(FindAttr(attribute, FindComponent(component)), type);
}

bool Model::SetInstanceUserType(const char* instance, const char* attribute, const char* type) {
    return SetUserType(FindInstanceAttr(instance, attribute), type);
}

bool Model::SetSignalUserType(const char* signal, const char* attribute, const char* type) {
    return SetUserType(FindAttr(attribute, FindSignal(signal)), type);
}

bool Model::SetComponentPinUserType(const char* component, const char* pin, const char* attribute,
                                    const char* type) {
    return SetUserType(FindAttr(attribute, FindComponentPin(component, pin)), type);
}

bool Model::SetInstancePinUserType(const char* instance, const char* pin, const char* attribute,
                                   const char* type) {
    return SetUserType(FindAttr(attribute, FindInstancePin(instance, pin)), type);
}

bool Model::AddComment(Object& object, const char* text) {
    object.AddComment(text);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddNotes(const char* text) {
    return text == nullptr || AddComment(implementation_->netlist, text);
}

bool Model::AddComponentComment(const char* component, const char* text) {
    return AddComment(*FindComponent(component), text);
}

bool Model::AddInstanceComment(const char* instance, const char* text) {
    return AddComment(*FindInstance(instance), text);
}

bool Model::AddSignalComment(const char* signal, const char* text) {
    return AddComment(*FindSignal(signal), text);
}

bool Model::AddComponentPinComment(const char* component, const char* pin, const char* text) {
    return text == nullptr || AddComment(*FindComponentPin(component, pin), text);
}

bool Model::AddInstancePinComment(const char* instance, const char* pin, const char* text) {
    return text == nullptr || AddComment(*FindInstancePin(instance, pin), text);
}

} // namespace Orn_Hdl
