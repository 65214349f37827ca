/// \file
/// What a design costs in memory: bytes an instance, a pin and a kept command. Every figure is the
/// difference between two designs of the same number of objects that differ in nothing else, or
/// between a design and none. Each design is built in a process of its own, whose resident memory
/// is read before and after: whatever the objects cost is in it, tables and unused ends of pages
/// included.
#include "example.h"

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <stdexcept>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace {

using namespace Orn_Hdl;

constexpr int PinsAnInstance = 4;

double ResidentBytes() {
    std::ifstream file("/proc/self/statm");
    double whole = 0;
    double resident = 0;
    if (!(file >> whole >> resident)) {
        throw std::runtime_error("/proc/self/statm cannot be read");
    }
    return resident * static_cast<double>(sysconf(_SC_PAGESIZE));
}

/// What a design holds besides its one component.
struct Contents {
    int instances;
    int pinsAnInstance = 0;
    bool isWired = false;
    bool isReplayed = false; ///< by commands, which are kept, or by direct calls
};

/// Makes the same calls on a model either way.
class Builder {
public:
    Builder(Engine& engine, bool isReplayed) : isReplayed_(isReplayed) {
        engine.CreateAndAddModel("top", "");
        model_ = engine.GetModel("top");
    }
    Model& GetModel() const { return *model_; }

    void AddInstance(const std::string& name) const {
        if (isReplayed_) {
            model_->ExecuteLine("ADD INSTANCE CELL " + name);
        } else {
            model_->AddInstance(name.c_str(), "CELL");
        }
    }
    void Connect(const std::string& net, const std::string& instance,
                 const std::string& pin) const {
        if (isReplayed_) {
            model_->ExecuteLine("CONNECT SIGNAL " + net + " " + instance + "." + pin);
        } else {
            model_->ConnectSignalToPin(net.c_str(), instance.c_str(), pin.c_str());
        }
    }

private:
    Model* model_;
    bool isReplayed_;
};

/// Every instance reads nets that others drive: as many nets as instances, each with as many pins
/// as an instance has.
void ConnectPins(const Builder& builder, const Contents& contents) {
    for (int i = 0; i < contents.instances; ++i) {
        const std::string instance = bench::Numbered("U", i);
        for (int pin = 0; pin < contents.pinsAnInstance; ++pin) {
            const bool isOutput = pin == contents.pinsAnInstance - 1;
            const int net = isOutput ? i : (i + 1 + pin) % contents.instances;
            builder.Connect(bench::Numbered("n", net), instance,
                            isOutput ? "O" : bench::Numbered("I", pin));
        }
    }
}

double MeasureHere(const Contents& contents) {
    const double before = ResidentBytes();
    Engine engine;
    const Builder builder(engine, contents.isReplayed);
    if (contents.pinsAnInstance == 0) {
        builder.GetModel().AddComponent("CELL");
    } else {
        bench::AddGate(builder.GetModel(), "CELL", contents.pinsAnInstance - 1);
    }
    for (int i = 0; i < contents.instances; ++i) {
        builder.AddInstance(bench::Numbered("U", i));
    }
    if (contents.isWired) {
        ConnectPins(builder, contents);
    }
    return ResidentBytes() - before;
}

/// The same in a process of its own, which hands nothing down that another has freed.
double Measure(const Contents& contents) {
    int ends[2];
    if (pipe(ends) != 0) {
        throw std::runtime_error("no pipe");
    }
    const pid_t child = fork();
    if (child < 0) {
        throw std::runtime_error("no process");
    }
    if (child == 0) {
        const double bytes = MeasureHere(contents);
        _exit(write(ends[1], &bytes, sizeof bytes) == sizeof bytes ? 0 : 1);
    }
    close(ends[1]);
    double bytes = 0;
    const bool isRead = read(ends[0], &bytes, sizeof bytes) == sizeof bytes;
    close(ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    if (!isRead || status != 0) {
        throw std::runtime_error("a measured process has failed");
    }
    return bytes;
}

void Print(int instances) {
    const double pins = static_cast<double>(instances) * PinsAnInstance;
    const double bare = Measure({instances});
    const double open = Measure({instances, PinsAnInstance});
    const double wired = Measure({instances, PinsAnInstance, true});
    const double replayed = Measure({instances, PinsAnInstance, true, true});
    std::printf("%.1f bytes an instance without pins, in a design of %d\n", bare / instances,
                instances);
    std::printf("%.1f bytes an open pin\n", (open - bare) / pins);
    std::printf("%.1f bytes to wire a pin, with its share of a net of %d pins\n",
                (wired - open) / pins, PinsAnInstance);
    std::printf("%.1f bytes a kept command\n", (replayed - wired) / (pins + instances));
}

} // namespace

int main(int argc, char** argv) {
    const int instances = argc > 1 ? std::atoi(argv[1]) : 1'000'000;
    if (argc > 2 || instances < 1) {
        std::fputs("usage: orn_bench_memory [INSTANCES]\n", stderr);
        return 2;
    }
    try {
        Print(instances);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "orn_bench_memory: %s\n", error.what());
        return 1;
    }
    return 0;
}
