/// \file
/// The whole library.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Containers.h"
#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Proof.h"
#include "Orn_Hdl/Readers.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers.h"
