#include <gtest/gtest.h>

#include <map>
#include <string>

#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

namespace {

std::u16string str(const KXWString& s) {
    return s.c_str();
}

TEST(KXWString, EditingOperations) {
    KXWString s(u"G.453");
    EXPECT_EQ(s.find(u'.'), 1);
    EXPECT_EQ(s.find(u'x'), -1);
    EXPECT_EQ(s.find(u'3', 3), 4);
    EXPECT_EQ(s.find(u'4', 3), -1);
    EXPECT_EQ(s.find(u"53"), 3);
    EXPECT_EQ(str(s.substr(0, 2)), u"G.");
    EXPECT_EQ(str(s.substr(0, 99)), u"G.453");
    s.Remove(2, 0);
    EXPECT_EQ(str(s), u"453");
    s.Remove(5, 1);
    EXPECT_EQ(str(s), u"4");
    s.Remove(1, 7);  // outside: nothing happens
    EXPECT_EQ(str(s), u"4");
}

TEST(KXWString, AppendingItsOwnTextSurvivesGrowth) {
    KXWString s(u"abc");
    for (int i = 0; i < 5; ++i) s += s.c_str();
    EXPECT_EQ(s.length(), 3 * 32);
    EXPECT_EQ(str(s.substr(0, 6)), u"abcabc");
    s = s.c_str() + 93;
    EXPECT_EQ(str(s), u"abc");
}

TEST(KXWString, ClearKeepsStorageAndCopiesAreIndependent) {
    KXWString s;
    for (char16_t c = u'a'; c <= u'z'; ++c) s += c;
    const char16_t* storage = s.c_str();
    s.clear();
    EXPECT_EQ(s.length(), 0);
    s += u'x';
    EXPECT_EQ(s.c_str(), storage);
    KXWString copy(s);
    copy += u'y';
    EXPECT_EQ(str(s), u"x");
    EXPECT_EQ(str(copy), u"xy");
}

TEST(KXWString, ComparisonsOrderMapKeysExactly) {
    std::map<KXWString, int> map{{KXWString(u"35"), 1}, {KXWString(u"8"), 2}};
    EXPECT_EQ(map.count(KXWString(u"035")), 0u);
    EXPECT_EQ(map.count(KXWString(u"35")), 1u);
    EXPECT_TRUE(KXWString(u"10") < KXWString(u"9"));
    EXPECT_TRUE(KXWString(u"") < KXWString(u"0"));
    EXPECT_FALSE(KXWString(u"ab") != u"ab");
    EXPECT_TRUE(KXWString(u"ab") != u"abc");
    EXPECT_TRUE(KXWString(u"a") == KXWString(u"a"));
}

struct Conversion {
    const char* utf8;
    std::u16string utf16;
    bool lossless;
};

TEST(KXWString, ConvertsUtf8BothWays) {
    const Conversion cases[] = {
        {"plain/path.fix", u"plain/path.fix", true},
        {"caf\xC3\xA9", u"caf\u00E9", true},
        {"\xE2\x82\xAC", u"\u20AC", true},
        {"\xF0\x9F\x98\x80", u"\U0001F600", true},
        {"bad\xFF", u"bad\uFFFD", false},
        {"cut\xE2\x82", u"cut\uFFFD", false},
        {"\xC0\xAF", u"\uFFFD", false},  // overlong
    };
    for (const auto& c : cases) {
        KXWString w;
        EXPECT_EQ(w.Assign(c.utf8, KX_CSET_DEFAULT, -1), c.lossless) << c.utf8;
        EXPECT_EQ(str(w), c.utf16) << c.utf8;
        if (!c.lossless) continue;
        KXString back;
        EXPECT_TRUE(back.Assign(w.c_str(), KX_CSET_DEFAULT, -1));
        EXPECT_STREQ(back.c_str(), c.utf8);
    }
}

TEST(KXWString, ByteCharacterSetMapsBytesToUnits) {
    KXWString w;
    EXPECT_TRUE(w.Assign("\xE9z", KX_CSET_BYTE, 2));
    EXPECT_EQ(str(w), u"\u00E9z");
    KXString narrow;
    EXPECT_FALSE(narrow.Assign(u"\u20AC", KX_CSET_BYTE));
    EXPECT_STREQ(narrow.c_str(), "?");
}

TEST(KXString, AppendAndAssign) {
    KXString s("ab");
    s += "cd";
    s += KXString("ef");
    EXPECT_STREQ(s.c_str(), "abcdef");
    EXPECT_EQ(s.length(), 6);
    s += s.c_str();
    EXPECT_STREQ(s.c_str(), "abcdefabcdef");
    s = nullptr;
    EXPECT_STREQ(s.c_str(), "");
}

}  // namespace
