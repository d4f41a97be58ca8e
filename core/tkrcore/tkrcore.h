// Everything of the core contract in one include.
#pragma once

#include "tkrcore/CIMInterfaces.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMDateTime.h"
#include "tkrcore/TCIMReference.h"
#include "tkrcore/TCIMSchemaHelper.h"
#include "tkrcore/TCIMValue.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"
