#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <string>

#include "kxutil/kxfileproxy.h"
#include "kxutil/kxwstring.h"
#include "testutil.h"

namespace {

using testutil::TempFile;

std::u16string readAll(KXFileProxy& proxy) {
    std::u16string out;
    for (char16_t c = proxy.wgetch(); c != KXFileProxy::kEndOfData; c = proxy.wgetch()) out += c;
    return out;
}

TEST(KXFileProxy, DecodesEachCharacterSetAcrossBufferRefills) {
    const struct {
        std::string bytes;
        KX_CSET cset;
        bool msbFirst;
        std::u16string expected;
    } cases[] = {
        {std::string("\0008\0=\x20\xAC", 6), KX_CSET_UTF16, true, u"8=\u20AC"},
        {std::string("8\0=\0\xAC\x20", 6), KX_CSET_UTF16, false, u"8=\u20AC"},
        {std::string("A\0B", 3), KX_CSET_UTF16, false, u"A"},  // a lone last byte ends the data
        {"0123456789\xE9", KX_CSET_BYTE, false, u"0123456789\u00E9"},
    };
    KXFileProxy proxy;  // reused: opening resets the byte order to LSB and the unit size
    for (const auto& c : cases) {
        TempFile file(c.bytes);
        ASSERT_EQ(proxy.openfile(file.c_str(), "rbu", c.cset), 0);
        proxy.setBufferSize(3);  // units split by the end of the buffer
        if (c.msbFirst) proxy.setMSBFirst(true);
        EXPECT_EQ(readAll(proxy), c.expected) << c.bytes.size();
        const int64_t unit = c.cset == KX_CSET_UTF16 ? 2 : 1;
        EXPECT_EQ(proxy.tell(), unit * static_cast<int64_t>(c.expected.size()));
        EXPECT_EQ(proxy.wgetch(), KXFileProxy::kEndOfData);  // stays at the end
    }
}

TEST(KXFileProxy, SeeksInsideOrOutsideTheBufferCopiesKeepTheFileAndBadOpensAreRefused) {
    const std::string text = "0123456789abcdefghij";
    TempFile file(text);
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    proxy.setBufferSize(4);
    EXPECT_EQ(proxy.wgetch(), u'0');
    proxy.wputBack(proxy.wgetch());
    EXPECT_EQ(proxy.tell(), 1);  // a character given back counts as unread
    EXPECT_EQ(proxy.wgetch(), u'1');
    {
        KXFileProxy copy(proxy);
        EXPECT_EQ(copy.wgetch(), u'2');
        KXFileProxy assigned;
        assigned = copy;
        assigned = assigned;
        EXPECT_EQ(readAll(assigned), u"3456789abcdefghij");
        copy.close(false);
    }
    EXPECT_TRUE(proxy.isOpen());
    EXPECT_EQ(proxy.wgetch(), u'2');
    // Past 4 GiB: a position cut to 32 bits would read "1" again.
    const int64_t beyond32Bits = (int64_t{1} << 32) + 1;
    for (const int64_t position : {int64_t{15}, int64_t{3}, int64_t{4}, int64_t{19}, int64_t{0},
                                   int64_t{20}, beyond32Bits, int64_t{8}}) {
        ASSERT_EQ(proxy.seek(position, 0), 0);
        EXPECT_EQ(proxy.tell(), position);
        EXPECT_EQ(proxy.wgetch(), position < 20 ? text[position] : KXFileProxy::kEndOfData);
    }
    EXPECT_EQ(proxy.seek(-1, 0), -1);
    EXPECT_EQ(proxy.seek(0, 1), -1);
    // Emptying the file proves that a seek inside the buffer reads from the buffer.
    ASSERT_EQ(truncate(file.c_str(), 0), 0);
    ASSERT_EQ(proxy.seek(8, 0), 0);
    proxy.wputBack(proxy.wgetch());
    char buffer[8] = {};
    EXPECT_EQ(proxy.read(buffer, 8), 4);  // the character given back comes first
    EXPECT_STREQ(buffer, "89ab");
    EXPECT_EQ(proxy.getch(), -1);
    EXPECT_EQ(proxy.openfile("/nonexistent/kxvfix/file", "rb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile(testutil::temporaryDirectory().c_str(), "rb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile(file.c_str(), "wb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_DEFAULT), -1);
    EXPECT_FALSE(proxy.isOpen());
    EXPECT_EQ(proxy.wgetch(), KXFileProxy::kEndOfData);
    EXPECT_LT(proxy.read(buffer, 4), 0);
    EXPECT_EQ(proxy.close(false), -1);
}

#if defined(_WIN32)
TEST(KXFileProxy, OpensWindowsPathsInEitherSpellingAndWideNamesWithoutLoss) {
    TempFile file("8=FIX");
    std::string forward = file.path();
    std::replace(forward.begin(), forward.end(), '\\', '/');
    std::string lowerDrive = file.path();
    lowerDrive[0] = static_cast<char>(std::tolower(static_cast<unsigned char>(lowerDrive[0])));
    ASSERT_EQ(file.path().substr(1, 2), ":\\");
    KXFileProxy proxy;
    for (const std::string& path : {file.path(), forward, lowerDrive}) {
        ASSERT_EQ(proxy.openfile(path.c_str(), "rb", KX_CSET_BYTE), 0) << path;
        EXPECT_EQ(readAll(proxy), u"8=FIX") << path;
    }
    // Beyond the ANSI code page: the UTF-16 name reaches the system unconverted.
    KXWString wide;
    wide.Assign(testutil::temporaryDirectory().c_str(), KX_CSET_DEFAULT);
    wide += u"kxvfix-\u03C9\u4E2D.dat";
    const auto* name = reinterpret_cast<const wchar_t*>(wide.c_str());
    FILE* out = _wfopen(name, L"wb");
    ASSERT_NE(out, nullptr);
    std::fputs("8=", out);
    std::fclose(out);
    EXPECT_EQ(proxy.openfile(wide.c_str(), "rb", KX_CSET_BYTE), 0);
    EXPECT_EQ(readAll(proxy), u"8=");
    proxy.close(false);
    _wremove(name);
}
#endif

}  // namespace
