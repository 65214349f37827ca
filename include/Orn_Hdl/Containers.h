/// \file
/// The containers of the library: sets and maps of names, arrays of pointers, lists of texts.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Containers/StringPtrMap.h"
#include "Orn_Hdl/Containers/StringSet.h"
