#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kxutil/kxglob.h"
#include "kxutil/kxxmlutils.h"

namespace {

struct Captured {
    int32_t level;
    BATCHERR code;
    std::string line;
};

void capture(int32_t level, BATCHERR code, const char* line, void* context) {
    static_cast<std::vector<Captured>*>(context)->push_back({level, code, line});
}

TEST(KXGlob, LogMessageFormatsIntegersAndUtf16Texts) {
    std::vector<Captured> lines;
    KXGlob::SetLogSink(capture, &lines);
    KXGlob::LogMessage(8, BATCH_CHECK_FAILED,
                       lgettext("Browser: Fatal: At line %d, column %d of file %s: %s"), int32_t{3},
                       int32_t{-1}, u"/s\u00E9.xml", u"bad %d");
    KXGlob::LogMessage(2, BATCH_OK, "100%% %s %q", nullptr);
    KXGlob::SetLogSink(nullptr, nullptr);
    ASSERT_EQ(lines.size(), 2u);
    EXPECT_EQ(lines[0].level, 8);
    EXPECT_EQ(lines[0].code, BATCH_CHECK_FAILED);
    EXPECT_EQ(lines[0].line, "Browser: Fatal: At line 3, column -1 of file /s\xC3\xA9.xml: bad %d");
    EXPECT_EQ(lines[1].line, "100% (null) q");
}

TEST(KXGlob, TruthValuesFollowTheWordList) {
    const char* words = "True.False.true.false";
    struct Case {
        const char* text;
        bool expected;
    } const cases[] = {{"True", true},  {"true", true},  {"False", false}, {"false", false},
                       {"TRUE", false}, {"1", false},    {"", false},      {"True.", false},
                       {"Tru", false},  {nullptr, false}};
    for (const auto& c : cases)
        EXPECT_EQ(KXGlob::StrToBool(c.text, words), c.expected) << (c.text ? c.text : "null");
    EXPECT_TRUE(KXGlob::StrToBool(KXGlob::BoolToStr(true), words));
    EXPECT_FALSE(KXGlob::StrToBool(KXGlob::BoolToStr(false), words));
}

TEST(KXXmlUtils, ConversionReplacesTheWholeString) {
    KXWString out(u"old text");
    KXXmlUtils::XMLChToWchar(u"new", out, false);
    EXPECT_EQ(std::u16string(out.c_str()), u"new");
    KXXmlUtils::XMLChToWchar(nullptr, out, false);
    EXPECT_EQ(out.length(), 0);
}

}  // namespace
