#include <gtest/gtest.h>

#include <string>
#include <tuple>
#include <vector>

#include "kxapi/kxvalidator.h"

namespace {

// An option with callbacks and one without, as plug-ins declare them. The 8-bit callbacks
// are exercised through the plug-in's own options.
struct ToyValidator : KXValidator {
    KXWString path;
    int OptionDefCount() const override { return 2; }
    const KXOptionDef* const* GetOptionDefs() const override {
        static const KXOptionDef pathDef(
            u"path", u"Path", u"", 5, "default.xml", u"", nullptr, nullptr,
            [](void* self, KXWString& out, const char16_t*) {
                out = static_cast<ToyValidator*>(self)->path;
                return BATCH_OK;
            },
            [](void* self, const char16_t* value, bool&, const char16_t*) {
                static_cast<ToyValidator*>(self)->path = value;
                return BATCH_OK;
            },
            nullptr, 0, nullptr, nullptr, 65535, 1);
        static const KXOptionDef muteDef(u"Mute", u"", u"", 0, "", u"", nullptr, nullptr, nullptr,
                                         nullptr, nullptr, 0, nullptr, nullptr, 65535, 1);
        static const KXOptionDef* const defs[] = {&pathDef, &muteDef, nullptr};
        return defs;
    }
};

std::u16string option(const KXValidator& v, const char16_t* name) {
    KXWString value;
    EXPECT_EQ(v.GetOption(name, value), BATCH_OK);
    return value.c_str();
}

TEST(KXValidator, OptionsAreFoundByEitherExactNameAndLoadedFromLines) {
    ToyValidator v;
    EXPECT_EQ(v.SetOption(u"path", u"/a/\u00E9.xml"), BATCH_OK);
    EXPECT_EQ(option(v, u"Path"), u"/a/\u00E9.xml");
    KXWString value;
    for (const char16_t* name :
         {u"PATH", u"nosuch", u"Mute", static_cast<const char16_t*>(nullptr)}) {
        EXPECT_EQ(v.SetOption(name, u"1"), BATCH_UNKNOWN_OPTION);
        EXPECT_EQ(v.GetOption(name, value), BATCH_UNKNOWN_OPTION);  // Mute: no callbacks
    }
    EXPECT_EQ(v.FindOptionDef(u""), nullptr);  // though Mute has no alternate name
    EXPECT_EQ(KXValidator().SetOption(u"path", u"x"), BATCH_UNKNOWN_OPTION);
    KXString text("not an option line\npath=/x.xml\nunknown=1\nPath=/y.xml\r\n");
    v.LoadOptions(text);
    EXPECT_EQ(option(v, u"path"), u"/y.xml");
    v.LoadDynamicOptions();
    EXPECT_EQ(option(v, u"path"), u"default.xml");
}

TEST(KXValidator, KeepsErrorsInOrderUntilCleared) {
    KXValidator v;
    v.addError(KXVAL_OTHER_ERROR, KXWString(u"first"), KXWString(u"a.fix"), -1, -1);
    v.addError(KXVAL_FIELD_ERROR, KXWString(u"second"), KXWString(u"?"), 3, 4);
    const KXValidator copy(v);
    v.clearErrors();
    EXPECT_EQ(v.errorCount(), 0);
    using Error = std::tuple<KXVALERROR, std::u16string, std::u16string, int32_t, int32_t>;
    std::vector<Error> kept;
    for (int32_t i = 0; i < copy.errorCount(); ++i) {
        const KXValError& e = copy.errorAt(i);
        kept.emplace_back(e.kind, e.message.c_str(), e.file.c_str(), e.line, e.column);
    }
    EXPECT_EQ(kept, (std::vector<Error>{{KXVAL_OTHER_ERROR, u"first", u"a.fix", -1, -1},
                                        {KXVAL_FIELD_ERROR, u"second", u"?", 3, 4}}));
}

}  // namespace
