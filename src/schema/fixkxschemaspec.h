// Reads a schema specification document, as the XML parser's SAX handler, into the schema
// model, and logs the parser's diagnostics.
#pragma once

#include <xercesc/sax/HandlerBase.hpp>

#include <cstdint>
#include <vector>

#include "kxutil/kxwstring.h"
#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

XERCES_CPP_NAMESPACE_BEGIN
class DTDValidator;
class Locator;
XERCES_CPP_NAMESPACE_END

class FIXKXSchemaSpec : public xercesc::HandlerBase {
  public:
    FIXKXSchemaSpec() = default;
    FIXKXSchemaSpec(const FIXKXSchemaSpec&) = delete;
    FIXKXSchemaSpec& operator=(const FIXKXSchemaSpec&) = delete;
    ~FIXKXSchemaSpec() override;

    xercesc::InputSource* resolveEntity(const XMLCh* publicId, const XMLCh* systemId) override;
    void characters(const XMLCh* chars, XMLSize_t length) override;
    void endElement(const XMLCh* name) override;
    void setDocumentLocator(const xercesc::Locator* locator) override;
    void startElement(const XMLCh* name, xercesc::AttributeList& attributes) override;
    void warning(const xercesc::SAXParseException& e) override;
    void error(const xercesc::SAXParseException& e) override;
    void fatalError(const xercesc::SAXParseException& e) override;

    // Element events: 0 Field start, 1 Tag end, 2 Name end, 3 Format end, 4 Requirement
    // end, 5 Value end, 6 Field end, 9 Group start, 10 Group end; others do nothing.
    void handleElement(int code);
    // "R", "O" and "C"; every other text is optional.
    static int requirementCode(const KXWString& text);

    FIXFieldMap& getFieldMap() { return fieldMap; }

  private:
    friend bool loadSchema(FIXKXSchemaSpec& handler, const char* path);

    // A fatal diagnostic of the reader's own, at the parser's position; fails the load.
    void refuse(const char16_t* message);
    [[noreturn]] void refuseNesting();
    void applyTag();
    void applyRequirement();
    void beginGroup();
    void endField();
    // Hands node to its owning list; false (and the node destroyed) when it cannot be.
    bool place(FIXField* node, bool isFieldNode);
    KXWString bracketPath() const;
    bool inGroupHeader() const { return groupDepth > sequenceDepth && groupStack.getCount() > 0; }

    int32_t fieldDepth = 0;
    int32_t groupDepth = 0;
    int32_t sequenceDepth = 0;
    int32_t nextOrdinal = 0;
    xercesc::DTDValidator* validator = nullptr;
    bool errorFlag = false;
    KXWString elementName;
    KXWString text;
    FIXField* currentField = nullptr;
    // Fields begun and not yet ended, innermost last; owned here until placed, so that a
    // Field inside a Field or a parse that stopped inside one cannot leak or double-own.
    std::vector<FIXField*> openFields;
    FIXFieldList topLevelFields;
    FIXFieldList groupStack;  // refers only: never destroys its entries
    FIXFieldMap fieldMap;
    const xercesc::Locator* locator = nullptr;
};
