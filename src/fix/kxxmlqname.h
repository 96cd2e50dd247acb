// Small value classes the plug-in exports for its host; the validator does not use them.
#pragma once

#include "kxutil/kxwstring.h"
#include "kxvfixexport.h"

using KXXString = KXWString;  // XML text: UTF-16, like the XML library's own

class KXVFIX_API KXXmlQName {
  public:
    KXXmlQName() = default;
    KXXmlQName(const KXXString& localPart, const KXXString& namespaceURI)
        : localPart_(localPart), namespaceURI_(namespaceURI) {}

    const KXXString& localPart() const { return localPart_; }
    const KXXString& namespaceURI() const { return namespaceURI_; }
    bool isNull() const { return localPart_.length() == 0 && namespaceURI_.length() == 0; }

  private:
    KXXString localPart_;
    KXXString namespaceURI_;
};

class KXVFIX_API kxcomplex {
  public:
    kxcomplex() = default;
    kxcomplex(double first, double second) : first_(first), second_(second) {}

    double first() const { return first_; }
    double second() const { return second_; }

  private:
    double first_ = 0.0;
    double second_ = 0.0;
};
