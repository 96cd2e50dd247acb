#include "fixprsr/requiredcheck.h"

#include "fixprsr/fieldreport.h"
#include "schema/fixfieldlist.h"

namespace {

// The map holds every group, nested ones too; a nested one is a group member of another
// group's list (entry 0, the counter, is never walked as a member).
std::unordered_set<const FIXField*> nestedGroups(const FIXFieldMap& fieldMap) {
    std::unordered_set<const FIXField*> nested;
    for (const auto& entry : fieldMap) {
        const FIXFieldList* children = entry.second->getChildren();
        if (entry.second->getIsField() != 0 || children == nullptr) continue;
        for (int32_t i = 1; i < children->getCount(); ++i) {
            const FIXField* child = children->getAt(i);
            if (child->getIsField() == 0) nested.insert(child);
        }
    }
    return nested;
}

}  // namespace

void reportMissingRequired(const FIXFieldMap& fieldMap, const TagIndex& topLevel,
                           KXValidator& validator, const KXWString& file) {
    const std::unordered_set<const FIXField*> nested = nestedGroups(fieldMap);
    for (const auto& entry : fieldMap) {
        const FIXField& definition = *entry.second;
        if (definition.getRequirement() != Required || nested.count(&definition) != 0) continue;
        const KXWString& tag = definition.getTag();
        const int32_t start = tagKeyStart(tag);
        if (topLevel.wasRead(tag.substr(start, tag.length() - start))) continue;
        reportFieldFinding(validator, file, tag, kFieldMissing);
    }
}
