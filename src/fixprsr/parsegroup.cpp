#include "fix/kxfixvalidator.h"
#include "fixprsr/decimal.h"
#include "fixprsr/fieldreport.h"
#include "schema/fixfieldlist.h"

// Each repetition is one pass over the members in schema order, entry 0 (the counter)
// excepted. A nested group's repetitions are walked as soon as its counter is read.
BATCHERR KXFIXValidator::parseGroup(FIXFieldList* fields, KXFIXDoc& doc, int repetitions,
                                    int64_t& checkTotal) {
    groupLevels.clear();
    if (repetitions > 0) groupLevels.push_back({fields, repetitions, 1, false});
    while (!groupLevels.empty()) {
        GroupLevel& level = groupLevels.back();
        if (level.fields == nullptr || level.member >= level.fields->getCount()) {
            --level.repetitions;
            // A repetition that read nothing left the reader where it was: every later
            // one would repeat it, findings included.
            if (level.repetitions <= 0 || !level.readAny) {
                groupLevels.pop_back();
            } else {
                level.member = 1;
                level.readAny = false;
            }
            continue;
        }
        const FIXField& member = *level.fields->getAt(level.member++);
        // An empty tag (end of input, or a field that begins with "=") stays empty: every
        // open repetition would end at its next member, reporting nothing.
        if (doc.peekTag(fieldTag) == 0) break;
        if (!matchesDefinitionTag(member.getTag(), fieldTag)) {
            if (member.getRequirement() == Required)
                reportFieldFinding(*this, sourceName, member.getTag(), kFieldMissing);
            continue;
        }
        doc.readValue(fieldValue);
        checkTotal += doc.lastFieldSum();
        level.readAny = true;
        if (member.getValue().length() > 0 && !member.getPattern().matches(fieldValue.view()))
            reportFieldFinding(*this, sourceName, member.getTag(), kFieldMismatch);
        if (member.getIsField() == 0) {
            const int count = repetitionCount(fieldValue);
            if (count > 0) groupLevels.push_back({member.getChildren(), count, 1, false});
        }
    }
    groupLevels.clear();  // its entries point into a schema that lives only for this call
    return BATCH_OK;
}
