// Tells of the values x and z that the user had replaced.
#pragma once

#include "import/ImportedComponents.h"
#include "import/ImportedDesign.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

namespace Tool::Import {

/// Counts the bits x and z of ports, connections and parameters that are replaced, in one warning
/// for each kind. Nothing is told without a replacement.
/// \param top its constants at output pins are replaced by net bits already.
/// \return whether there are such bits of ports and connections.
bool TellReplacedValues(const Module& top, const ImportedComponents& components,
                        const UnknownValues& unknown, Warnings& warnings);

} // namespace Tool::Import
