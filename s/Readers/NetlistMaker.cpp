#include "Readers/NetlistMaker.h"

#include "HdlModel/Objects/MakePacked.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>
#include <memory>
#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// What a netlist takes for something else than a part of a name.
constexpr std::string_view Meaningful = "()[]{}<>-:,\\\"";

void AppendNumber(std::string& text, int number) {
    char digits[16];
    const auto result = std::to_chars(digits, digits + sizeof digits, number);
    text.append(digits, result.ptr);
}

void AppendRange(std::string& text, const Range& range) {
    text += '(';
    AppendNumber(text, range.left);
    text += ':';
    AppendNumber(text, range.right);
    text += ')';
}

bool IsSimple(std::string_view name) {
    if (name.empty() || Port::IsDigit(name.front())) {
        return false;
    }
    for (const char c : name) {
        if (!Port::IsLetter(c) && !Port::IsDigit(c) && c != '_') {
            return false;
        }
    }
    return true;
}

/// \param initial stands in front of a name that would begin with a digit or be empty.
std::string MakeSimple(std::string_view name, char initial) {
    std::string result;
    for (const char c : name) {
        if (Port::IsLetter(c) || Port::IsDigit(c)) {
            result += c;
        } else if (!result.empty() && result.back() != '_') {
            result += '_';
        }
    }
    while (!result.empty() && result.back() == '_') {
        result.pop_back();
    }
    if (result.empty() || Port::IsDigit(result.front())) {
        result.insert(result.begin(), initial);
    }
    return result;
}

std::string InSmallLetters(std::string_view name) {
    std::string result(name);
    std::transform(result.begin(), result.end(), result.begin(), Port::ToLower);
    return result;
}

/// Whether a bus has this base name.
bool HasBase(std::string_view busName, std::string_view base, bool isExact) {
    if (busName.size() <= base.size() || busName[base.size()] != '(') {
        return false;
    }
    busName = busName.substr(0, base.size());
    return isExact ? busName == base : Port::EqualIgnoringCase(busName, base);
}

} // namespace

bool NetlistMaker::IsOpenWord(std::string_view name) noexcept {
    return Port::EqualIgnoringCase(name, "open");
}

std::size_t NetlistMaker::RenamingHash::operator()(std::string_view name) const noexcept {
    if (!ignoresCase || IsExtended(name)) {
        return std::hash<std::string_view>()(name);
    }
    return std::hash<std::string_view>()(InSmallLetters(name));
}

NetlistMaker::NetlistMaker(Netlist& netlist, ReaderNames names, const NameRules& rules,
                           NetlistSink* sink)
    : netlist_(netlist), names_(names), rules_(rules),
      renamed_(0, RenamingHash{&renamings_, rules.ignoresCase},
               RenamingEqual{&renamings_, rules.ignoresCase}),
      sink_(sink) {}

Owner NetlistMaker::GetOwner(const AttributeHolder& holder) const noexcept {
    if (&holder == &netlist_) {
        return {};
    }
    if (&holder == instance_.get()) {
        return {Owner::Instance, nullptr, instanceName_};
    }
    return {Owner::Signal, static_cast<const Signal*>(&holder), {}};
}

/// The name without the backslashes that are part of it; valid until the next call.
const std::string& NetlistMaker::Plain(const std::string& name) const {
    if (!rules_.ignoresCase || !IsExtended(name)) {
        return name;
    }
    plain_.assign(name, 1, name.size() - 2);
    return plain_;
}

/// Whether the file may have had to escape a name.
bool NetlistMaker::MayBeEscaped(std::string_view name) const noexcept {
    return !rules_.ignoresCase || IsExtended(name);
}

