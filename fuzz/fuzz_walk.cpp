// The walk of a source over schemas loaded once. First byte: bit 0 picks the schema, bit 1
// reads the source as UTF-16; the rest is the source.
#include <memory>

#include "fix/kxfixvalidator.h"
#include "fuzzutil.h"
#include "schema/loadschema.h"

struct KXFIXValidatorAccess {
    static void walk(FIXFieldMap& map, KXFIXDoc& doc) {
        KXFIXValidator validator;
        validator.sourceName = u"source.fix";
        int64_t checkTotal = 0;
        validator.parseFIXFile(map, doc, checkTotal);
    }
};

namespace {

// Groups three deep, a required member in each, so that nesting and repetitions show.
constexpr char kNested[] =
    "<Spec><Transaction><Field><Tag>8</Tag><Value>FIX.4.4|FIX.4.2</Value></Field>"
    "<Field><Tag>9</Tag></Field><Field><Tag>35</Tag><Value>D|8</Value></Field>"
    "<Group><Field><Tag>1</Tag></Field><Sequence><Field><Tag>2</Tag><Requirement>R</Requirement>"
    "</Field><Group><Field><Tag>3</Tag></Field><Sequence><Field><Tag>4</Tag></Field><Group>"
    "<Field><Tag>5</Tag></Field><Sequence><Field><Tag>6</Tag><Requirement>R</Requirement>"
    "</Field></Sequence></Group></Sequence></Group><Field><Tag>7</Tag><Value>X|Y</Value>"
    "</Field></Sequence></Group><Field><Tag>10</Tag><Requirement>R</Requirement></Field>"
    "</Transaction></Spec>";

std::unique_ptr<FIXKXSchemaSpec> schemas[2];

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    fuzz::start();
    fuzz::ScratchFile nested(".xml");
    const char* paths[2] = {
        KXVFIX_FIX44_SCHEMA,
        nested.write(reinterpret_cast<const uint8_t*>(kNested), sizeof kNested - 1)};
    for (int i = 0; i < 2; ++i) {
        schemas[i] = std::make_unique<FIXKXSchemaSpec>();
        if (!loadSchema(*schemas[i], paths[i])) std::abort();
    }
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static fuzz::ScratchFile file(".fix");
    if (size == 0) return 0;
    KXFIXDoc doc;
    if (doc.openfile(file.write(data + 1, size - 1), "rbu",
                     (data[0] & 2) != 0 ? KX_CSET_UTF16 : KX_CSET_BYTE) != 0)
        std::abort();
    if (doc.isFIXFile()) KXFIXValidatorAccess::walk(schemas[data[0] & 1]->getFieldMap(), doc);
    return 0;
}
