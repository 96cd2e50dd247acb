#include "fix/kxfixvalidator.h"

#include <mutex>

#include <xercesc/util/PlatformUtils.hpp>
#include <xercesc/util/XMLException.hpp>
#include <xercesc/util/XMLUni.hpp>

#include "fix/options.h"
#include "kxutil/kxxmlutils.h"

namespace {

// Validators may be made on several threads at once, and the XML library's
// initialisation is not safe to run concurrently: the plug-in's one lock.
std::mutex xmlInitMutex;

}  // namespace

KXFIXValidator::KXFIXValidator() {
    const std::lock_guard<std::mutex> lock(xmlInitMutex);
    try {
        xercesc::XMLPlatformUtils::Initialize(xercesc::XMLUni::fgXercescDefaultLocale, nullptr,
                                              nullptr, nullptr);
    } catch (const xercesc::XMLException& e) {
        xmlReady = false;
        KXXmlUtils::XMLChToWchar(e.getMessage(), xmlInitError, false);
    }
}

// Copies share the library's initialisation; it is not repeated.
KXFIXValidator::KXFIXValidator(const KXFIXValidator& other) = default;
KXFIXValidator& KXFIXValidator::operator=(const KXFIXValidator& other) = default;

// The XML library is never terminated: other validators may still be using it.
KXFIXValidator::~KXFIXValidator() = default;

int KXFIXValidator::OptionDefCount() const {
    return kfixOptionCount;
}

const KXOptionDef* const* KXFIXValidator::GetOptionDefs() const {
    return optionDefs;
}
