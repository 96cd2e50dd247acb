#include "schema/fixkxschemaspec.h"

#include <xercesc/framework/MemBufInputSource.hpp>
#include <xercesc/sax/Locator.hpp>
#include <xercesc/sax/SAXParseException.hpp>

#include <algorithm>
#include <cstdint>
#include <string_view>

#include "kxutil/kxglob.h"
#include "kxutil/kxxmlutils.h"

namespace {

int32_t clampToInt32(XMLFileLoc value) {
    return static_cast<int32_t>(std::min<XMLFileLoc>(value, INT32_MAX));
}

void logDiagnostic(int32_t level, const char* format, int32_t line, int32_t column,
                   const XMLCh* systemId, const XMLCh* message) {
    KXGlob::LogMessage(level, BATCH_CHECK_FAILED, lgettext(format), line, column,
                       systemId != nullptr ? systemId : u"", message != nullptr ? message : u"");
}

void logException(int32_t level, const char* format, const xercesc::SAXParseException& e) {
    logDiagnostic(level, format, clampToInt32(e.getLineNumber()), clampToInt32(e.getColumnNumber()),
                  e.getSystemId(), e.getMessage());
}

// Each node's qualified tag spells its whole group path, so deep nesting costs memory in
// the square of the depth. FIX nests a few levels; far deeper is refused.
constexpr int32_t kMaxGroupDepth = 100;
constexpr char16_t kNestingRefused[] = u"Groups nested deeper than 100 are refused";

// Ends the parse from inside a callback; the load answers false.
struct NestingRefused {};

constexpr const char* kWarning = "Browser: Warning: At line %d, column %d of file %s: %s";
constexpr const char* kError = "Browser: Error: At line %d, column %d of file %s: %s";
constexpr const char* kFatal = "Browser: Fatal: At line %d, column %d of file %s: %s";

// A URL scheme other than file (a single letter is a Windows drive, not a scheme).
bool isRemote(const XMLCh* systemId) {
    if (systemId == nullptr) return false;
    size_t n = 0;
    while (systemId[n] != 0 && systemId[n] != u':' && systemId[n] != u'/' && systemId[n] != u'\\')
        ++n;
    if (systemId[n] != u':' || n < 2) return false;
    const KXWString scheme(systemId, static_cast<int32_t>(n));
    return scheme != u"file" && scheme != u"FILE";
}

bool isNamed(const KXWString& name, std::u16string_view text) {
    return name.view() == text;
}

bool isHeaderElement(const KXWString& name) {
    static constexpr std::u16string_view kHeader[] = {
        u"Title",        u"Subject",      u"AuthorName",   u"TradingPartner", u"Version",
        u"CreationDate", u"LastModified", u"IndustryType", u"Standard",       u"StdVersion"};
    return std::any_of(std::begin(kHeader), std::end(kHeader),
                       [&name](std::u16string_view h) { return isNamed(name, h); });
}

}  // namespace

FIXKXSchemaSpec::~FIXKXSchemaSpec() {
    topLevelFields.clear();
    fieldMap.clear();
    while (groupStack.getCount() > 0) groupStack.dropLast();
    for (FIXField* node : openFields) delete node;
}

// Local files are left to the parser; nothing is ever fetched from the network. A refused
// entity reads as empty and fails the load.
xercesc::InputSource* FIXKXSchemaSpec::resolveEntity(const XMLCh* /*publicId*/,
                                                     const XMLCh* systemId) {
    if (!isRemote(systemId)) return nullptr;
    KXWString message(u"External entity not fetched, only local files are read: ");
    message += systemId;
    refuse(message.c_str());
    static const XMLByte kNothing[] = {0};
    return new xercesc::MemBufInputSource(kNothing, 0, systemId);
}

void FIXKXSchemaSpec::refuseNesting() {
    refuse(kNestingRefused);
    throw NestingRefused();
}

void FIXKXSchemaSpec::refuse(const char16_t* message) {
    errorFlag = true;
    logDiagnostic(8, kFatal, locator != nullptr ? clampToInt32(locator->getLineNumber()) : 0,
                  locator != nullptr ? clampToInt32(locator->getColumnNumber()) : 0,
                  locator != nullptr ? locator->getSystemId() : nullptr, message);
}

void FIXKXSchemaSpec::setDocumentLocator(const xercesc::Locator* documentLocator) {
    locator = documentLocator;
}

void FIXKXSchemaSpec::characters(const XMLCh* chars, XMLSize_t /*length*/) {
    // The parser may split one element's text into several chunks: keep them all.
    text += chars;
}