void NetlistMaker::SetName(const std::string& name) {
    if (sink_ != nullptr) {
        sink_->TakeModule(name, place_);
        return;
    }
    const std::string& plain = Plain(name);
    const bool isEscaped = MayBeEscaped(name);
    const bool isKept = names_ == ReaderNames::Literal || CanKeep(plain, false, isEscaped);
    std::string newName = isKept ? plain : MakeSimple(plain, 'm');
    if (!isKept && !CanKeep(newName, false, isEscaped)) {
        newName = MakeUnique(newName);
    }
    if (!isKept) {
        renamings_.push_back({name, newName, ReaderRenaming::Kind::Module});
    }
    netlist_.SetName(newName.c_str());
}

/// Whether a netlist can have an object of that name and tell it from others.
/// \param isEscaped whether the file may have had to escape it.
bool NetlistMaker::CanKeep(std::string_view name, bool isBus, bool isEscaped) const {
    const bool isLiteral = names_ == ReaderNames::Literal;
    if (!isLiteral && IsOpenWord(name)) {
        return false;
    }
    if (!isLiteral && rules_.keeps && !rules_.keeps(name)) {
        return false;
    }
    if (IsSimple(name)) {
        return isLiteral || !isEscaped || !rules_.isReserved(name);
    }
    if (name.empty() || isBus) {
        return false;
    }
    if (isLiteral) {
        return name.find_first_of(Meaningful) == std::string_view::npos && name.front() != '\'';
    }
    // A name of letters, digits, "_" and "$".
    bool hasOther = Port::IsDigit(name.front()) || name.front() == '$';
    for (const char c : name) {
        hasOther = hasOther || !(Port::IsLetter(c) || Port::IsDigit(c) || c == '_' ||
                                 (c == '$' && rules_.allowsDollar));
    }
    return !hasOther;
}

bool NetlistMaker::IsTaken(const std::string& name) const {
    return netlist_.IsNameUsed(name) || netlist_.GetParentBus(name.c_str()) != nullptr;
}

const std::string* NetlistMaker::FindRenamed(std::string_view name) const {
    if (renamed_.empty()) {
        return nullptr;
    }
    const auto found = renamed_.find(name);
    return found == renamed_.end() ? nullptr : &renamings_[*found].newName;
}

std::string NetlistMaker::MakeUnique(const std::string& name) {
    unsigned& suffix = lastSuffixes_.try_emplace(name, 1).first->second;
    // A caller that keeps no name at all gets one that it would not keep.
    constexpr int MostRefused = 100;
    for (int refused = 0;;) {
        std::string unique = name + "_" + std::to_string(++suffix);
        if (IsTaken(unique)) {
            continue;
        }
        if (refused++ >= MostRefused || CanKeep(unique, false)) {
            return unique;
        }
    }
}

/// Whether an object of the file has that name. \param isTaken whether one of the netlist has it.
bool NetlistMaker::IsDeclared(const std::string& name, bool isTaken) const {
    return FindRenamed(name) != nullptr ||
           (isTaken && (FindSignal(name) != nullptr || FindInstance(name) != nullptr));
}

void NetlistMaker::AddRenaming(const std::string& name, const std::string& newName,
                               ReaderRenaming::Kind kind) {
    renamings_.push_back({name, newName, kind});
    renamed_.insert(static_cast<std::uint32_t>(renamings_.size() - 1));
    newNames_.insert(InSmallLetters(newName));
}

bool NetlistMaker::IsRenamedTo(std::string_view newName) const {
    return !newNames_.empty() && newNames_.find(InSmallLetters(newName)) != newNames_.end();
}

const std::string& NetlistMaker::MakeName(const std::string& name, bool isBus, bool isTaken,
                                          ReaderRenaming::Kind kind) {
    const std::string& plain = Plain(name);
    const bool isBasic = &plain == &name;
    if (!isTaken && CanKeep(plain, isBus, MayBeEscaped(name))) {
        if (isBasic) {
            return name;
        }
        newName_ = plain;
        if (IsSimple(plain)) {
            // The file may have this name without backslashes too, and mean another object.
            AddRenaming(name, newName_, kind);
        }
        return newName_;
    }
    newName_ = IsSimple(plain) && CanKeep(plain, isBus)
                   ? plain
                   : MakeSimple(plain, kind == ReaderRenaming::Kind::Instance ? 'u' : 'n');
    if (!CanKeep(newName_, isBus) || IsTaken(newName_)) {
        newName_ = MakeUnique(newName_);
    }
    AddRenaming(name, newName_, kind);
    return newName_;
}

