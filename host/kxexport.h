// Export and calling-convention macros shared by the host libraries and the plug-in.
#pragma once

#if defined(_WIN32)
#define KX_EXPORT __declspec(dllexport)
#define KX_IMPORT __declspec(dllimport)
#define KX_STDCALL __stdcall
#else
#define KX_EXPORT __attribute__((visibility("default")))
#define KX_IMPORT __attribute__((visibility("default")))
#define KX_STDCALL
#endif

#if defined(KXUTIL_BUILD)
#define KXUTIL_API KX_EXPORT
#else
#define KXUTIL_API KX_IMPORT
#endif

#if defined(KXAPI_BUILD)
#define KXAPI_API KX_EXPORT
#else
#define KXAPI_API KX_IMPORT
#endif
