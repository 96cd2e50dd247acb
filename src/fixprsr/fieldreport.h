// What the message parser and the group walk share about a definition's tag and the
// findings that name it.
#pragma once

#include <cstdint>
#include <string_view>

#include "kxapi/kxvalidator.h"
#include "kxutil/kxwstring.h"

constexpr const char16_t* kFieldMissing = u" is missing";
constexpr const char16_t* kFieldMismatch = u" failed to match specified value";

// Where a definition's tag stops being its prefix: a group's tag is "G." before its
// counter tag, recognised by a "." after the first character.
inline int32_t tagKeyStart(const KXWString& tag) {
    const size_t dot = tag.view().find(u'.');
    return dot != std::u16string_view::npos && dot > 0 ? 2 : 0;
}

// Whether the tag read from the source is the definition's tag without its prefix.
// Inline, and the lengths first: the group walk asks for every member it meets.
inline bool matchesDefinitionTag(const KXWString& definitionTag, const KXWString& readTag) {
    const std::u16string_view definition = definitionTag.view();
    const std::u16string_view read = readTag.view();
    const size_t start = definition.size() == read.size() ? 0 : 2;
    return definition.size() == read.size() + start && definition.substr(start) == read &&
           tagKeyStart(definitionTag) == static_cast<int32_t>(start);
}

// Reports "Field " + tag + finding as a field error of the file.
void reportFieldFinding(KXValidator& validator, const KXWString& file, const KXWString& tag,
                        const char16_t* finding);
