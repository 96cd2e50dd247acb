// The validator's option table, shared by every validator of the library.
#pragma once

#include "kxapi/kxoptiondef.h"

constexpr int kfixOptionCount = 2;

// SchemaFile, Unicode, then null.
extern const KXOptionDef* const optionDefs[kfixOptionCount + 1];

BATCHERR getUnicodeOption(void* object, KXString& result, const char16_t* text);
BATCHERR setUnicodeOption(void* object, const char* value, bool& changed, const char16_t* text);
BATCHERR getSchemaFileOption(void* object, KXWString& result, const char16_t* text);
BATCHERR setSchemaFileOption(void* object, const char16_t* value, bool& changed,
                             const char16_t* text);
