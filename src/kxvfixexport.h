// Visibility of what the plug-in exports; everything else stays inside it.
#pragma once

#include "kxexport.h"

#if defined(_WIN32)
// The DLL exports only its two entry points, through its module-definition file.
#define KXVFIX_API
#elif defined(KXVFIX_BUILD)
#define KXVFIX_API KX_EXPORT
#else
#define KXVFIX_API KX_IMPORT
#endif
