// What the message parser and the group walk share about a definition's tag and the
// findings that name it.
#pragma once

#include <cstdint>

#include "kxapi/kxvalidator.h"
#include "kxutil/kxwstring.h"

constexpr const char16_t* kFieldMissing = u" is missing";
constexpr const char16_t* kFieldMismatch = u" failed to match specified value";

// Where a definition's tag stops being its prefix: a group's tag is "G." before its
// counter tag, recognised by a "." after the first character.
inline int32_t tagKeyStart(const KXWString& tag) {
    return tag.find(u'.') > 0 ? 2 : 0;
}

// Whether the tag read from the source is the definition's tag without its prefix.
bool matchesDefinitionTag(const KXWString& definitionTag, const KXWString& readTag);

// Reports "Field " + tag + finding as a field error of the file.
void reportFieldFinding(KXValidator& validator, const KXWString& file, const KXWString& tag,
                        const char16_t* finding);
