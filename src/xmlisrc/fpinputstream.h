// The bytes of a file, read through the host's file proxy, for the XML parser.
#pragma once

#include <xercesc/util/BinInputStream.hpp>

#include "kxutil/kxfileproxy.h"
#include "kxutil/kxwstring.h"

class FPInputStream : public xercesc::BinInputStream {
  public:
    // Opens the file; isOpen() tells whether that worked.
    FPInputStream(const KXWString& fileName, bool designMode);
    ~FPInputStream() override;

    bool isOpen() const { return proxy.isOpen(); }

    XMLFilePos curPos() const override { return bytesDelivered; }
    XMLSize_t readBytes(XMLByte* toFill, XMLSize_t maxToRead) override;
    // The parser recognises the encoding itself.
    const XMLCh* getContentType() const override { return nullptr; }

  private:
    KXFileProxy proxy;
    uint32_t bytesDelivered = 0;
};
