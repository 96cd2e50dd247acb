#include "schema/loadschema.h"

#include <xercesc/framework/XMLPScanToken.hpp>
#include <xercesc/parsers/SAXParser.hpp>
#include <xercesc/util/PlatformUtils.hpp>
#include <xercesc/util/SecurityManager.hpp>
#include <xercesc/validators/DTD/DTDValidator.hpp>

#include <memory>

#include "kxutil/kxwstring.h"
#include "xmlisrc/fpinputsource.h"

namespace {

// Bounds the work entity expansion may cause ("billion laughs"); a schema needs few.
constexpr XMLSize_t kEntityExpansionLimit = 10000;

}  // namespace

bool loadSchema(FIXKXSchemaSpec& handler, const char* path) {
    handler.errorFlag = false;
    handler.validator = new xercesc::DTDValidator();
    bool result = true;
    {
        xercesc::SAXParser parser(handler.validator, xercesc::XMLPlatformUtils::fgMemoryManager,
                                  nullptr);
        parser.setDocumentHandler(&handler);
        parser.setErrorHandler(&handler);
        parser.setEntityResolver(&handler);
        xercesc::SecurityManager security;
        security.setEntityExpansionLimit(kEntityExpansionLimit);
        parser.setSecurityManager(&security);
        xercesc::XMLPScanToken token;
        KXWString widePath;
        widePath.Assign(path, KX_CSET_DEFAULT, -1);
        const std::unique_ptr<FPInputSource> source(new FPInputSource(widePath));
        try {
            if (parser.parseFirst(*source, token)) {
                while (parser.parseNext(token)) {
                }
            } else {
                result = false;
            }
        } catch (...) {
            handler.errorFlag = true;
        }
        handler.validator = nullptr;
    }
    return result && !handler.errorFlag;
}
