/// \file
/// What the parts of a replay cost: splitting a line, finding its phrase, placing an instance,
/// wiring a pin, sorting.
#include "example.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <random>
#include <string>
#include <string_view>
#include <vector>

namespace {

using namespace Orn_Hdl;

constexpr std::string_view Line = "CONNECT SIGNAL n123456 U123456.I0";

void TokeniseLine(benchmark::State& state) {
    StringArray tokens;
    for (auto _ : state) {
        tokens.Empty();
        benchmark::DoNotOptimize(tokens.ParseCommandLine(Line));
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * Line.size()));
}
BENCHMARK(TokeniseLine);

void FindPhrase(benchmark::State& state) {
    const CommandFactory factory;
    StringArray tokens;
    tokens.ParseCommandLine(Line);
    for (auto _ : state) {
        benchmark::DoNotOptimize(factory.GetCommandCreator(tokens));
    }
}
BENCHMARK(FindPhrase);

/// The names of a batch of instances, and of the nets that they drive.
struct Names {
    explicit Names(int count) {
        for (int i = 0; i < count; ++i) {
            instances.push_back(bench::Numbered("U", i));
            nets.push_back(bench::Numbered("n", i));
        }
    }
    std::vector<std::string> instances;
    std::vector<std::string> nets;
};

constexpr int Batch = 100'000;

/// Times `measure` on a model that was made ready by `prepare`, anew each time; making it and
/// taking it down is not timed.
template <class Prepare, class Measure>
void TimeOnFreshModels(benchmark::State& state, const Prepare& prepare, const Measure& measure) {
    for (auto _ : state) {
        state.PauseTiming();
        {
            Model model(nullptr);
            prepare(model);
            state.ResumeTiming();
            measure(model);
            state.PauseTiming();
        }
        state.ResumeTiming();
    }
}

/// Instances of a gate of three pins, in a netlist that grows from none to a batch.
void AddInstance(benchmark::State& state) {
    const Names names(Batch);
    TimeOnFreshModels(
        state, [](Model& model) { bench::AddGate(model, "AND2", 2); },
        [&](Model& model) {
            for (const std::string& name : names.instances) {
                model.AddInstance(name.c_str(), "AND2");
            }
        });
    state.SetItemsProcessed(state.iterations() * Batch);
}
BENCHMARK(AddInstance)->Unit(benchmark::kMillisecond);

/// One pin of every instance, in order, each to a net that its connection declares.
void ConnectPin(benchmark::State& state) {
    const Names names(Batch);
    TimeOnFreshModels(
        state,
        [](Model& model) {
            bench::AddGate(model, "AND2", 2);
            bench::AddInstances(model, "AND2", Batch);
        },
        [&](Model& model) {
            for (std::size_t i = 0; i < names.nets.size(); ++i) {
                model.ConnectSignalToPin(names.nets[i].c_str(), names.instances[i].c_str(), "O");
            }
        });
    state.SetItemsProcessed(state.iterations() * Batch);
}
BENCHMARK(ConnectPin)->Unit(benchmark::kMillisecond);

/// Instances without pins whose names were added in no order.
void SortInstances(benchmark::State& state, const std::string& beginning) {
    Names names(static_cast<int>(state.range(0)));
    for (std::string& name : names.instances) {
        name.insert(0, beginning);
    }
    std::shuffle(names.instances.begin(), names.instances.end(), std::mt19937(1));
    TimeOnFreshModels(
        state,
        [&](Model& model) {
            for (const std::string& name : names.instances) {
                model.GetNetlist()->Add(new Instance(name.c_str(), nullptr));
            }
        },
        [](Model& model) { model.GetNetlist()->SortNetlist(); });
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void SortNaturally(benchmark::State& state) {
    SortInstances(state, "");
}
BENCHMARK(SortNaturally)->Arg(1'000)->Arg(100'000)->Unit(benchmark::kMicrosecond);

/// A key holds fewer characters than all names begin with.
void SortLongNames(benchmark::State& state) {
    SortInstances(state, "top_core_0_alu_stage_");
}
BENCHMARK(SortLongNames)->Arg(1'000)->Arg(100'000)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
