// Visibility of what the plug-in exports; everything else stays inside it.
#pragma once

#include "kxexport.h"

#if defined(KXVFIX_BUILD)
#define KXVFIX_API KX_EXPORT
#else
#define KXVFIX_API KX_IMPORT
#endif
