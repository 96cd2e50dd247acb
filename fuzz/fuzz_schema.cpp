// Any bytes as a schema document: loading must neither crash nor leak, whatever it builds.
#include "fuzzutil.h"
#include "schema/loadschema.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    fuzz::start();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static fuzz::ScratchFile file(".xml");
    FIXKXSchemaSpec handler;
    const bool loaded = loadSchema(handler, file.write(data, size));
    // A load that reports success must leave a usable model behind.
    if (loaded)
        for (const auto& entry : handler.getFieldMap())
            if (entry.second == nullptr) std::abort();
    return 0;
}
