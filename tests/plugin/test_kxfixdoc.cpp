#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "fixprsr/kxfixdoc.h"
#include "testutil.h"

namespace {

using testutil::fix;
using testutil::TempFile;
using testutil::utf16;

TEST(KXFIXDoc, RecognisesFixFilesAfterMarksBlanksAndComments) {
    const std::string message = fix("8=FIX.4.4|9=5|35=0|10=000|");
    const struct {
        std::string bytes;
        KX_CSET cset;
        bool isFix;
        char16_t next;  // where the reader stands afterwards
    } cases[] = {
        {"\r\n   ; note\n;another\r\n\n" + message, KX_CSET_BYTE, true, u'8'},
        {"\xFE\xFF" + utf16(";c\n" + message, true), KX_CSET_UTF16, true, u'8'},
        {utf16(message, false), KX_CSET_UTF16, true, u'8'},  // LSB again after an MSB file
        {fix("9=5|8=FIX.4.4|"), KX_CSET_BYTE, false, u'9'},
        {"", KX_CSET_BYTE, false, KXFileProxy::kEndOfData},
        {"; one\n\n; the end", KX_CSET_BYTE, false, KXFileProxy::kEndOfData},
        {"8", KX_CSET_BYTE, true, u'8'},
    };
    KXFIXDoc doc;
    for (const auto& c : cases) {
        TempFile file(c.bytes);
        ASSERT_EQ(doc.openfile(file.c_str(), "rbu", c.cset), 0) << c.bytes;
        EXPECT_EQ(doc.isFIXFile(), c.isFix) << c.bytes;
        EXPECT_EQ(doc.wgetch(), c.next) << c.bytes;
    }
}

// Peeks, checking that the position stays put and that the count is the tag's length.
std::u16string peek(KXFIXDoc& doc) {
    KXWString tag(u"stale");
    const int64_t at = doc.tell();
    const int32_t n = doc.peekTag(tag);
    EXPECT_EQ(n, tag.length());
    EXPECT_EQ(doc.tell(), at);
    return tag.c_str();
}

// Reads a value, checking the count and that the sum covers every character consumed.
std::u16string value(KXFIXDoc& doc, const std::string& consumed) {
    KXWString v(u"stale");
    const int32_t n = doc.readValue(v);
    EXPECT_EQ(n, v.length());
    int64_t sum = 0;
    for (const char c : consumed) sum += static_cast<unsigned char>(c);
    EXPECT_EQ(doc.lastFieldSum(), sum);
    return v.c_str();
}

TEST(KXFIXDoc, PeekLeavesThePositionAndReadConsumesTheField) {
    TempFile file(fix("35=D|58=a=b|abc|35=D|x|9=1|=5|") + "\r\n8=");
    KXFIXDoc doc;
    ASSERT_EQ(doc.openfile(file.c_str(), "rbu", KX_CSET_BYTE), 0);
    EXPECT_EQ(peek(doc), u"35");
    EXPECT_EQ(peek(doc), u"35");
    EXPECT_EQ(value(doc, fix("35=D|")), u"D");
    EXPECT_EQ(value(doc, fix("58=a=b|")), u"ab");   // every "=" is dropped
    EXPECT_EQ(peek(doc), u"abc\00135");             // separators belong to the tag
    EXPECT_EQ(value(doc, fix("abc|35=D|")), u"D");  // and end no field before its "="
    EXPECT_EQ(value(doc, fix("x|9=1|")), u"1");     // not even when it was not peeked at
    EXPECT_EQ(peek(doc), u"");                      // a field starting with "="
    EXPECT_EQ(value(doc, fix("=5|")), u"5");
    EXPECT_EQ(peek(doc), u"\r\n8");
    EXPECT_EQ(value(doc, "\r\n8="), u"");
    EXPECT_EQ(peek(doc), u"");
    EXPECT_EQ(value(doc, ""), u"");
    const std::string sevens(100000, '7');
    TempFile noEquals(sevens);
    ASSERT_EQ(doc.openfile(noEquals.c_str(), "rbu", KX_CSET_BYTE), 0);
    EXPECT_EQ(peek(doc), std::u16string(KXFIXDoc::kMaxTagLength, u'7'));  // bounded
    EXPECT_EQ(value(doc, sevens), u"");
    // Opening a file forgets where the last peek was.
    ASSERT_EQ(doc.openfile(file.c_str(), "rbu", KX_CSET_BYTE), 0);
    EXPECT_EQ(peek(doc), u"35");
    TempFile other(fix("9999=X|"));
    ASSERT_EQ(doc.openfile(other.c_str(), "rbu", KX_CSET_BYTE), 0);
    EXPECT_EQ(value(doc, fix("9999=X|")), u"X");
}

// Long tags and values, "=" inside values, at every way the fields may fall across
// buffers: each field reads as tag, value without its "=", and the sum of all it took.
TEST(KXFIXDoc, FieldsReadTheSameWhereverBuffersEnd) {
    const std::string longValue = std::string(1500, 'v') + "=" + std::string(1700, 'w');
    const std::string fields[][2] = {
        {"8", "FIX.4.4"},
        {std::string(KXFIXDoc::kMaxTagLength - 1, '1'), "x"},
        {"58", longValue},
        {"58", std::string(1023, 'a')},
        {"58", std::string(1024, 'b') + "=="},
        {"10", "0"},
    };
    std::string text;
    for (const auto& [tag, content] : fields) text += tag + "=" + content + "\x01";
    for (const bool wide : {false, true}) {
        TempFile file(wide ? utf16(text, false) : text);
        for (const int32_t bufferSize : {16, 1000, 16384}) {
            KXFIXDoc doc;
            ASSERT_EQ(doc.openfile(file.c_str(), "rbu", wide ? KX_CSET_UTF16 : KX_CSET_BYTE), 0);
            doc.setBufferSize(bufferSize);
            for (const auto& [tag, content] : fields) {
                std::string kept = content;
                kept.erase(std::remove(kept.begin(), kept.end(), '='), kept.end());
                EXPECT_EQ(peek(doc), std::u16string(tag.begin(), tag.end()));
                EXPECT_EQ(value(doc, tag + "=" + content + "\x01"),
                          std::u16string(kept.begin(), kept.end()))
                    << tag << " in buffers of " << bufferSize << (wide ? " wide" : "");
            }
            EXPECT_EQ(peek(doc), u"");
        }
    }
}

}  // namespace
