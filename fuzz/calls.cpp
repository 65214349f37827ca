// The input chooses calls of the class interface on one design, in any order: they create, connect,
// rename, remove, copy and widen objects and write the netlist.

#include "Bytes.h"
#include "Check.h"
#include "CommandScripts.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Sampling.h"
#include "Writes.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace {

using Fuzz::Check;
using Fuzz::Checks;
using namespace Orn_Hdl;

constexpr int MostCalls = 300;
constexpr int MostWrites = 2;
/// How many calls are made between two checks of the whole design.
constexpr int CallsPerCheck = 8;
/// One input in so many is run with all checks.
constexpr std::size_t InputsPerFullCheck = 16;

constexpr const char* Names[] = {"A",
                                 "B",
                                 "n1",
                                 "N1",
                                 "D(7:0)",
                                 "D[3:0]",
                                 "D(15:0)",
                                 "D(0:3)",
                                 "D(2)",
                                 "d(7)",
                                 "E(0:7)",
                                 "E(3:1)",
                                 "E(5)",
                                 "F(1:1)",
                                 "A,B",
                                 "A,D(3:0)",
                                 "n1\\D(2)",
                                 "A_DUMMY",
                                 "D_DUMMY(7:0)",
                                 "U1",
                                 "open",
                                 "",
                                 "G(2147483647:-2147483648)"};
constexpr const char* PinNames[] = {"I", "O", "D(3:0)", "D(7:0)", "Q(0:1)", "B(2)", ""};
constexpr const char* Values[] = {"1", "8:H:FF", "4:B:1010", "", "x", "9999999999:B:1"};
constexpr const char* Types[] = {"String", "Integer",   "Float", "Boolean",
                                 "Bit",    "BitVector", "User"};
constexpr const char* Comments[] = {"text", "two\nlines", "*/ endmodule", ""};

template <class T> T* At(const Iterator<T*>& list, int index) {
    std::vector<T*> all;
    for (T* element : list) {
        all.push_back(element);
    }
    return all.empty() ? nullptr : all[static_cast<std::size_t>(index) % all.size()];
}

class Player {
public:
    Player(Fuzz::Bytes bytes, Checks checks) : bytes_(bytes), checks_(checks) {}

    void Play() {
        for (int i = 0; i < MostCalls && !bytes_.IsAtEnd(); ++i) {
            try {
                Call();
            } catch (const Orn_Hdl::Exception&) {
                // An operation by name throws if its arguments do not fit.
            }
            if (checks_ == Checks::All && i % CallsPerCheck == 0) {
                Fuzz::CheckNetlist(GetNetlist(), GetLoose());
            }
        }
        if (checks_ == Checks::All) {
            Fuzz::CheckCommands(model_);
        }
        Write();
        // Loose signals are destroyed before the design or after it.
        if (bytes_.Choose(2) == 0) {
            loose_.clear();
        }
    }

private:
    Netlist& GetNetlist() { return *model_.GetNetlist(); }

    std::vector<Signal*> GetLoose() const {
        std::vector<Signal*> loose;
        for (const std::unique_ptr<Signal>& signal : loose_) {
            loose.push_back(signal.get());
        }
        return loose;
    }

    const char* PickName() { return bytes_.Pick(Names); }
    Polarity PickPolarity() { return Polarity(bytes_.Choose(5) - 1); }

    Signal* PickSignal() {
        const int which = bytes_.Choose(256);
        const std::size_t looseCount = loose_.size();
        if (looseCount > 0 && which % 4 == 3) {
            return loose_[static_cast<std::size_t>(which) % looseCount].get();
        }
        return At(GetNetlist().GetSignalIterator(), which);
    }

    template <class T> T* PickOf(int type) {
        for (int tries = 0; tries < 4; ++tries) {
            Signal* const signal = PickSignal();
            if (signal != nullptr && signal->GetSignalType() == type) {
                return static_cast<T*>(signal);
            }
        }
        return nullptr;
    }

    Bus* PickBus() { return PickOf<Bus>(SignalTypeBus); }
    Component* PickComponent() {
        return At(GetNetlist().GetComponentIterator(), bytes_.Choose(256));
    }
    Instance* PickInstance() { return At(GetNetlist().GetInstanceIterator(), bytes_.Choose(256)); }

    Pin* PickPin() {
        if (bytes_.Choose(8) == 7) {
            const Component* const component = PickComponent();
            return component == nullptr ? nullptr
                                        : At(component->GetPinIterator(), bytes_.Choose(256));
        }
        const Instance* const instance = PickInstance();
        return instance == nullptr ? nullptr : At(instance->GetPinIterator(), bytes_.Choose(256));
    }