void FIXKXSchemaSpec::startElement(const XMLCh* name, xercesc::AttributeList& /*attributes*/) {
    KXXmlUtils::XMLChToWchar(name, elementName, false);
    text.clear();
    if (isNamed(elementName, u"Field")) {
        ++fieldDepth;
        handleElement(0);
    } else if (isNamed(elementName, u"Group")) {
        if (++groupDepth > kMaxGroupDepth) refuseNesting();
        handleElement(9);
    } else if (isNamed(elementName, u"Sequence")) {
        ++sequenceDepth;
    }
}

void FIXKXSchemaSpec::endElement(const XMLCh* name) {
    KXXmlUtils::XMLChToWchar(name, elementName, false);
    if (isHeaderElement(elementName) || isNamed(elementName, u"Transaction")) return;
    if (isNamed(elementName, u"Field")) {
        --fieldDepth;
        handleElement(6);
    } else if (isNamed(elementName, u"Group")) {
        --groupDepth;
        handleElement(10);
    } else if (isNamed(elementName, u"Sequence")) {
        --sequenceDepth;
    } else if (isNamed(elementName, u"Tag")) {
        handleElement(1);
    } else if (isNamed(elementName, u"Name")) {
        if (fieldDepth != 0) handleElement(2);
    } else if (isNamed(elementName, u"Format")) {
        handleElement(3);
    } else if (isNamed(elementName, u"Requirement")) {
        handleElement(4);
    } else if (isNamed(elementName, u"Value")) {
        handleElement(5);
    }
}

void FIXKXSchemaSpec::warning(const xercesc::SAXParseException& e) {
    logException(2, kWarning, e);
}

void FIXKXSchemaSpec::error(const xercesc::SAXParseException& e) {
    logException(4, kError, e);
    errorFlag = true;
}

void FIXKXSchemaSpec::fatalError(const xercesc::SAXParseException& e) {
    logException(8, kFatal, e);
    errorFlag = true;
}

void FIXKXSchemaSpec::handleElement(int code) {
    // Properties that close before any node was begun have nothing to apply to.
    if (code >= 1 && code <= 5 && currentField == nullptr) return;
    switch (code) {
        case 0:
            openFields.push_back(new FIXField);
            currentField = openFields.back();
            currentField->setIsField(1);
            break;
        case 1:
            applyTag();
            break;
        case 2:
            currentField->setName(text);
            break;
        case 3:
            currentField->setFormat(text);
            break;
        case 4:
            applyRequirement();
            break;
        case 5:
            currentField->setValue(text);
            break;
        case 6:
            endField();
            break;
        case 9:
            beginGroup();
            break;
        case 10:
            groupStack.dropLast();
            break;
        default:
            break;
    }
}

int FIXKXSchemaSpec::requirementCode(const KXWString& requirement) {
    if (isNamed(requirement, u"R")) return Required;
    if (isNamed(requirement, u"C")) return Conditional;
    return Optional;
}

void FIXKXSchemaSpec::applyTag() {
    currentField->setTag(text);
    if (inGroupHeader()) {
        FIXField* group = groupStack.getLast();
        KXWString groupTag(u"G.");
        groupTag += text;
        group->setTag(groupTag);
        fieldMap[text] = group;
        KXWString qualified = group->getQualifiedTag();
        qualified += groupTag;
        group->setQualifiedTag(qualified);
    }
    KXWString qualified = bracketPath();
    qualified += text;
    currentField->setQualifiedTag(qualified);
}

void FIXKXSchemaSpec::applyRequirement() {
    const int code = requirementCode(text);
    currentField->setRequirement(code);
    if (inGroupHeader()) groupStack.getLast()->setRequirement(code);
}

void FIXKXSchemaSpec::endField() {
    if (openFields.empty()) return;
    FIXField* node = openFields.back();
    openFields.pop_back();
    if (!place(node, true) && currentField == node) currentField = nullptr;
}

void FIXKXSchemaSpec::beginGroup() {
    auto* group = new FIXField;
    group->setIsField(0);
    group->setQualifiedTag(bracketPath());
    currentField = group;
    if (!place(group, false) || groupStack.append(group) == nullptr) currentField = nullptr;
}

bool FIXKXSchemaSpec::place(FIXField* node, bool isFieldNode) {
    node->setOrdinal(nextOrdinal);
    FIXField* placed = groupStack.getCount() == 0 ? topLevelFields.append(node)
                                                  : groupStack.getLast()->addChild(node);
    if (placed == nullptr) {
        delete node;
        return false;
    }
    if (isFieldNode && groupStack.getCount() == 0) fieldMap[node->getTag()] = node;
    ++nextOrdinal;
    return true;
}

KXWString FIXKXSchemaSpec::bracketPath() const {
    KXWString path;
    if (groupStack.getCount() == 0) return path;
    path += u'[';
    for (int32_t i = 0; i < groupStack.getCount(); ++i) {
        if (i > 0) path += u'!';
        path += groupStack.getAt(i)->getTag();
    }
    path += u']';
    return path;
}
