#include "fix/kxfixvalidator.h"
#include "schema/fixkxschemaspec.h"
#include "schema/loadschema.h"

namespace {

constexpr char16_t kNoSchema[] = u"No schema specs file is found!";
constexpr char16_t kInitFailed[] = u"XmlFIXValidator: initializion failed!";
constexpr char16_t kBadSchema[] = u"Not a valid schema spec file!";
constexpr char16_t kCannotOpen[] = u"Unable to open source file!";
constexpr char16_t kNotFix[] = u"Source file is not a FIX file!";

}  // namespace

BATCHERR KXFIXValidator::Validate(const KXConnTarget& target) {
    sourceName.Assign(target.name, KX_CSET_DEFAULT);
    // Lives for this call only, and with it the schema model it loads.
    FIXKXSchemaSpec handler;
    auto refuse = [this](const char16_t* message, const KXWString& file) {
        addError(KXVAL_OTHER_ERROR, KXWString(message), file, -1, -1);
        return BATCH_NOT_PERFORMED;
    };
    if (schemaFile.length() == 0) return refuse(kNoSchema, KXWString(u"?"));
    if (!xmlReady) {
        KXWString message(kInitFailed);
        message += xmlInitError;
        return refuse(message.c_str(), schemaFile);
    }
    KXString schemaPath;
    schemaPath.Assign(schemaFile.c_str(), KX_CSET_DEFAULT, -1);
    if (!loadSchema(handler, schemaPath.c_str())) return refuse(kBadSchema, schemaFile);

    if (fixDoc.openfile(sourceName.c_str(), "rbu", unicode ? KX_CSET_UTF16 : KX_CSET_BYTE) == -1)
        return refuse(kCannotOpen, sourceName);
    if (!fixDoc.isFIXFile()) {
        fixDoc.close(false);
        return refuse(kNotFix, sourceName);
    }
    int64_t checkTotal = 0;
    const BATCHERR result = parseFIXFile(handler.getFieldMap(), fixDoc, checkTotal);
    fixDoc.close(false);
    return result;
}
