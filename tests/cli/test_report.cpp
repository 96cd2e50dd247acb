#include <gtest/gtest.h>

#include <sstream>

#include "report.h"

namespace {

TEST(Report, EscapesControlCharacters) {
    EXPECT_EQ(escapeControls("tag=\r\n8\x01\t\x7f\xc3\xa9"), "tag=\\r\\n8\\x01\\t\\x7f\xc3\xa9");
    EXPECT_EQ(jsonString("a\"b\\c\n\x01\xc3\xa9"), "\"a\\\"b\\\\c\\n\\u0001\xc3\xa9\"");
}

TEST(Report, TextLinesCarryTheErrorsOwnFileAndANoteForLineBreaks) {
    FileResult file{"src.fix",
                    4,
                    {{3, "src.fix", "Failed to match tag=\r\n8 in schema file"},
                     {2, "?", "Field 11 is missing"}}};
    std::ostringstream out;
    printFile(out, OutputFormat::Text, file);
    EXPECT_EQ(out.str(),
              "src.fix: error: Failed to match tag=\\r\\n8 in schema file\n"
              "src.fix: note: messages must follow one another directly: a line break between "
              "messages, or after the last one, is read as the start of the next tag\n"
              "?: field error: Field 11 is missing\n");
}

TEST(Report, SummaryInBothFormats) {
    std::ostringstream text;
    std::ostringstream json;
    printSummary(text, OutputFormat::Text, {1, 1, 0});
    printSummary(json, OutputFormat::Json, {3, 0, 2});
    EXPECT_EQ(text.str(), "kxvalidate: 1 file, 1 finding, 0 not validated\n");
    EXPECT_EQ(json.str(), "{\"summary\":{\"files\":3,\"findings\":0,\"not_validated\":2}}\n");
}

}  // namespace
