#include "kxapi/kxvalidator.h"

#include <cstring>
#include <vector>

struct KXValidator::Errors {
    std::vector<KXValError> list;
};

KXValidator::KXValidator() : errors_(new Errors) {}

KXValidator::KXValidator(const KXValidator& other) : errors_(new Errors(*other.errors_)) {}

KXValidator& KXValidator::operator=(const KXValidator& other) {
    if (this != &other) errors_->list = other.errors_->list;
    return *this;
}

KXValidator::~KXValidator() {
    delete errors_;
}

BATCHERR KXValidator::Validate(const KXConnTarget& /*target*/) {
    return BATCH_NOT_PERFORMED;
}

BATCHERR KXValidator::validate(QueueMessage* /*in*/, QueueMessage* /*out*/) {
    return BATCH_NOT_PERFORMED;
}

BATCHERR KXValidator::GetOption(const char16_t* name, KXWString& value) const {
    const KXOptionDef* def = FindOptionDef(name);
    if (def == nullptr) return BATCH_UNKNOWN_OPTION;
    auto* self = const_cast<KXValidator*>(this);  // callbacks take the object untyped
    if (def->get16() != nullptr) return def->get16()(self, value, def->name().c_str());
    if (def->get8() != nullptr) {
        KXString narrow;
        const BATCHERR result = def->get8()(self, narrow, def->name().c_str());
        value.Assign(narrow, KX_CSET_DEFAULT);
        return result;
    }
    return BATCH_UNKNOWN_OPTION;
}

BATCHERR KXValidator::SetOption(const char16_t* name, const char16_t* value) {
    const KXOptionDef* def = FindOptionDef(name);
    if (def == nullptr) return BATCH_UNKNOWN_OPTION;
    bool changed = false;
    if (def->set16() != nullptr) return def->set16()(this, value, changed, def->name().c_str());
    if (def->set8() != nullptr) {
        KXString narrow;
        narrow.Assign(value, KX_CSET_DEFAULT);
        return def->set8()(this, narrow.c_str(), changed, def->name().c_str());
    }
    return BATCH_UNKNOWN_OPTION;
}

void KXValidator::LoadOptions(KXString& text) {
    const char* p = text.c_str();
    while (*p != 0) {
        const char* end = std::strchr(p, '\n');
        const size_t n = end != nullptr ? static_cast<size_t>(end - p) : std::strlen(p);
        const char* eq = static_cast<const char*>(std::memchr(p, '=', n));
        if (eq != nullptr) {
            KXWString name;
            KXWString value;
            name.Assign(p, KX_CSET_DEFAULT, static_cast<int32_t>(eq - p));
            size_t valueLength = n - static_cast<size_t>(eq - p) - 1;
            if (valueLength > 0 && eq[valueLength] == '\r') --valueLength;
            value.Assign(eq + 1, KX_CSET_DEFAULT, static_cast<int32_t>(valueLength));
            SetOption(name.c_str(), value.c_str());
        }
        p += n;
        if (*p == '\n') ++p;
    }
}

void KXValidator::LoadDynamicOptions() {
    const KXOptionDef* const* defs = GetOptionDefs();
    for (int i = 0; defs != nullptr && i < OptionDefCount(); ++i) {
        KXWString value;
        value.Assign(defs[i]->defaultValue(), KX_CSET_DEFAULT);
        SetOption(defs[i]->name().c_str(), value.c_str());
    }
}

const KXOptionDef* KXValidator::FindOptionDef(const char16_t* name) const {
    const KXOptionDef* const* defs = GetOptionDefs();
    for (int i = 0; defs != nullptr && i < OptionDefCount(); ++i)
        if (defs[i] != nullptr && defs[i]->isNamed(name)) return defs[i];
    return nullptr;
}

int KXValidator::OptionDefCount() const {
    return 0;
}

const KXOptionDef* const* KXValidator::GetOptionDefs() const {
    return nullptr;
}

void KXValidator::addError(KXVALERROR kind, const KXWString& message, const KXWString& file,
                           int32_t line, int32_t column) {
    errors_->list.push_back(KXValError{kind, message, file, line, column});
}

int32_t KXValidator::errorCount() const {
    return static_cast<int32_t>(errors_->list.size());
}

const KXValError& KXValidator::errorAt(int32_t index) const {
    return errors_->list.at(static_cast<size_t>(index));
}

void KXValidator::clearErrors() {
    errors_->list.clear();
}
