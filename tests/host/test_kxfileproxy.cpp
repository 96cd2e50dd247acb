#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>

#include "kxutil/kxfileproxy.h"
#include "testutil.h"

namespace {

using testutil::TempFile;

std::u16string readAll(KXFileProxy& proxy) {
    std::u16string out;
    for (char16_t c = proxy.wgetch(); c != KXFileProxy::kEndOfData; c = proxy.wgetch()) out += c;
    return out;
}

TEST(KXFileProxy, ReadsBytesAcrossManyRefills) {
    std::string bytes;
    for (int i = 0; i < 1000; ++i) bytes += static_cast<char>('a' + i % 26);
    TempFile file(bytes + "\xE9");
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    proxy.setBufferSize(7);
    const std::u16string text = readAll(proxy);
    ASSERT_EQ(text.size(), 1001u);
    EXPECT_EQ(text[26], u'a');
    EXPECT_EQ(text[1000], u'\u00E9');
    EXPECT_EQ(proxy.tell(), 1001);
    EXPECT_EQ(proxy.wgetch(), KXFileProxy::kEndOfData);  // stays at the end
}

struct Utf16Case {
    const char* name;
    std::string bytes;
    bool msbFirst;
    std::u16string expected;
};

TEST(KXFileProxy, DecodesUtf16InEitherByteOrder) {
    const Utf16Case cases[] = {
        {"lsb", std::string("8\0=\0\xAC\x20", 6), false, u"8=\u20AC"},
        {"msb",
         std::string("\0"
                     "8\0=\x20\xAC",
                     6),
         true, u"8=\u20AC"},
        {"odd last byte is not a character", std::string("A\0B", 3), false, u"A"},
    };
    for (const auto& c : cases) {
        TempFile file(c.bytes);
        KXFileProxy proxy;
        ASSERT_EQ(proxy.openfile(file.c_str(), "rbu", KX_CSET_UTF16), 0);
        proxy.setBufferSize(3);  // units split by the end of the buffer
        proxy.setMSBFirst(c.msbFirst);
        EXPECT_EQ(readAll(proxy), c.expected) << c.name;
    }
}

TEST(KXFileProxy, GetchReportsTheStoredUnitAndEndOfData) {
    TempFile file(std::string("\xFE\xFF", 2));
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rbu", KX_CSET_UTF16), 0);
    EXPECT_EQ(proxy.getch(), 0xFFFE);
    EXPECT_EQ(proxy.getch(), -1);
}

TEST(KXFileProxy, PutBackCountsAsUnreadAndTellSeekRoundTrip) {
    TempFile file("0123456789abcdefghij");
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    proxy.setBufferSize(4);
    EXPECT_EQ(proxy.wgetch(), u'0');
    const char16_t c = proxy.wgetch();
    proxy.wputBack(c);
    EXPECT_EQ(proxy.tell(), 1);
    EXPECT_EQ(proxy.wgetch(), u'1');
    EXPECT_EQ(proxy.tell(), 2);
    for (const int64_t position : {15, 3, 4, 19, 0, 20}) {
        ASSERT_EQ(proxy.seek(position, 0), 0);
        EXPECT_EQ(proxy.tell(), position);
        const char16_t expected = position < 20
                                      ? static_cast<char16_t>("0123456789abcdefghij"[position])
                                      : KXFileProxy::kEndOfData;
        EXPECT_EQ(proxy.wgetch(), expected) << position;
    }
    EXPECT_EQ(proxy.seek(-1, 0), -1);
    EXPECT_EQ(proxy.seek(0, 1), -1);
}

TEST(KXFileProxy, ReadsAndSeeksInsideTheBufferWithoutTheFile) {
    TempFile file(
        "8=FIX.4.4\x01"
        "9=5\x01");
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    EXPECT_EQ(proxy.wgetch(), u'8');
    // Emptying the file proves the rest comes from the buffer.
    ASSERT_EQ(truncate(file.c_str(), 0), 0);
    const int64_t mark = proxy.tell();
    EXPECT_EQ(proxy.wgetch(), u'=');
    EXPECT_EQ(proxy.seek(mark, 0), 0);
    EXPECT_EQ(readAll(proxy),
              u"=FIX.4.4\x01"
              u"9=5\x01");
}

TEST(KXFileProxy, CopiesNeverShareOrCloseTheOriginalsFile) {
    TempFile file("abcdef");
    KXFileProxy original;
    ASSERT_EQ(original.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    original.setBufferSize(2);
    EXPECT_EQ(original.wgetch(), u'a');
    {
        KXFileProxy copy(original);
        EXPECT_EQ(copy.wgetch(), u'b');
        EXPECT_EQ(copy.wgetch(), u'c');
        EXPECT_EQ(copy.wgetch(), u'd');
        KXFileProxy assigned;
        assigned = copy;
        assigned = assigned;
        EXPECT_EQ(assigned.wgetch(), u'e');
        copy.close(false);
    }
    EXPECT_TRUE(original.isOpen());
    EXPECT_EQ(readAll(original), u"bcdef");
}

TEST(KXFileProxy, RefusesWhatItCannotRead) {
    TempFile file("x");
    KXFileProxy proxy;
    EXPECT_EQ(proxy.openfile("/nonexistent/kxvfix/file", "rb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile("/tmp", "rb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile(file.c_str(), "wb", KX_CSET_BYTE), -1);
    EXPECT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_DEFAULT), -1);
    EXPECT_FALSE(proxy.isOpen());
    EXPECT_EQ(proxy.wgetch(), KXFileProxy::kEndOfData);
    char buffer[4];
    EXPECT_LT(proxy.read(buffer, 4), 0);
    EXPECT_EQ(proxy.close(false), -1);
}

TEST(KXFileProxy, ByteReadsDeliverAPutBackFirst) {
    TempFile file("hello");
    KXFileProxy proxy;
    ASSERT_EQ(proxy.openfile(file.c_str(), "rb", KX_CSET_BYTE), 0);
    proxy.wputBack(proxy.wgetch());
    char buffer[8] = {};
    EXPECT_EQ(proxy.read(buffer, 8), 5);
    EXPECT_STREQ(buffer, "hello");
    EXPECT_EQ(proxy.read(buffer, 8), 0);
}

}  // namespace