    AttributeHolder* PickHolder() {
        switch (bytes_.Choose(5)) {
        case 0:
            return &GetNetlist();
        case 1:
            return PickSignal();
        case 2:
            return PickComponent();
        case 3:
            return PickInstance();
        default:
            return PickPin();
        }
    }

    std::unique_ptr<Signal> MakeSignal() {
        switch (bytes_.Choose(6)) {
        case 0:
            return std::make_unique<ScalarSignal>(PickName());
        case 1:
            return std::make_unique<Bus>(PickName());
        case 2: {
            const char* const name = PickName();
            return std::make_unique<BusSlice>(name, PickBus());
        }
        case 3: {
            const char* const name = PickName();
            return std::make_unique<BusIndex>(name, PickBus());
        }
        case 4: {
            auto compound = std::make_unique<CompoundBus>(PickName());
            for (int i = bytes_.Choose(4); i > 0; --i) {
                compound->AddBusMember(PickSignal());
            }
            return compound;
        }
        default: {
            const Signal* const model = PickSignal();
            if (model == nullptr) {
                return std::make_unique<ScalarSignal>(PickName());
            }
            return MakeDummy(*model);
        }
        }
    }

    std::unique_ptr<Signal> MakeDummy(const Signal& signal) {
        switch (signal.GetSignalType()) {
        case SignalTypeScalar:
            return std::unique_ptr<Signal>(
                static_cast<const ScalarSignal&>(signal).CreateDummySignal());
        case SignalTypeBus:
            return std::unique_ptr<Signal>(static_cast<const Bus&>(signal).CreateDummySignal());
        case SignalTypeBusSlice:
            return std::unique_ptr<Signal>(
                static_cast<const BusSlice&>(signal).CreateDummySignal(PickBus()));
        case SignalTypeBusIndex:
            return std::unique_ptr<Signal>(
                static_cast<const BusIndex&>(signal).CreateDummySignal(PickBus()));
        default:
            return std::unique_ptr<Signal>(
                static_cast<const CompoundBus&>(signal).CreateDummySignal());
        }
    }

    void Call() {
        // Few bytes lead to calls about ownership, so that the others keep their meaning.
        constexpr int LeastOfOwning = 232;
        const int choice = bytes_.Choose(256);
        if (choice >= LeastOfOwning) {
            return Own();
        }
        switch (choice % 6) {
        case 0:
            return Make();
        case 1:
            return Wire();
        case 2:
            return Change();
        case 3:
            return Remove();
        case 4:
            return CallByName();
        default:
            return Prepare();
        }
    }

    void Make() {
        switch (bytes_.Choose(7)) {
        case 0:
            return GetNetlist().Add(new Component(PickName()));
        case 1:
            if (Component* component = PickComponent()) {
                const char* const name = bytes_.Pick(PinNames);
                const Polarity polarity = PickPolarity();
                component->AddPin(name, polarity, bytes_.Pick(Values));
            }
            return;
        case 2:
            if (Component* component = PickComponent()) {
                if (const Pin* pin = PickPin()) {
                    component->AddPin(*pin);
                }
            }
            return;
        case 3: {
            const char* const name = PickName();
            return GetNetlist().Add(new Instance(name, PickComponent()));
        }
        case 4:
            loose_.push_back(MakeSignal());
            return;
        case 5:
            return AddLoose();
        default:
            return GetNetlist().Add(MakeSignal().release());
        }
    }

    void AddLoose() {
        if (!loose_.empty()) {
            GetNetlist().Add(loose_.back().release());
            loose_.pop_back();
        } else {
            // The netlist holds the signal already, so nothing is added.
            GetNetlist().Add(PickSignal());
        }
    }

    void Wire() {
        Signal* const signal = PickSignal();
        if (signal == nullptr) {
            return;
        }
        switch (bytes_.Choose(10)) {
        case 0:
        case 1:
        case 2:
            return signal->Connect(PickPin());
        case 3:
            return signal->Connect(PickSignal());
        case 4:
            return signal->Disconnect(PickPin());
        case 5:
            return signal->Disconnect(PickSignal());
        case 6:
            return signal->DisconnectAll();
        case 7:
            return signal->CloneConnection(PickSignal());
        case 8:
            if (Pin* pin = PickPin()) {
                pin->Connect(signal);
            }
            return;
        default:
            if (Pin* pin = PickPin()) {
                pin->Disconnect();
            }
            return;
        }
    }