Signal* NetlistMaker::DeclareSignal(const std::string& name, const std::optional<Range>& range) {
    if (sink_ != nullptr) {
        return sink_->Declare(name, range, Polarity::Invalid, place_);
    }
    const bool isTaken = IsTaken(Plain(name));
    if (IsDeclared(name, isTaken)) {
        return nullptr;
    }
    const std::string& newName =
        MakeName(name, range.has_value(), isTaken, ReaderRenaming::Kind::Signal);
    Signal* signal = nullptr;
    if (range) {
        text_ = newName;
        AppendRange(text_, *range);
        signal = new Bus(text_.c_str());
    } else {
        signal = MakePacked<ScalarSignal>(newName.c_str()).release();
    }
    netlist_.Add(signal);
    return signal;
}

Signal* NetlistMaker::DeclarePort(const PortHead& port) {
    if (sink_ != nullptr) {
        return sink_->Declare(port.name, port.range, port.direction, port.place);
    }
    Signal* const signal = DeclareSignal(port.name, port.range);
    if (signal != nullptr) {
        signal->SetPortPolarity(Polarity(port.direction));
    }
    return signal;
}

Instance* NetlistMaker::AddInstance(const std::string& name, const ModuleHead& head) {
    const Component& component = *head.component;
    if (sink_ != nullptr) {
        if (instance_ == nullptr || instance_->GetComponent() != &component) {
            instance_ = MakePacked<Instance>("", &component);
        }
        instanceName_ = name;
        sink_->BeginInstance(name, head, place_);
        return instance_.get();
    }
    const bool isTaken = IsTaken(Plain(name));
    if (IsDeclared(name, isTaken)) {
        return nullptr;
    }
    auto instance = MakePacked<Instance>(
        MakeName(name, false, isTaken, ReaderRenaming::Kind::Instance).c_str(), &component);
    Instance* const added = instance.get();
    netlist_.Add(instance.release());
    return added;
}

Signal* NetlistMaker::FindByNewName(const std::string& name, bool isExact) const {
    Signal* const signal = netlist_.GetSignal(std::string_view(name));
    if (signal != nullptr && (isExact ? signal->GetNameView() == name
                                      : Port::EqualIgnoringCase(signal->GetNameView(), name))) {
        return signal;
    }
    Bus* const bus = netlist_.GetParentBus(name.c_str());
    return bus != nullptr && HasBase(bus->GetNameView(), name, isExact) ? bus : nullptr;
}

bool NetlistMaker::CanBeFound(std::string_view plain, bool isBasic) const {
    return (IsSimple(plain) ? isBasic : CanKeep(plain, false)) && !IsRenamedTo(plain);
}

Signal* NetlistMaker::FindSignal(const std::string& name) const {
    if (sink_ != nullptr) {
        return sink_->FindSignal(name);
    }
    if (const std::string* const renamed = FindRenamed(name)) {
        return FindByNewName(*renamed, true);
    }
    const std::string& plain = Plain(name);
    const bool isBasic = &plain == &name;
    if (!CanBeFound(plain, isBasic)) {
        return nullptr;
    }
    Signal* const signal = FindByNewName(plain, !rules_.ignoresCase || !isBasic);
    return signal == nullptr || made_.empty() || made_.find(signal) == made_.end() ? signal
                                                                                   : nullptr;
}

Instance* NetlistMaker::FindInstance(const std::string& name) const {
    if (sink_ != nullptr) {
        return instance_ != nullptr && instanceName_ == name ? instance_.get() : nullptr;
    }
    if (const std::string* const renamed = FindRenamed(name)) {
        return netlist_.GetInstance(std::string_view(*renamed));
    }
    const std::string& plain = Plain(name);
    const bool isBasic = &plain == &name;
    if (!CanBeFound(plain, isBasic)) {
        return nullptr;
    }
    Instance* const instance = netlist_.GetInstance(std::string_view(plain));
    const bool isExact = !rules_.ignoresCase || !isBasic;
    return instance != nullptr && (!isExact || instance->GetNameView() == plain) ? instance
                                                                                 : nullptr;
}

