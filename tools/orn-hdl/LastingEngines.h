// Engines that are not destroyed before the process ends: freeing a large design object by object
// would take a tenth of the time of a whole run.
#pragma once

namespace Orn_Hdl {
class Engine;
}

namespace Tool {

/// Destroys the engines of an earlier command of the tool. A process that carries out several
/// commands keeps no more designs than those of the last one.
void DropLastingEngines();
/// Makes an engine that stands until the next command or the end of the process.
Orn_Hdl::Engine& MakeLastingEngine();

} // namespace Tool
