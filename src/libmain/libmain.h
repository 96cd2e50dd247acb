// The plug-in's entry points: the factory pair through which the host obtains and
// disposes of validators.
#pragma once

#include "kxapi/kxvalidator.h"
#include "kxvfixexport.h"

extern "C" {
// Null when the validator cannot be made.
KXVFIX_API KXValidator* KX_STDCALL NewValidator();
// Null is ignored.
KXVFIX_API void KX_STDCALL DeleteValidator(KXValidator* validator);
}
