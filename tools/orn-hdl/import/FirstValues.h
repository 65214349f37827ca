// The first values of registers.
#pragma once

#include "import/ImportedDesign.h"

namespace Tool::Import {

/// Gives registers the parameter INIT, a text of the digits 0, 1 and U, from the first values of
/// the nets that they drive. Only types that have a simulation model with this generic are
/// concerned; if a register of a type has a first value, all of its type get the parameter. Nets
/// whose first values were taken have none any more.
void SetFirstValues(ImportedDesign& design);

} // namespace Tool::Import
