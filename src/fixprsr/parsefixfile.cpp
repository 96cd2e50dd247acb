#include <string_view>

#include "fix/kxfixvalidator.h"
#include "fixprsr/decimal.h"
#include "fixprsr/fieldreport.h"
#include "fixprsr/requiredcheck.h"

namespace {

using namespace std::string_view_literals;

// The finding when the field at this position of the file is not the header field due
// there; null when it is, or when the position is past the header.
const char16_t* headerFinding(int32_t fieldPosition, const KXWString& tag) {
    struct HeaderField {
        std::u16string_view tag;
        const char16_t* finding;
    };
    static constexpr HeaderField kHeader[] = {
        {u"8"sv, u"Failed to find BeginString"},
        {u"9"sv, u"Failed to find BodyLength"},
        {u"35"sv, u"Failed to find MsgType"},
    };
    if (fieldPosition < 1 || fieldPosition > 3) return nullptr;
    const HeaderField& expected = kHeader[fieldPosition - 1];
    return tag.view() == expected.tag ? nullptr : expected.finding;
}

// The total covers one message, from its BeginString to the separator before its
// CheckSum; it starts afresh for the next one.
void checkCheckSum(const KXWString& value, int64_t& checkTotal, KXValidator& validator,
                   const KXWString& file) {
    if (value.length() != 3)
        validator.addError(KXVAL_OTHER_ERROR, KXWString(u"The Checksum length is incorrect"), file,
                           -1, -1);
    checkTotal %= 256;
    if (leadingDecimal(value) != checkTotal)
        validator.addError(KXVAL_OTHER_ERROR, KXWString(u"The Checksum is incorrect"), file, -1,
                           -1);
    checkTotal = 0;
}

}  // namespace

BATCHERR KXFIXValidator::parseFIXFile(FIXFieldMap& fieldMap, KXFIXDoc& doc, int64_t& checkTotal) {
    TagIndex topLevel(fieldMap);
    int32_t fieldPosition = 0;
    while (doc.peekTag(fieldTag) > 0) {
        ++fieldPosition;
        if (const char16_t* finding = headerFinding(fieldPosition, fieldTag)) {
            addError(KXVAL_OTHER_ERROR, KXWString(finding), sourceName, -1, -1);
            return BATCH_CHECK_FAILED;
        }
        const TagIndex::Entry* entry = topLevel.read(fieldTag);
        if (entry == nullptr) {
            KXWString message(u"Failed to match tag=");
            message += fieldTag;
            message += u" in schema file";
            addError(KXVAL_OTHER_ERROR, message, sourceName, -1, -1);
            return BATCH_CHECK_FAILED;
        }
        const FIXField& definition = *entry->second;
        doc.readValue(fieldValue);
        if (fieldTag.view() == u"10"sv) {
            checkCheckSum(fieldValue, checkTotal, *this, sourceName);
        } else {
            if (fieldTag.view() == u"8"sv) checkTotal = 0;
            checkTotal += doc.lastFieldSum();
        }
        if (definition.getValue().length() > 0 &&
            !definition.getPattern().matches(fieldValue.view()))
            reportFieldFinding(*this, sourceName, definition.getTag(), kFieldMismatch);
        if (definition.getIsField() == 0)
            parseGroup(definition.getChildren(), doc, repetitionCount(fieldValue), checkTotal);
    }
    reportMissingRequired(fieldMap, topLevel, *this, sourceName);
    return BATCH_OK;
}
