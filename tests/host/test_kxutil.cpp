#include <gtest/gtest.h>

#if defined(_WIN32)
#include <windows.h>
#endif

#include <map>
#include <string>
#include <utility>
#include <vector>

#include "kxutil/kxglob.h"
#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

namespace {

std::u16string str(const KXWString& s) {  // by length: a stray zero must not hide the rest
    return {s.c_str(), static_cast<size_t>(s.length())};
}

TEST(KXWString, SearchGrowAndCompareExactly) {
    KXWString s(u"G.453");
    EXPECT_EQ(s.find(u'.'), 1);
    EXPECT_EQ(s.find(u'x'), -1);
    EXPECT_EQ(s.find(u'4', 3), -1);
    EXPECT_EQ(str(s.substr(2, 99)), u"453");
    for (int i = 0; i < 5; ++i) s += s.c_str();        // its own text, moved by growth
    EXPECT_EQ(str(s.substr(150, 99)), u"G.453G.453");  // 160 long: the count is clamped
    const char16_t* storage = s.c_str();
    s.clear();  // keeps the storage, so a reused working string stops allocating
    s += u'x';
    EXPECT_EQ(s.c_str(), storage);
    KXWString copy(s);
    copy += u'y';
    EXPECT_EQ(str(s), u"x");
    EXPECT_EQ(str(copy), u"xy");
    // Tags are map keys: exact texts, never numbers.
    const std::map<KXWString, int> map{{KXWString(u"35"), 1}, {KXWString(u"8"), 2}};
    EXPECT_EQ(map.count(KXWString(u"035")), 0u);
    EXPECT_EQ(map.count(KXWString(u"35")), 1u);
    EXPECT_TRUE(KXWString(u"35") == KXWString(u"35") && !(KXWString(u"35") == KXWString(u"350")));
}

#if !defined(_WIN32)
TEST(KXWString, ConvertsUtf8BothWaysAndReplacesWhatCannotConvert) {
    const std::pair<const char*, std::u16string> cases[] = {
        {"plain/path.fix", u"plain/path.fix"},
        {"caf\xC3\xA9", u"caf\u00E9"},
        {"\xE2\x82\xAC", u"\u20AC"},
        {"\xF0\x9F\x98\x80", u"\U0001F600"},
        {"bad\xFF", u"bad\uFFFD"},
        {"cut\xE2\x82", u"cut\uFFFD"},
        {"\xC0\xAF", u"\uFFFD"},  // overlong
    };
    for (const auto& [utf8, utf16] : cases) {
        const bool lossless = utf16.find(u'\uFFFD') == std::u16string::npos;
        KXWString w;
        EXPECT_EQ(w.Assign(utf8, KX_CSET_DEFAULT, -1), lossless) << utf8;
        EXPECT_EQ(str(w), utf16) << utf8;
        if (!lossless) continue;
        KXString back;
        EXPECT_TRUE(back.Assign(w.c_str(), KX_CSET_DEFAULT, -1));
        EXPECT_STREQ(back.c_str(), utf8);
    }
    KXString narrow;
    EXPECT_FALSE(narrow.Assign(u"\xD800x", KX_CSET_DEFAULT));  // lone surrogate
    EXPECT_STREQ(narrow.c_str(), "\xEF\xBF\xBDx");
    EXPECT_FALSE(narrow.Assign(u"\u20AC", KX_CSET_BYTE));
    EXPECT_STREQ(narrow.c_str(), "?");
}
#else
// Character set 0 is the ANSI code page there; the cases are those of code page 1252.
TEST(KXWString, ConvertsTheAnsiCodePageBothWaysWithoutBestFit) {
    if (GetACP() != 1252) GTEST_SKIP() << "the ANSI code page is " << GetACP() << ", not 1252";
    const std::pair<const char*, std::u16string> cases[] = {
        {"C:\\data\\plain.fix", u"C:\\data\\plain.fix"},
        {"caf\xE9", u"caf\u00E9"},
        {"\x80", u"\u20AC"},  // not Latin-1
        {"", u""},
    };
    for (const auto& [ansi, utf16] : cases) {
        KXWString w;
        EXPECT_TRUE(w.Assign(ansi, KX_CSET_DEFAULT, -1)) << ansi;
        EXPECT_EQ(str(w), utf16) << ansi;
        KXString back;
        EXPECT_TRUE(back.Assign(w.c_str(), KX_CSET_DEFAULT, -1));
        EXPECT_STREQ(back.c_str(), ansi);
    }
    // A best fit would turn these into other, existing names ("A", "a").
    for (const char16_t* lossy : {u"\u0100", u"\uFF41", u"\xD800", u"\U0001F600"}) {
        KXString narrow;
        EXPECT_FALSE(narrow.Assign(lossy, KX_CSET_DEFAULT));
        EXPECT_EQ(std::string(narrow.c_str()).find_first_not_of('?'), std::string::npos)
            << narrow.c_str();
    }
}
#endif

TEST(KXGlob, LogMessageFormatsIntegersAndUtf16TextsToTheSink) {
    std::vector<std::string> lines;
    KXGlob::SetLogSink(
        [](int32_t level, BATCHERR code, const char* line, void* context) {
            static_cast<std::vector<std::string>*>(context)->push_back(
                std::to_string(level) + "/" + std::to_string(code) + " " + line);
        },
        &lines);
    KXGlob::LogMessage(8, BATCH_CHECK_FAILED, lgettext("At line %d, column %d of file %s: %s"),
                       int32_t{3}, int32_t{-1}, u"/s\u00E9.xml", u"bad %d");
    KXGlob::LogMessage(2, BATCH_OK, "100%% %s %q", nullptr);
    KXGlob::SetLogSink(nullptr, nullptr);
    // Texts are logged in character set 0, as paths are written.
#if defined(_WIN32)
    KXString path;
    path.Assign(u"/s\u00E9.xml", KX_CSET_DEFAULT);
#else
    const KXString path("/s\xC3\xA9.xml");
#endif
    EXPECT_EQ(lines, (std::vector<std::string>{std::string("8/4 At line 3, column -1 of file ") +
                                                   path.c_str() + ": bad %d",
                                               "2/0 100% (null) q"}));
}

TEST(KXGlob, TruthValuesAreExactlyTheTrueWords) {
    const char* words = "True.False.true.false";
    for (const char* text : {"True", "true"}) EXPECT_TRUE(KXGlob::StrToBool(text, words));
    for (const char* text : {"False", "false", "TRUE", "1", "", "True.", "Tru"})
        EXPECT_FALSE(KXGlob::StrToBool(text, words)) << text;
    EXPECT_FALSE(KXGlob::StrToBool(nullptr, words));
    EXPECT_TRUE(KXGlob::StrToBool(KXGlob::BoolToStr(true), words));
    EXPECT_FALSE(KXGlob::StrToBool(KXGlob::BoolToStr(false), words));
}

}  // namespace
