#include <gtest/gtest.h>

#include <string>

#include "kxapi/kxvalidator.h"
#include "kxutil/kxglob.h"

namespace {

// A validator with one option of each callback kind, as plug-ins declare them.
class ToyValidator : public KXValidator {
  public:
    static BATCHERR getPath(void* self, KXWString& out, const char16_t*) {
        out = static_cast<ToyValidator*>(self)->path;
        return BATCH_OK;
    }
    static BATCHERR setPath(void* self, const char16_t* value, bool& changed, const char16_t*) {
        static_cast<ToyValidator*>(self)->path = value;
        changed = true;
        return BATCH_OK;
    }
    static BATCHERR getFlag(void* self, KXString& out, const char16_t*) {
        out = KXGlob::BoolToStr(static_cast<ToyValidator*>(self)->flag);
        return BATCH_OK;
    }
    static BATCHERR setFlag(void* self, const char* value, bool& changed, const char16_t*) {
        static_cast<ToyValidator*>(self)->flag = KXGlob::StrToBool(value, "True.False");
        changed = true;
        return BATCH_OK;
    }

    int OptionDefCount() const override { return 3; }
    const KXOptionDef* const* GetOptionDefs() const override {
        static const KXOptionDef pathDef(u"path", u"Path", u"a path", 5, "default.xml", u"",
                                         nullptr, nullptr, getPath, setPath, nullptr, 0, nullptr,
                                         nullptr, 65535, 1);
        static const KXOptionDef flagDef(u"Flag", u"Flag", u"a flag", 0, "True", u"", getFlag,
                                         setFlag, nullptr, nullptr, nullptr, 0, nullptr, nullptr,
                                         65535, 1);
        static const KXOptionDef mute(u"Mute", u"Mute", u"no callbacks", 0, "", u"", nullptr,
                                      nullptr, nullptr, nullptr, nullptr, 0, nullptr, nullptr,
                                      65535, 1);
        static const KXOptionDef* const defs[] = {&pathDef, &flagDef, &mute, nullptr};
        return defs;
    }

    KXWString path;
    bool flag = false;
};

std::u16string option(const KXValidator& v, const char16_t* name) {
    KXWString value;
    EXPECT_EQ(v.GetOption(name, value), BATCH_OK) << std::string(name, name + 4);
    return value.c_str();
}

TEST(KXValidator, OptionsAreFoundByEitherNameAndUseTheirCallbacks) {
    ToyValidator v;
    EXPECT_EQ(v.SetOption(u"path", u"/a/\u00E9.xml"), BATCH_OK);
    EXPECT_EQ(option(v, u"Path"), u"/a/\u00E9.xml");
    EXPECT_EQ(v.SetOption(u"Flag", u"True"), BATCH_OK);
    EXPECT_TRUE(v.flag);
    EXPECT_EQ(option(v, u"Flag"), u"True");
    EXPECT_NE(v.FindOptionDef(u"Path"), nullptr);
    EXPECT_EQ(v.FindOptionDef(u"PATH"), nullptr);
}

TEST(KXValidator, UnknownOrSilentOptionsAreErrorCodes) {
    ToyValidator v;
    KXWString value;
    EXPECT_EQ(v.SetOption(u"nosuch", u"1"), BATCH_UNKNOWN_OPTION);
    EXPECT_EQ(v.GetOption(u"nosuch", value), BATCH_UNKNOWN_OPTION);
    EXPECT_EQ(v.GetOption(u"Mute", value), BATCH_UNKNOWN_OPTION);
    EXPECT_EQ(v.SetOption(nullptr, u"1"), BATCH_UNKNOWN_OPTION);
    KXValidator plain;
    EXPECT_EQ(plain.SetOption(u"path", u"x"), BATCH_UNKNOWN_OPTION);
    EXPECT_EQ(plain.Validate(KXConnTarget{}), BATCH_NOT_PERFORMED);
}

TEST(KXValidator, LoadsOptionLinesAndDefaults) {
    ToyValidator v;
    KXString text("Path=/x.xml\r\nnot an option line\nFlag=True\nunknown=1");
    v.LoadOptions(text);
    EXPECT_EQ(option(v, u"path"), u"/x.xml");
    EXPECT_TRUE(v.flag);
    v.flag = false;
    v.LoadDynamicOptions();
    EXPECT_EQ(option(v, u"path"), u"default.xml");
    EXPECT_TRUE(v.flag);
}

TEST(KXValidator, KeepsErrorsInOrderUntilCleared) {
    ToyValidator v;
    v.addError(KXVAL_OTHER_ERROR, KXWString(u"first"), KXWString(u"a.fix"), -1, -1);
    v.addError(KXVAL_FIELD_ERROR, KXWString(u"second"), KXWString(u"?"), 3, 4);
    ASSERT_EQ(v.errorCount(), 2);
    EXPECT_EQ(v.errorAt(0).kind, KXVAL_OTHER_ERROR);
    EXPECT_EQ(std::u16string(v.errorAt(1).message.c_str()), u"second");
    EXPECT_EQ(std::u16string(v.errorAt(1).file.c_str()), u"?");
    EXPECT_EQ(v.errorAt(1).line, 3);
    ToyValidator copy(v);
    v.clearErrors();
    EXPECT_EQ(v.errorCount(), 0);
    EXPECT_EQ(copy.errorCount(), 2);
}

}  // namespace
