// The check, made once a whole file has been walked, that every required top-level
// definition occurred.
#pragma once

#include <unordered_set>

#include "kxapi/kxvalidator.h"
#include "kxutil/kxwstring.h"
#include "schema/fixfield.h"

// The entries of the field map whose tag was read at the top level.
using SeenEntries = std::unordered_set<const FIXFieldMap::value_type*>;

// Reports each required definition whose tag, without its group prefix, was not read at
// the top level. Groups nested in other groups are passed over: the group walk reports
// their absence within their parent.
void reportMissingRequired(const FIXFieldMap& fieldMap, const SeenEntries& seen,
                           KXValidator& validator, const KXWString& file);