Range NetlistMaker::GetRange(const Bus& bus) {
    Range range;
    bus.GetIndex(range.left, range.right);
    return range;
}

Signal* NetlistMaker::FindPart(const std::string& name) const {
    Signal* const present = sink_ == nullptr ? nullptr : sink_->FindSignal(name);
    return present != nullptr ? present : netlist_.GetSignal(std::string_view(name));
}

Signal* NetlistMaker::GetBit(Bus& bus, int index) {
    const std::string_view name = bus.GetNameView();
    text_ = name.substr(0, name.find('(') + 1);
    AppendNumber(text_, index);
    text_ += ')';
    Signal* bit = FindPart(text_);
    if (bit == nullptr) {
        bit = new BusIndex(text_.c_str(), sink_ == nullptr ? &bus : nullptr);
        netlist_.Add(bit);
    }
    return bit;
}

Signal* NetlistMaker::GetSlice(Bus& bus, const Range& range) {
    if (range == GetRange(bus)) {
        return &bus;
    }
    const std::string_view name = bus.GetNameView();
    text_ = name.substr(0, name.find('('));
    AppendRange(text_, range);
    Signal* slice = FindPart(text_);
    if (slice == nullptr) {
        slice = new BusSlice(text_.c_str(), sink_ == nullptr ? &bus : nullptr);
        netlist_.Add(slice);
    }
    return slice;
}

Signal* NetlistMaker::GetConcatenation(const std::vector<Signal*>& members) {
    text_.clear();
    for (const Signal* member : members) {
        text_.append(text_.empty() ? "" : ",").append(member->GetNameView());
    }
    if (Signal* const present = netlist_.GetSignal(std::string_view(text_))) {
        return present;
    }
    auto compound = std::make_unique<CompoundBus>(text_.c_str());
    for (Signal* member : members) {
        compound->AddBusMember(member);
    }
    Signal* const added = compound.get();
    netlist_.Add(compound.release());
    return added;
}

Signal* NetlistMaker::GetSignal(const std::vector<Piece>& pieces) {
    if (pieces.size() == 1 && pieces.front().signal != nullptr) {
        return pieces.front().signal;
    }
    return GetConcatenation(GetMembers(pieces));
}

const Members& NetlistMaker::GetMembers(const std::vector<Piece>& pieces) {
    members_.clear();
    for (const Piece& piece : pieces) {
        if (piece.signal != nullptr) {
            members_.push_back(piece.signal);
        }
        for (const char bit : piece.bits) {
            members_.push_back(GetConstantNet(bit));
        }
    }
    return members_;
}

Signal* NetlistMaker::GetConstantNet(char bit) {
    static constexpr struct {
        const char* name;
        const char* value;
    } Nets[] = {{"const_0", "0"}, {"const_1", "1"}, {"const_x", "-"}};
    const std::size_t kind = bit == '1' ? 1 : bit == '-' ? 2 : 0;
    Signal*& net = constantNets_[kind];
    if (net == nullptr) {
        std::string name = Nets[kind].name;
        if (IsTaken(name)) {
            name = MakeUnique(name);
        }
        auto signal = MakePacked<ScalarSignal>(name.c_str());
        signal->AssignConstantValue(Nets[kind].value);
        made_.insert(signal.get());
        net = signal.get();
        netlist_.Add(signal.release());
    }
    return net;
}

