// A schema file as an input source of the XML parser, read through the host's file proxy.
#pragma once

#include <xercesc/sax/InputSource.hpp>

#include "kxutil/kxwstring.h"

class FPInputSource : public xercesc::InputSource {
  public:
    // The file name is also the source's system id.
    explicit FPInputSource(const KXWString& fileName);
    ~FPInputSource() override;

    // Null when the file cannot be opened; the caller owns the stream.
    xercesc::BinInputStream* makeStream() const override;

  private:
    KXWString fileName;
    bool designMode = false;
};
