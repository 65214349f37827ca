#include "LastingEngines.h"

#include "Orn_Hdl/Engine.h"

#include <memory>
#include <vector>

namespace Tool {

namespace {

using Engines = std::vector<std::unique_ptr<Orn_Hdl::Engine>>;

Engines& GetEngines() {
    // Never destroyed.
    static Engines& engines = *new Engines;
    return engines;
}

} // namespace

void DropLastingEngines() {
    GetEngines().clear();
}

Orn_Hdl::Engine& MakeLastingEngine() {
    return *GetEngines().emplace_back(std::make_unique<Orn_Hdl::Engine>());
}

} // namespace Tool