    void Change() {
        switch (bytes_.Choose(14)) {
        case 0:
            if (Bus* bus = PickBus()) {
                bus->AddBusSlice(PickSignal());
            }
            return;
        case 1:
            if (Bus* bus = PickBus()) {
                bus->RemoveBusSlice(PickSignal());
            }
            return;
        case 2:
            if (Bus* bus = PickBus()) {
                bus->EmptyBusSlice();
            }
            return;
        case 3:
            if (auto* compound = PickOf<CompoundBus>(SignalTypeCompoundBus)) {
                compound->AddBusMember(PickSignal());
            }
            return;
        case 4:
            if (auto* compound = PickOf<CompoundBus>(SignalTypeCompoundBus)) {
                const int place = bytes_.Choose(8) - 1;
                compound->SetAt(place, PickSignal());
            }
            return;
        case 5:
        case 6:
            if (Signal* signal = PickSignal()) {
                signal->SetPortPolarity(PickPolarity());
            }
            return;
        case 7:
            if (Signal* signal = PickSignal()) {
                signal->AssignConstantValue(bytes_.Pick(Values));
            }
            return;
        case 8:
            if (Signal* signal = PickSignal()) {
                signal->SetName(PickName());
            }
            return;
        case 9:
            if (Signal* signal = PickSignal()) {
                signal->AddComment(bytes_.Pick(Comments));
            }
            return;
        case 10:
            return ChangePin();
        case 11:
            return AddAttribute();
        case 12:
            return CopyAttributes();
        default:
            return Rename();
        }
    }

    void ChangePin() {
        Pin* const pin = PickPin();
        if (pin == nullptr) {
            return;
        }
        switch (bytes_.Choose(5)) {
        case 0:
            return pin->SetPolarity(PickPolarity());
        case 1:
            return pin->SetDefaultValue(bytes_.Pick(Values));
        case 2:
            return pin->SetName(bytes_.Pick(PinNames));
        case 3: {
            const std::unique_ptr<Pin> clone(pin->ClonePin());
            if (Signal* signal = PickSignal()) {
                // The pin is destroyed here, which must take it off the signal's list.
                signal->Connect(clone.get());
            }
            return;
        }
        default:
            return AssignPin(*pin);
        }
    }

    void AssignPin(Pin& pin) {
        const Pin* const other = PickPin();
        if (other == nullptr || other->GetPinType() != pin.GetPinType()) {
            return;
        }
        if (pin.GetPinType() == PinTypeScalar) {
            static_cast<ScalarPin&>(pin) = static_cast<const ScalarPin&>(*other);
        } else if (pin.GetPinType() == PinTypeBus) {
            static_cast<BusPin&>(pin) = static_cast<const BusPin&>(*other);
        } else {
            static_cast<BusIndexPin&>(pin) = static_cast<const BusIndexPin&>(*other);
        }
    }

    void AddAttribute() {
        AttributeHolder* const holder = PickHolder();
        if (holder == nullptr) {
            return;
        }
        const auto create = AttributeFactory::GetCreators().Get(bytes_.Pick(Types));
        const char* const name = PickName();
        std::unique_ptr<Attribute> attribute(create(name, bytes_.Pick(Values)));
        attribute->SetGeneric(bytes_.Choose(2) == 0 ? "SYN" : "NOSYN");
        attribute->SetSynAttr(bytes_.Choose(2) == 0 ? "ASSIGN" : "NONE");
        attribute->SetValue(bytes_.Pick(Comments));
        holder->AddAttr(attribute.release());
    }

    void CopyAttributes() {
        AttributeHolder* const from = PickHolder();
        AttributeHolder* const to = PickHolder();
        if (from != nullptr && to != nullptr) {
            *to = *from;
        }
    }

    void Rename() {
        switch (bytes_.Choose(3)) {
        case 0:
            return GetNetlist().SetName(PickName());
        case 1:
            if (Component* component = PickComponent()) {
                component->SetName(PickName());
            }
            return;
        default:
            if (Instance* instance = PickInstance()) {
                instance->SetName(PickName());
            }
            return;
        }
    }

    void Remove() {
        switch (bytes_.Choose(6)) {
        case 0:
        case 1:
            return GetNetlist().Remove(PickSignal());
        case 2:
            return GetNetlist().Remove(PickInstance());
        case 3:
            return GetNetlist().Remove(PickComponent());
        case 4:
            if (!loose_.empty()) {
                loose_.erase(loose_.begin());
            }
            return;
        default:
            // The signal is removed, and a new one is added under its name.
            if (Signal* signal = PickSignal()) {
                const std::string name(signal->GetNameView());
                GetNetlist().Remove(signal);
                model_.AddSignal(name.c_str());
            }
            return;
        }
    }

