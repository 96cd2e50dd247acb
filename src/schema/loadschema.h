// Reads a schema specification file into a handler's model.
#pragma once

#include "schema/fixkxschemaspec.h"

// True when the file was parsed to its end without error; the handler keeps whatever was
// built either way. path is 8-bit text (UTF-8 here).
bool loadSchema(FIXKXSchemaSpec& handler, const char* path);
