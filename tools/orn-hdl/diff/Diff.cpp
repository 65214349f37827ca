#include "diff/Diff.h"

#include "diff/Compare.h"
#include "diff/Places.h"
#include "diff/Spelling.h"

#include <algorithm>
#include <exception>
#include <new>
#include <optional>
#include <utility>

namespace Tool {

namespace {

/// The two designs, which stand until the process ends: freeing them would take a tenth of the
/// time.
struct Designs {
    explicit Designs(const DiffOptions& options) : a(options.a), b(options.b) {}

    LoadedDesign a;
    LoadedDesign b;
};

/// A netlist refers to components that it need not declare: those of the other design stand in.
Status Load(Designs& designs, const DiffOptions& options, Reporter& reporter) {
    LoadedDesign* first = &designs.a;
    LoadedDesign* second = &designs.b;
    if (first->GetFormat() == DesignFormat::Verilog &&
        second->GetFormat() != DesignFormat::Verilog) {
        std::swap(first, second);
    }
    for (LoadedDesign* design : {first, second}) {
        design->GetModel().GetOptions()->threads = options.threads;
    }
    Libraries libraries{options.libraries, nullptr};
    Status status = first->Load(libraries, reporter, options.quiet);
    if (status == Status::Success) {
        libraries.components = &first->GetNetlist();
        status = second->Load(libraries, reporter, options.quiet);
    }
    return status;
}

bool Ignores(const DiffOptions& options, const char* what) {
    return std::find(options.ignored.begin(), options.ignored.end(), what) != options.ignored.end();
}

Diff::Rules MakeRules(const DiffOptions& options, const Designs& designs) {
    const DesignFormat a = designs.a.GetFormat();
    const DesignFormat b = designs.b.GetFormat();
    const bool areCommands = a == DesignFormat::Commands && b == DesignFormat::Commands;
    const bool isAnyJson = a == DesignFormat::Json || b == DesignFormat::Json;
    Diff::Rules rules;
    rules.names = !Ignores(options, "names");
    rules.attributes = !Ignores(options, "attributes");
    // A comment of a netlist is found where a writer of the same language has put it.
    rules.comments = !Ignores(options, "comments") && a == b && !isAnyJson;
    rules.order = !Ignores(options, "order");
    rules.mergesNets = isAnyJson;
    rules.hasExactAttributes = areCommands;
    rules.hasSynthesisAttributes = !isAnyJson;
    rules.hasUnusedParts = areCommands || (a == DesignFormat::Vhdl && b == DesignFormat::Vhdl);
    rules.hasPinRanges = !isAnyJson;
    rules.hasPortOrder = !areCommands;
    rules.hasDesignName = designs.a.HasName() && designs.b.HasName();
    return rules;
}

/// Sorts what changed alike by the lines of the first file, or else of the second one.
void SortByLine(std::vector<Diff::Difference>& differences) {
    const auto lineOf = [](const Diff::Difference& difference) {
        return difference.a.line != 0 ? difference.a.line : difference.b.line;
    };
    std::stable_sort(differences.begin(), differences.end(),
                     [&](const Diff::Difference& a, const Diff::Difference& b) {
                         return a.change != b.change ? a.change < b.change : lineOf(a) < lineOf(b);
                     });
}

Status Run(const DiffOptions& options, Reporter& reporter) {
    static Designs* designs = nullptr;
    delete std::exchange(designs, nullptr); // From an earlier run.
    designs = new Designs(options);
    if (Load(*designs, options, reporter) != Status::Success) {
        return Status::Usage;
    }
    Diff::Differences found = Diff::Compare(designs->a.GetNetlist(), designs->b.GetNetlist(),
                                            MakeRules(options, *designs), options.limit);
    std::vector<Diff::Difference> shown = found.Take();
    Diff::FindLines(shown, designs->a, designs->b);
    SortByLine(shown);
    const Diff::Report report{designs->a.GetFile().name, designs->b.GetFile().name, found, shown};
    if (Print(options.format == DiffFormat::Json ? Diff::SpellAsJson(report)
                                                 : Diff::SpellAsText(report)) != Status::Success) {
        return Status::Usage;
    }
    return found.GetTotal() == 0 ? Status::Success : Status::Failed;
}

} // namespace

const std::vector<std::string>& GetIgnorable() {
    static const std::vector<std::string> words = {"names", "attributes", "comments", "order"};
    return words;
}

Status PrintDiff(const DiffOptions& options) {
    Reporter reporter(options.report);
    // Whatever goes wrong is 2: 1 is kept for designs that differ.
    Status status = Status::Usage;
    try {
        status = Run(options, reporter);
    } catch (const std::bad_alloc&) {
        Complain("out of memory");
    } catch (const std::exception& error) {
        Complain(error.what());
    }
    reporter.Finish();
    return status;
}

} // namespace Tool
