// The options of the VHDL writer with which a file could have been written.
#pragma once

#include "Orn_Hdl/Options.h"
#include "Readers/Vhdl/Design.h"

namespace Orn_Hdl::Readers::Vhdl {

/// Sets the options that say which library and use clauses a file has.
void SetClauses(const Clauses& ofEntity, const Clauses& ofArchitecture,
                HdlOptions::VhdlOption& options);

} // namespace Orn_Hdl::Readers::Vhdl
