// Which module of a file is read.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Place.h"

#include <string>
#include <string_view>

namespace Orn_Hdl::Readers {

/// The module of that name, or the only one that no other instantiates when the name is empty.
/// \param kind what messages call it: "module" or "entity".
const ModuleHead& FindTop(const Heads& heads, const std::string& name, std::string_view kind,
                          const Files& files);

} // namespace Orn_Hdl::Readers
