#pragma once

// The host SDK, as a plug-in includes it.

#include "assetmanagement.h"
#include "bitmap.h"
#include "custcont.h"
#include "ifnpub.h"
#include "imtl.h"
#include "iparamb2.h"
#include "maxapi.h"
#include "maxtypes.h"
#include "mentalray.h"
#include "ref.h"
