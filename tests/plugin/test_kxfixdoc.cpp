#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "fixprsr/kxfixdoc.h"
#include "testutil.h"

namespace {

using testutil::fix;
using testutil::TempFile;
using testutil::utf16;

struct DetectCase {
    const char* name;
    std::string bytes;
    KX_CSET cset;
    bool isFix;
    char16_t next;  // character the reader stands on afterwards
};

TEST(KXFIXDoc, RecognisesFixFilesAfterMarksBlanksAndComments) {
    const std::string message = fix("8=FIX.4.4|9=5|35=0|10=000|");
    const DetectCase cases[] = {
        {"plain", message, KX_CSET_BYTE, true, u'8'},
        {"blank and comment lines", "\r\n  \t\n; a comment\n;another\r\n\n" + message, KX_CSET_BYTE,
         true, u'8'},
        {"comment after blanks on one line", "   ; note\n" + message, KX_CSET_BYTE, true, u'8'},
        {"utf-16 lsb with mark", "\xFF\xFE" + utf16("\r\n" + message, false), KX_CSET_UTF16, true,
         u'8'},
        {"utf-16 msb with mark", "\xFE\xFF" + utf16(";c\n" + message, true), KX_CSET_UTF16, true,
         u'8'},
        {"utf-16 without mark", utf16(message, false), KX_CSET_UTF16, true, u'8'},
        {"starts with 9", fix("9=5|8=FIX.4.4|"), KX_CSET_BYTE, false, u'9'},
        {"empty", "", KX_CSET_BYTE, false, KXFileProxy::kEndOfData},
        {"only comments", "; one\n\n; two\n", KX_CSET_BYTE, false, KXFileProxy::kEndOfData},
        {"comment without line feed", "; the end", KX_CSET_BYTE, false, KXFileProxy::kEndOfData},
        {"single 8", "8", KX_CSET_BYTE, true, u'8'},
    };
    for (const auto& c : cases) {
        TempFile file(c.bytes);
        KXFIXDoc doc;
        ASSERT_EQ(doc.openfile(file.c_str(), "rbu", c.cset), 0) << c.name;
        EXPECT_EQ(doc.isFIXFile(), c.isFix) << c.name;
        EXPECT_EQ(doc.wgetch(), c.next) << c.name;
    }
}

TEST(KXFIXDoc, ByteOrderOfOneFileDoesNotLeakIntoTheNext) {
    TempFile msb("\xFE\xFF" + utf16("8=", true));
    TempFile lsb(utf16("8=", false));
    KXFIXDoc doc;
    ASSERT_EQ(doc.openfile(msb.c_str(), "rbu", KX_CSET_UTF16), 0);
    EXPECT_TRUE(doc.isFIXFile());
    doc.close(false);
    ASSERT_EQ(doc.openfile(lsb.c_str(), "rbu", KX_CSET_UTF16), 0);
    EXPECT_TRUE(doc.isFIXFile());
}

class ReaderTest : public ::testing::Test {
  protected:
    void open(const std::string& bytes) {
        file_ = std::make_unique<TempFile>(bytes);
        ASSERT_EQ(doc_.openfile(file_->c_str(), "rbu", KX_CSET_BYTE), 0);
    }
    std::u16string peek() {
        KXWString tag(u"stale");
        const int32_t n = doc_.peekTag(tag);
        EXPECT_EQ(n, tag.length());
        return tag.c_str();
    }
    std::u16string value() {
        KXWString v(u"stale");
        const int32_t n = doc_.readValue(v);
        EXPECT_EQ(n, v.length());
        return v.c_str();
    }

    std::unique_ptr<TempFile> file_;
    KXFIXDoc doc_;
};

TEST_F(ReaderTest, PeekLeavesThePositionAndReadConsumesTheField) {
    open(fix("35=D|58=a=b|abc|35=D|") + "\r\n8=");
    EXPECT_EQ(peek(), u"35");
    EXPECT_EQ(peek(), u"35");
    EXPECT_EQ(value(), u"D");
    EXPECT_EQ(value(), u"ab");  // every "=" is dropped
    EXPECT_EQ(peek(),
              u"abc\x01"
              u"35");          // separators belong to the tag
    EXPECT_EQ(value(), u"D");  // a separator before any "=" does not end the field
    EXPECT_EQ(peek(), u"\r\n8");
    EXPECT_EQ(value(), u"");
    EXPECT_EQ(peek(), u"");
    EXPECT_EQ(value(), u"");
}

TEST_F(ReaderTest, FieldSumCoversEveryConsumedCharacter) {
    open(fix("8=FIX.4.4|x=|"));
    value();
    int64_t expected = 0;
    for (const char c : fix("8=FIX.4.4|")) expected += static_cast<unsigned char>(c);
    EXPECT_EQ(doc_.lastFieldSum(), expected);
    value();
    EXPECT_EQ(doc_.lastFieldSum(), 'x' + '=' + 1);
    value();
    EXPECT_EQ(doc_.lastFieldSum(), 0);
}

TEST_F(ReaderTest, LongTagIsBoundedAndKeepsThePosition) {
    open(std::string(100000, '7'));
    const std::u16string tag = peek();
    EXPECT_EQ(static_cast<int32_t>(tag.size()), KXFIXDoc::kMaxTagLength);
    EXPECT_EQ(doc_.tell(), 0);
    EXPECT_EQ(value(), u"");
    EXPECT_EQ(doc_.lastFieldSum(), 100000 * int64_t{'7'});
}

TEST_F(ReaderTest, FieldStartingWithEqualsHasAnEmptyTag) {
    open(fix("=5|"));
    EXPECT_EQ(peek(), u"");
    EXPECT_EQ(doc_.tell(), 0);
}

}  // namespace
