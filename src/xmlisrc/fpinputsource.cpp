#include "xmlisrc/fpinputsource.h"

#include <xercesc/util/PlatformUtils.hpp>

#include "xmlisrc/fpinputstream.h"

FPInputSource::FPInputSource(const KXWString& name)
    : xercesc::InputSource(xercesc::XMLPlatformUtils::fgMemoryManager), fileName(name) {
    setSystemId(fileName.c_str());
}

FPInputSource::~FPInputSource() = default;

xercesc::BinInputStream* FPInputSource::makeStream() const {
    auto* stream = new (getMemoryManager()) FPInputStream(fileName, designMode);
    if (!stream->isOpen()) {
        delete stream;
        return nullptr;
    }
    return stream;
}
