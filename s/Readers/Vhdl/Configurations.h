// Configuration declarations and specifications.
#pragma once

#include "Readers/NetlistSink.h"
#include "Readers/Vhdl/Design.h"
#include "Readers/Vhdl/Parser.h"

namespace Orn_Hdl::Readers::Vhdl {

/// Reads a configuration declaration.
/// \param sink gets the bindings; null when nobody wants them.
Configuration ReadConfiguration(Parser& parser, NetlistSink* sink);

/// Reads "for U1, U2 : COMPONENT use entity WORK.COMPONENT;", the token being "for". A binding to
/// the entity or the configuration that the component has anyway changes nothing.
/// \return why no model can have another binding; `place` is where it stands.
std::string ReadBinding(Parser& parser, Place& place);

} // namespace Orn_Hdl::Readers::Vhdl
