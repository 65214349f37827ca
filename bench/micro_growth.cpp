/// \file
/// Operations that no command reaches, on designs of growing size: the time of each is to grow as
/// the size does.
#include "example.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;

int SizeOf(const benchmark::State& state) {
    return static_cast<int>(state.range(0));
}

/// Times `measure` on a netlist that was made ready by `prepare`, anew each time.
template <class Prepare, class Measure>
void TimeOnFreshNetlists(benchmark::State& state, const Prepare& prepare, const Measure& measure) {
    for (auto _ : state) {
        state.PauseTiming();
        {
            Model model(nullptr);
            auto prepared = prepare(*model.GetNetlist());
            state.ResumeTiming();
            measure(*model.GetNetlist(), prepared);
            state.PauseTiming();
        }
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
    state.SetComplexityN(state.range(0));
}

std::vector<Instance*> AddInstances(Netlist& netlist, int count) {
    std::vector<Instance*> instances;
    for (int i = 0; i < count; ++i) {
        instances.push_back(new Instance(bench::Numbered("U", i).c_str(), nullptr));
        netlist.Add(instances.back());
    }
    return instances;
}

template <class T> void RemoveEach(Netlist& netlist, const std::vector<T*>& objects) {
    for (T* object : objects) {
        netlist.Remove(object);
    }
}

/// All instances of a design, the first one first.
void RemoveInstances(benchmark::State& state) {
    TimeOnFreshNetlists(
        state, [&](Netlist& netlist) { return AddInstances(netlist, SizeOf(state)); },
        RemoveEach<Instance>);
}
BENCHMARK(RemoveInstances)->Arg(25'000)->Arg(50'000)->Arg(100'000)->Unit(benchmark::kMillisecond);

/// Objects of a design in no order that it knows of.
template <class T> std::vector<T*> Shuffled(std::vector<T*> objects) {
    std::shuffle(objects.begin(), objects.end(), std::mt19937(1));
    return objects;
}

/// Half of the objects of a design.
template <class T, class Make> void RemoveRandom(benchmark::State& state, Make make) {
    TimeOnFreshNetlists(
        state,
        [&](Netlist& netlist) {
            std::vector<T*> objects;
            for (int i = 0; i < SizeOf(state); ++i) {
                objects.push_back(make(bench::Numbered("X", i)));
                netlist.Add(objects.back());
            }
            objects = Shuffled(objects);
            objects.resize(objects.size() / 2);
            return objects;
        },
        RemoveEach<T>);
}

void RemoveRandomInstances(benchmark::State& state) {
    RemoveRandom<Instance>(
        state, [](const std::string& name) { return new Instance(name.c_str(), nullptr); });
}
BENCHMARK(RemoveRandomInstances)
    ->Arg(100'000)
    ->Arg(300'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kMillisecond);

void RemoveRandomSignals(benchmark::State& state) {
    RemoveRandom<Signal>(state,
                         [](const std::string& name) { return new ScalarSignal(name.c_str()); });
}
BENCHMARK(RemoveRandomSignals)
    ->Arg(100'000)
    ->Arg(300'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kMillisecond);

void RemoveRandomComponents(benchmark::State& state) {
    RemoveRandom<Component>(state,
                            [](const std::string& name) { return new Component(name.c_str()); });
}
BENCHMARK(RemoveRandomComponents)
    ->Arg(100'000)
    ->Arg(300'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kMillisecond);

struct Net {
    std::unique_ptr<Component> component;
    Signal* signal = nullptr;
    std::vector<std::unique_ptr<Instance>> instances;
};

/// The pins of one net, the first one first.
void DisconnectPins(benchmark::State& state) {
    TimeOnFreshNetlists(
        state,
        [&](Netlist& netlist) {
            Net net;
            net.component = std::make_unique<Component>("LOAD");
            net.component->AddPin("C", Polarity(Polarity::Input), "");
            net.signal = new ScalarSignal("clk");
            netlist.Add(net.signal);
            for (int i = 0; i < SizeOf(state); ++i) {
                net.instances.push_back(std::make_unique<Instance>("u", net.component.get()));
                net.signal->Connect(net.instances.back()->GetPin("C"));
            }
            return net;
        },
        [](Netlist& /*netlist*/, const Net& net) {
            for (const auto& instance : net.instances) {
                net.signal->Disconnect(instance->GetPin("C"));
            }
        });
}
BENCHMARK(DisconnectPins)->Arg(25'000)->Arg(50'000)->Arg(100'000)->Unit(benchmark::kMillisecond);

/// Every pin of a wide instance is looked up and renamed.
void RenamePins(benchmark::State& state) {
    TimeOnFreshNetlists(
        state,
        [&](Netlist& /*netlist*/) {
            Component component("WIDE");
            for (int i = 0; i < SizeOf(state); ++i) {
                component.AddPin(bench::Numbered("p", i).c_str(), Polarity(Polarity::Input), "");
            }
            return std::make_unique<Instance>("u", &component);
        },
        [&](Netlist& /*netlist*/, const std::unique_ptr<Instance>& instance) {
            for (int i = 0; i < SizeOf(state); ++i) {
                Pin* const pin = instance->GetPin(bench::Numbered("p", i).c_str());
                pin->SetName(bench::Numbered("q", i).c_str());
            }
        });
}
BENCHMARK(RenamePins)->Arg(25'000)->Arg(50'000)->Arg(100'000)->Unit(benchmark::kMillisecond);

/// Ports that are driven inside, and have dummy signals therefore.
void RemovePortsWithDummies(benchmark::State& state) {
    TimeOnFreshNetlists(
        state,
        [&](Netlist& netlist) {
            auto* const driver = new Component("DRIVER");
            driver->AddPin("O", Polarity(Polarity::Output), "");
            netlist.Add(driver);
            std::vector<Signal*> ports;
            for (int i = 0; i < SizeOf(state); ++i) {
                ports.push_back(new ScalarSignal(bench::Numbered("p", i).c_str()));
                ports.back()->SetPortPolarity(Polarity(Polarity::Input));
                netlist.Add(ports.back());
                auto* const instance = new Instance(bench::Numbered("U", i).c_str(), driver);
                netlist.Add(instance);
                ports.back()->Connect(instance->GetPin("O"));
            }
            netlist.CreateVerilogDummySignals();
            return ports;
        },
        [](Netlist& netlist, const std::vector<Signal*>& ports) {
            for (Signal* port : ports) {
                netlist.Remove(port);
            }
        });
}
BENCHMARK(RemovePortsWithDummies)
    ->Arg(25'000)
    ->Arg(50'000)
    ->Arg(100'000)
    ->Unit(benchmark::kMillisecond);

/// A signal that a compound repeats.
void RemoveRepeatedMember(benchmark::State& state) {
    TimeOnFreshNetlists(
        state,
        [&](Netlist& netlist) {
            auto* const member = new ScalarSignal("a");
            netlist.Add(member);
            auto* const compound = new CompoundBus("c");
            netlist.Add(compound);
            for (int i = 0; i < SizeOf(state); ++i) {
                compound->AddBusMember(member);
            }
            return member;
        },
        [](Netlist& netlist, Signal* member) { netlist.Remove(member); });
}
BENCHMARK(RemoveRepeatedMember)
    ->Arg(25'000)
    ->Arg(50'000)
    ->Arg(100'000)
    ->Unit(benchmark::kMillisecond);

} // namespace
