// Base class of every validator a plug-in provides, with the option machinery and the
// list of errors the host reads after a validation.
#pragma once

#include <cstdint>

#include "kxapi/batcherr.h"
#include "kxapi/kxoptiondef.h"
#include "kxexport.h"
#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

class QueueMessage;  // message queues; no validator here reads them

struct KXConnTarget {
    KXString name;  // the source the validation reads
};

struct KXValError {
    KXVALERROR kind;
    KXWString message;
    KXWString file;
    int32_t line;
    int32_t column;
};

class KXAPI_API KXValidator {
  public:
    KXValidator();
    KXValidator(const KXValidator& other);
    KXValidator& operator=(const KXValidator& other);

    // The slot order below is the interface with plug-ins: never reorder it.
    virtual ~KXValidator();
    virtual BATCHERR Validate(const KXConnTarget& target);
    virtual BATCHERR validate(QueueMessage* in, QueueMessage* out);
    // Both find the definition by either of its names; BATCH_UNKNOWN_OPTION when none has
    // it or it offers no callback.
    virtual BATCHERR GetOption(const char16_t* name, KXWString& value) const;
    virtual BATCHERR SetOption(const char16_t* name, const char16_t* value);
    // Lines of NAME=VALUE (in character set 0), each set with SetOption; others are skipped.
    virtual void LoadOptions(KXString& text);
    // Sets every option to its definition's default value.
    virtual void LoadDynamicOptions();
    virtual const KXOptionDef* FindOptionDef(const char16_t* name) const;
    virtual int OptionDefCount() const;
    virtual const KXOptionDef* const* GetOptionDefs() const;

    void addError(KXVALERROR kind, const KXWString& message, const KXWString& file, int32_t line,
                  int32_t column);
    int32_t errorCount() const;
    const KXValError& errorAt(int32_t index) const;
    void clearErrors();

  private:
    struct Errors;
    Errors* errors_;
};
