// Schema and source together through the host's entry point: the input is the schema
// document, a NUL, then the source; the source's first byte set to 'U' reads it as UTF-16.
#include <algorithm>
#include <string>

#include "fix/kxfixvalidator.h"
#include "fuzzutil.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    fuzz::start();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static fuzz::ScratchFile schema(".xml");
    static fuzz::ScratchFile source(".fix");
    const uint8_t* end = data + size;
    const uint8_t* split = std::find(data, end, 0);
    schema.write(data, split - data);
    const uint8_t* body = split == end ? end : split + 1;
    const bool unicode = body != end && *body == 'U';
    if (unicode) ++body;
    KXFIXValidator validator;
    validator.SetOption(u"SchemaFile", schema.widePath().c_str());
    validator.SetOption(u"Unicode", unicode ? u"True" : u"False");
    validator.Validate(KXConnTarget{KXString(source.write(body, end - body))});
    return 0;
}