    /// Calls after which another object owns something, or nothing does.
    void Own() {
        switch (bytes_.Choose(12)) {
        case 0:
            if (AttributeHolder* holder = PickHolder()) {
                holder->RemoveAttr(At(holder->GetAttrIterator(), bytes_.Choose(256)));
            }
            return;
        case 1:
            return MoveAttribute();
        case 2:
            return RemovePin();
        case 3:
            return Destroy();
        case 4:
            if (std::unique_ptr<Signal> signal = GetNetlist().DetachSignal(PickSignal())) {
                loose_.push_back(std::move(signal));
            }
            return;
        case 5:
            // Detached and added again, an object stands behind all others.
            if (std::unique_ptr<Instance> instance = GetNetlist().DetachInstance(PickInstance())) {
                GetNetlist().Add(instance.release());
            }
            return;
        case 6:
            if (std::unique_ptr<Component> component =
                    GetNetlist().DetachComponent(PickComponent())) {
                GetNetlist().Add(component.release());
            }
            return;
        case 7:
        case 8:
            return RenameByName();
        case 9:
            return RemoveWhileWalking();
        case 10:
            return MoveNetlist();
        default:
            return MoveEngine();
        }
    }

    void MoveAttribute() {
        AttributeHolder* const from = PickHolder();
        AttributeHolder* const to = PickHolder();
        if (from == nullptr || to == nullptr) {
            return;
        }
        Attribute* const attribute = At(from->GetAttrIterator(), bytes_.Choose(256));
        std::unique_ptr<Attribute> detached = from->DetachAttr(attribute);
        Check(detached.get() == attribute, "a holder owns what it lists");
        switch (bytes_.Choose(3)) {
        case 0:
            to->AddAttr(detached.release());
            return;
        case 1:
            from->AddAttr(detached.release());
            // Whoever destroys an attribute, it leaves its holder.
            delete attribute;
            return;
        default:
            return;
        }
    }

    void RemovePin() {
        Component* const component = PickComponent();
        Pin* const pin = PickPin();
        switch (bytes_.Choose(4)) {
        case 0:
            return GetNetlist().RemovePin(component, pin);
        case 1:
            if (component != nullptr) {
                component->RemovePin(At(component->GetPinIterator(), bytes_.Choose(256)));
            }
            return;
        case 2:
            if (Instance* instance = PickInstance()) {
                instance->RemovePin(At(instance->GetPinIterator(), bytes_.Choose(256)));
            }
            return;
        default:
            delete pin;
            return;
        }
    }

    /// Destroys what the netlist owns.
    void Destroy() {
        switch (bytes_.Choose(3)) {
        case 0:
            delete At(GetNetlist().GetSignalIterator(), bytes_.Choose(256));
            return;
        case 1:
            delete PickInstance();
            return;
        default:
            delete PickComponent();
            return;
        }
    }

    void RenameByName() {
        const std::string newName = PickName();
        switch (bytes_.Choose(4)) {
        case 0:
            if (const Component* component = PickComponent()) {
                model_.RenameComponent(component->GetName().CStr(), newName.c_str());
            }
            return;
        case 1:
            if (const Instance* instance = PickInstance()) {
                model_.RenameInstance(instance->GetName().CStr(), newName.c_str());
            }
            return;
        default:
            if (const Signal* signal = PickSignal()) {
                model_.RenameSignal(signal->GetName().CStr(), newName.c_str());
            }
            return;
        }
    }

    /// Removes some signals during one walk. What is left keeps its order.
    void RemoveWhileWalking() {
        std::vector<const Signal*> kept;
        const int every = 2 + bytes_.Choose(4);
        int met = bytes_.Choose(8);
        const int count = CountSignals();
        Iterator<Signal*> at = GetNetlist().GetSignalIterator();
        for (int i = 0; !at.IsAtEnd(); ++i) {
            Check(i < count, "a walk meets no signal twice");
            if (++met % every == 0) {
                GetNetlist().Remove(at.GetCurrent());
            } else {
                kept.push_back(at.GetCurrent());
                at.Next();
            }
        }
        std::size_t place = 0;
        for (const Signal* signal : GetNetlist().GetSignalIterator()) {
            Check(place < kept.size() && signal == kept[place++], "removal keeps the order");
        }
        Check(place == kept.size(), "only what was removed is missing");
    }

