/// \file
/// The header banner and the writers of both languages.
#pragma once

#include "Orn_Hdl/Writers/NetlistHeader.h"
#include "Orn_Hdl/Writers/Verilog.h"
#include "Orn_Hdl/Writers/Vhdl.h"
