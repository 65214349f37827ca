#include "stats/Stats.h"

#include "LastingEngines.h"
#include "NoWrites.h"
#include "Progress.h"
#include "Run.h"
#include "stats/Count.h"
#include "stats/Spelling.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <chrono>
#include <cstdint>
#include <fstream>
#include <sys/resource.h>
#include <unistd.h>

namespace Tool {

namespace {

using Clock = std::chrono::steady_clock;

double GetSecondsSince(Clock::time_point start) {
    return std::chrono::duration<double>(Clock::now() - start).count();
}

/// The memory that the process has now, in bytes; 0 where the system does not tell.
std::uint64_t GetMemory() {
    std::ifstream file("/proc/self/statm");
    std::uint64_t all = 0;
    std::uint64_t resident = 0;
    file >> all >> resident;
    return resident * static_cast<std::uint64_t>(sysconf(_SC_PAGESIZE));
}

/// The most memory that the process had, in bytes.
std::uint64_t GetGreatestMemory() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<std::uint64_t>(usage.ru_maxrss) * 1024;
}

} // namespace

Status PrintStats(const StatsOptions& options) {
    DropLastingEngines();
    Orn_Hdl::Engine& engine = MakeLastingEngine();
    const std::string name = GetModelName(options.file, options.model);
    engine.CreateAndAddModel(name, options.file);
    Orn_Hdl::Model& model = *engine.GetModel(name);
    model.GetOptions()->threads = options.threads;
    DropWrites(*model.GetCommandFactory());

    Progress progress(options.quiet, options.file);
    CommandFile file(options.file, options.report, progress);
    Stats::Cost cost;
    const std::uint64_t memoryBefore = GetMemory();
    const Clock::time_point start = Clock::now();
    const Replayed replayed = Replay(model, file, false);
    cost.replaySeconds = GetSecondsSince(start);
    file.reporter.Finish();
    if (!replayed.complete) {
        return replayed.status;
    }
    const std::uint64_t memoryAfter = GetMemory();
    cost.designBytes = memoryAfter > memoryBefore ? memoryAfter - memoryBefore : 0;
    cost.lines = replayed.lines;
    const Clock::time_point counting = Clock::now();
    const Stats::DesignCounts counts = Stats::CountDesign(*model.GetNetlist());
    cost.countSeconds = GetSecondsSince(counting);
    cost.peakBytes = GetGreatestMemory();
    progress.Erase();
    return Print(options.format == StatsFormat::Json ? Stats::SpellAsJson(counts, cost)
                                                     : Stats::SpellAsText(counts, cost));
}

} // namespace Tool
