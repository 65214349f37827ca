// Replays a command file, walks the netlist with visitors, and prints what it is made of.
//
// report FILE

#include <Orn_Hdl/Orn_Hdl.h>

#include <algorithm>
#include <cstddef>
#include <iostream>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace {

using Counts = std::map<std::string, int>;

/// Finds the nets behind a signal: a part of a bus belongs to the bus, a compound to its members'.
class NetFinder : public Orn_Hdl::SignalVisitor {
public:
    void VisitScalarSignal(Orn_Hdl::ScalarSignal* signal) override { Add(*signal); }
    void VisitBus(Orn_Hdl::Bus* bus) override { Add(*bus); }
    void VisitBusSlice(Orn_Hdl::BusSlice* slice) override { AddParent(slice->GetParentBus()); }
    void VisitBusIndex(Orn_Hdl::BusIndex* bit) override { AddParent(bit->GetParentBus()); }
    void VisitCompoundBus(Orn_Hdl::CompoundBus* compound) override {
        for (Orn_Hdl::Signal* member : compound->GetBusMemberIterator()) {
            member->AcceptSignal(*this);
        }
    }

    const std::vector<std::string>& GetNets() const { return nets_; }

private:
    void Add(const Orn_Hdl::Signal& signal) { nets_.emplace_back(signal.GetNameView()); }
    void AddParent(const Orn_Hdl::Bus* bus) {
        if (bus != nullptr) {
            Add(*bus);
        }
    }

    std::vector<std::string> nets_;
};

/// Counts the instances of each component, the pins that read each net, and the pins left open.
class Survey : public Orn_Hdl::ObjectVisitor {
public:
    void VisitNetlist(Orn_Hdl::Netlist* netlist) override {
        for (Orn_Hdl::Instance* instance : netlist->GetInstanceIterator()) {
            instance->AcceptObject(*this);
        }
    }

    void VisitInstance(Orn_Hdl::Instance* instance) override {
        ++uses_[instance->GetComponentName().CStr()];
        instance_ = instance->GetNameView();
        for (Orn_Hdl::Pin* pin : instance->GetPinIterator()) {
            pin->AcceptObject(*this);
        }
    }

    void VisitPin(Orn_Hdl::Pin* pin) override {
        Orn_Hdl::Signal* const signal = pin->GetSignal();
        if (signal == nullptr) {
            openPins_.push_back(instance_ + "." + std::string(pin->GetNameView()));
        } else if (pin->GetPolarity().GetValue() != Orn_Hdl::Polarity::Output) {
            NetFinder finder;
            signal->AcceptSignal(finder);
            for (const std::string& net : finder.GetNets()) {
                ++fanOut_[net];
            }
        }
    }

    const Counts& GetUses() const { return uses_; }
    const Counts& GetFanOut() const { return fanOut_; }
    const std::vector<std::string>& GetOpenPins() const { return openPins_; }

private:
    std::string instance_;
    Counts uses_;
    Counts fanOut_;
    std::vector<std::string> openPins_;
};

/// The greatest counts, one a line; of equal ones the first by name.
void PrintGreatest(const char* title, const Counts& counts, std::size_t limit) {
    std::vector<std::pair<std::string, int>> sorted(counts.begin(), counts.end());
    std::stable_sort(sorted.begin(), sorted.end(),
                     [](const auto& a, const auto& b) { return a.second > b.second; });
    std::cout << title << "\n";
    for (std::size_t i = 0; i < std::min(limit, sorted.size()); ++i) {
        std::cout << "  " << sorted[i].second << "  " << sorted[i].first << "\n";
    }
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::cerr << "usage: report FILE\n";
        return 2;
    }
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel("design", argv[1]);
    // Asked for before the replay: the file's SET NETLIST NAME renames the model.
    Orn_Hdl::Model& model = *engine.GetModel("design");
    try {
        if (!model.Read(argv[1])) {
            std::cerr << "report: cannot read " << argv[1] << "\n";
            return 1;
        }
    } catch (const Orn_Hdl::Exception& exception) {
        std::cerr << "report: " << exception.what();
        return 1;
    }

    Survey survey;
    model.GetNetlist()->AcceptObject(survey);
    PrintGreatest("components by use", survey.GetUses(), survey.GetUses().size());
    PrintGreatest("fan-out, the ten greatest", survey.GetFanOut(), 10);
    std::cout << "open pins: " << survey.GetOpenPins().size() << "\n";
    for (const std::string& pin : survey.GetOpenPins()) {
        std::cout << "  " << pin << "\n";
    }
}