    int CountSignals() {
        int count = 0;
        for (const Signal* signal : GetNetlist().GetSignalIterator()) {
            count += signal == nullptr ? 0 : 1;
        }
        return count;
    }

    void MoveNetlist() {
        Netlist moved(std::move(GetNetlist()));
        Fuzz::CheckNetlist(moved, GetLoose());
        Check(GetNetlist().GetSignalIterator().IsAtEnd(), "what was moved has left");
        switch (bytes_.Choose(3)) {
        case 0:
            GetNetlist() = std::move(moved);
            return;
        case 1:
            // The design begins anew.
            return;
        default:
            GetNetlist().Add(new Component("A"));
            GetNetlist() = std::move(moved);
            return;
        }
    }

    /// An engine of its own, which is slow to make: the calls of this design need none.
    void MoveEngine() {
        if (checks_ != Checks::All || movesEngine_) {
            return;
        }
        movesEngine_ = true;
        Engine engine;
        engine.CreateAndAddModel("m", "");
        Model* const model = engine.GetModel("m");
        const char* const name = PickName();
        Engine other(std::move(engine));
        if (bytes_.Choose(2) == 0) {
            engine.CreateAndAddModel("m", "");
            engine = std::move(other);
        } else {
            engine = std::move(other);
            other = std::move(engine);
            engine = std::move(other);
        }
        Check(engine.GetModel("m") == model, "a model stays where it is");
        model->AddSignal(name);
        Fuzz::CheckNetlist(*model->GetNetlist(), {});
    }

    void CallByName() {
        switch (bytes_.Choose(6)) {
        case 0: {
            const Instance* const instance = PickInstance();
            const char* const name = PickName();
            model_.ConnectSignalToPin(name, instance == nullptr ? "" : instance->GetName().CStr(),
                                      bytes_.Pick(PinNames));
            return;
        }
        case 1: {
            const char* const first = PickName();
            model_.ConnectSignals(first, PickName());
            return;
        }
        case 2: {
            const char* const name = PickName();
            model_.AssignConstantToSignal(name, bytes_.Pick(Values));
            return;
        }
        case 3: {
            const Instance* const instance = PickInstance();
            const char* const pin = bytes_.Pick(PinNames);
            model_.AssignConstantToPin(instance == nullptr ? "" : instance->GetName().CStr(), pin,
                                       bytes_.Pick(Values));
            return;
        }
        case 4:
            model_.AddSignal(PickName());
            return;
        default:
            model_.AddInstance(PickName(), "A");
            return;
        }
    }

    void Prepare() {
        switch (bytes_.Choose(8)) {
        case 0:
            return GetNetlist().SortNetlist();
        case 1:
            return GetNetlist().ConnectOpenPinToDummy();
        case 2:
            return GetNetlist().CreateVerilogDummySignals();
        case 3:
            return GetNetlist().CreateVhdlDummySignals();
        case 4:
            return GetNetlist().SetBoxTypeAttribute();
        case 5:
            model_.GetOptions()->vhdl.openPin = bytes_.Choose(2) == 0;
            model_.GetOptions()->vhdl.useAttrType = bytes_.Choose(2) == 0;
            model_.GetOptions()->verilog.synthesisType = bytes_.Choose(6);
            model_.GetOptions()->verilog.signalCase =
                static_cast<HdlOptions::VerilogOption::CaseType>(10 + bytes_.Choose(3));
            return;
        default:
            if (writes_ < MostWrites) {
                ++writes_;
                Write();
            }
            return;
        }
    }

    void Write() {
        if (checks_ == Checks::All) {
            Fuzz::WriteWithChecks(GetNetlist(), *model_.GetOptions(), GetLoose());
        } else {
            Fuzz::WriteOnceWithChecks(GetNetlist(), *model_.GetOptions(), GetLoose());
        }
    }

    /// No call registers a phrase, so all inputs can share a factory.
    static CommandFactory& GetFactory() {
        static CommandFactory factory;
        return factory;
    }

    Fuzz::Bytes bytes_;
    Checks checks_;
    // Declared before the design, and so destroyed after it.
    std::vector<std::unique_ptr<Signal>> loose_;
    Model model_{&GetFactory()};
    int writes_ = 0;
    bool movesEngine_ = false;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    for (const Checks checks : Fuzz::ChooseChecks(data, size, InputsPerFullCheck)) {
        Player(Fuzz::Bytes(data, size), checks).Play();
    }
    return 0;
}