void NetlistMaker::ConnectConstant(const Instance& instance, Pin& pin,
                                   const std::string& constant) {
    std::string owner(instance.GetNameView());
    Port::String name;
    for (unsigned suffix = 2;; ++suffix) {
        PinConstantSignalVisitor visitor(owner.c_str());
        pin.AcceptPin(visitor);
        name = visitor.GetName();
        const std::string_view view = name;
        if (!IsTaken(std::string(view.substr(0, view.find('('))))) {
            break;
        }
        owner.assign(instance.GetNameView()).append("_").append(std::to_string(suffix));
    }
    std::unique_ptr<Signal> signal;
    if (pin.GetPinType() == PinTypeBus) {
        signal = std::make_unique<Bus>(name.CStr());
    } else {
        signal = MakePacked<ScalarSignal>(name.CStr());
    }
    signal->AssignConstantValue(constant.c_str());
    Signal* const added = signal.release();
    netlist_.Add(added);
    made_.insert(added);
    pin.Connect(added);
}

std::string NetlistMaker::MakeComponent(ModuleHead& head) {
    if (head.component != nullptr) {
        return "";
    }
    if (head.isPrimitive) {
        return "it is a primitive, whose ports have no names";
    }
    if (sink_ != nullptr) {
        return MakeStandIn(head);
    }
    const std::string plain = Plain(head.name);
    const bool canKeep = CanKeep(plain, false, MayBeEscaped(head.name));
    if (canKeep && netlist_.GetComponent(std::string_view(plain)) != nullptr) {
        return "a model does not tell it from another component, whose name differs in letter case "
               "alone";
    }
    std::string name = canKeep ? plain : MakeSimple(plain, 'c');
    if (!CanKeep(name, false) || IsTaken(name)) {
        name = MakeUnique(name);
    }
    auto component = std::make_unique<Component>(name.c_str());
    std::string problem = MakePins(head, *component);
    if (!problem.empty()) {
        return problem;
    }
    if (name != head.name) {
        renamings_.push_back({head.name, name, ReaderRenaming::Kind::Component});
    }
    head.component = component.get();
    netlist_.Add(component.release());
    return "";
}

/// The name without a range of the pin that is made of a port.
std::string NetlistMaker::MakePinName(const PortHead& port, const ModuleHead& head,
                                      const Component& component) const {
    const bool isBus = port.range.has_value();
    const std::string& plain = Plain(port.name);
    if (CanKeep(plain, isBus, MayBeEscaped(port.name))) {
        return plain;
    }
    std::string similar = MakeSimple(plain, 'p');
    std::string name = similar;
    constexpr unsigned Most = 100;
    for (unsigned suffix = 2; suffix < Most; ++suffix) {
        // Those that follow keep their names.
        const std::size_t same = head.FindPort(name, 0);
        if (CanKeep(name, isBus) && component.GetPin(name.c_str()) == nullptr &&
            (same == head.ports.size() || &head.ports[same] == &port)) {
            return name;
        }
        name = similar + "_" + std::to_string(suffix);
    }
    return similar;
}

/// Makes a component that stands for a module, when there is a sink.
std::string NetlistMaker::MakeStandIn(ModuleHead& head) {
    auto component = std::make_unique<Component>(head.name.c_str());
    head.component = component.get();
    netlist_.Add(component.release());
    return "";
}

std::string NetlistMaker::MakePins(const ModuleHead& head, Component& component) {
    for (const PortHead& port : head.ports) {
        if (!port.problem.empty()) {
            return "of its port " + Quoted(port.name) + ": " + port.problem;
        }
        if (head.isDeclared && !Polarity::IsValidValue(port.direction)) {
            return "its port " + Quoted(port.name) + " has no direction";
        }
        std::string name = MakePinName(port, head, component);
        const std::string base = name;
        if (port.range) {
            AppendRange(name, *port.range);
        }
        // Long lists of pins have an index.
        if (component.GetPin(name.c_str()) != nullptr) {
            return "its port " + Quoted(port.name) +
                   " is one that a model does not tell from another one";
        }
        if (base != port.name) {
            renamings_.push_back(
                {port.name, base, ReaderRenaming::Kind::Pin, std::string(component.GetNameView())});
        }
        component.AddPin(name.c_str(), Polarity(port.direction), "");
    }
    return "";
}

} // namespace Orn_Hdl::Readers
