// The FIX validator the plug-in hands to the host.
#pragma once

#include <cstdint>
#include <vector>

#include "fixprsr/kxfixdoc.h"
#include "kxapi/kxvalidator.h"
#include "kxutil/kxwstring.h"
#include "kxvfixexport.h"
#include "schema/fixfield.h"

class FIXFieldList;

class KXVFIX_API KXFIXValidator : public KXValidator {
  public:
    KXFIXValidator();
    KXFIXValidator(const KXFIXValidator& other);
    KXFIXValidator& operator=(const KXFIXValidator& other);
    ~KXFIXValidator() override;

    BATCHERR Validate(const KXConnTarget& target) override;
    int OptionDefCount() const override;
    const KXOptionDef* const* GetOptionDefs() const override;

    void SchemaFile(const char16_t* path) { schemaFile = path; }
    const char16_t* SchemaFile() const { return schemaFile.c_str(); }
    void Unicode(bool on) { unicode = on; }
    bool Unicode() const { return unicode; }

  private:
    friend struct KXFIXValidatorAccess;  // white-box tests of the checks

    BATCHERR parseFIXFile(FIXFieldMap& fieldMap, KXFIXDoc& doc, int64_t& checkTotal);
    BATCHERR parseGroup(FIXFieldList* fields, KXFIXDoc& doc, int repetitions, int64_t& checkTotal);
    BATCHERR checkValidField(const KXWString& pattern, const KXWString& value);
    bool isLike(const KXWString& value, const KXWString& pattern);

    // One open group of parseGroup's walk: kept on the heap, not the call stack, so that
    // deeply nested groups cannot overflow it.
    struct GroupLevel {
        FIXFieldList* fields;
        int repetitions;  // still to walk, the current one included
        int32_t member;   // next member to try in the current repetition
        bool readAny;     // whether the current repetition consumed a field
    };
    // Working storage of the walk, reused so that reading a field allocates nothing.
    std::vector<GroupLevel> groupLevels;
    KXWString fieldTag;
    KXWString fieldValue;

    bool xmlReady = true;
    KXWString xmlInitError;
    KXFIXDoc fixDoc;
    KXWString sourceName;
    KXWString schemaFile;
    bool unicode = false;
};
