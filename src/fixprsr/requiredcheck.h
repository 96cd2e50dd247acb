// The check, made once a whole file has been walked, that every required top-level
// definition occurred.
#pragma once

#include "fixprsr/tagindex.h"
#include "kxapi/kxvalidator.h"
#include "kxutil/kxwstring.h"
#include "schema/fixfield.h"

// Reports each required definition whose tag, without its group prefix, was not read at
// the top level. Groups nested in other groups are passed over: the group walk reports
// their absence within their parent.
void reportMissingRequired(const FIXFieldMap& fieldMap, const TagIndex& topLevel,
                           KXValidator& validator, const KXWString& file);
