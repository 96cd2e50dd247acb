#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "checkharness.h"

namespace {

using checks::checkSum;
using checks::Finding;
using checks::kCheckSumLength;
using checks::kCheckSumValue;
using checks::kOther;
using checks::mismatch;
using checks::missing;
using checks::Schema;
using checks::Session;
using checks::unknownTag;
using testutil::fix;

// Top-level 8 (FIX.4.2), 9, 35 (D|F), 11 and 10, all required; the optional group 78 with
// the members 79 (required) and 80 (optional).
struct WalkSchema {
    WalkSchema() {
        schema.field("8", Required, "FIX.4.2");
        schema.field("9", Required);
        schema.field("35", Required, "D|F");
        schema.field("11", Required);
        schema.field("10", Required);
        FIXField* group = schema.group("78", Optional);
        schema.member(group, "79", Required);
        schema.member(group, "80", Optional);
    }
    Schema schema;
};

TEST(ParseFIXFile, WorkedWalkAndItsVariants) {
    struct WalkCase {
        const char* name;
        std::string body;      // up to the CheckSum field
        std::string checkSum;  // empty: the correct one
        std::vector<Finding> findings;
    };
    const std::string start = fix("8=FIX.4.2|9=40|35=D|11=ABC|78=2|79=X|80=Y|");
    const WalkCase cases[] = {
        {"as written", start + fix("79=Z|"), "", {}},
        {"second repetition without 79", start + fix("80=W|"), "", {missing("79")}},
        {"wrong CheckSum", start + fix("79=Z|"), "999", {kCheckSumValue}},
        {"MsgType outside its pattern", fix("8=FIX.4.2|9=40|35=G|11=ABC|"), "", {mismatch("35")}},
    };
    for (const auto& c : cases) {
        WalkSchema w;
        const std::string sum = c.checkSum.empty() ? checkSum(c.body) : c.checkSum;
        Session s(c.body + fix("10=" + sum + "|"));
        ASSERT_TRUE(s.isFix());
        const auto walk = s.parseFile(w.schema.map);
        EXPECT_EQ(walk.result, BATCH_OK) << c.name;
        EXPECT_EQ(walk.findings, c.findings) << c.name;
    }
}

TEST(ParseFIXFile, StructuralErrorsStopTheWalkBeforeTheRequiredCheck) {
    struct StopCase {
        const char* name;
        std::string source;
        Finding finding;
        const char* undefinedTag = "";  // taken out of the schema
    };
    const std::string message = fix("8=FIX.4.2|9=5|35=D|11=A|");
    const std::string sealed = message + fix("10=" + checkSum(message) + "|");
    const StopCase cases[] = {
        {"BeginString not first", fix("9=5|8=FIX.4.2|"), {kOther, "Failed to find BeginString"}},
        {"BodyLength not second",
         fix("8=FIX.4.2|35=D|9=5|"),
         {kOther, "Failed to find BodyLength"}},
        {"MsgType not third", fix("8=FIX.4.2|9=5|11=A|35=D|"), {kOther, "Failed to find MsgType"}},
        {"unknown tag", fix("8=FIX.4.2|9=5|35=D|99=x|11=A|"), unknownTag("99")},
        {"header tag the schema lacks", fix("8=FIX.4.2|9=5|35=D|"), unknownTag("9"), "9"},
        {"group member at the top level", fix("8=FIX.4.2|9=5|35=D|79=X|"), unknownTag("79")},
        {"line break between messages", sealed + "\r\n" + sealed, unknownTag("\r\n8")},
        {"line break after the last message", sealed + "\r\n", unknownTag("\r\n")},
        {"tag 035 is not 35", fix("8=FIX.4.2|9=5|035=D|"), {kOther, "Failed to find MsgType"}},
    };
    for (const auto& c : cases) {
        WalkSchema w;
        w.schema.map.erase(checks::wide(c.undefinedTag));
        Session s(c.source);
        const auto walk = s.parseFile(w.schema.map);
        EXPECT_EQ(walk.result, BATCH_CHECK_FAILED) << c.name;
        // Only the stop: the missing 10 (and 11) is not reported.
        EXPECT_EQ(walk.findings, std::vector<Finding>{c.finding}) << c.name;
    }
}

TEST(ParseFIXFile, FieldStartingWithEqualsEndsTheWalkLikeTheEndOfInput) {
    WalkSchema w;
    Session s(fix("8=FIX.4.2|9=5|35=D|=x|11=A|10=000|"));
    const auto walk = s.parseFile(w.schema.map);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, (std::vector<Finding>{missing("10"), missing("11")}));
}

TEST(ParseFIXFile, OnlyTheFilesFirstThreeFieldsArePositionChecked) {
    WalkSchema w;
    // The second message starts with 11 and has no 9; its 8 is checked by pattern only.
    const std::string first = fix("8=FIX.4.2|9=5|35=D|11=A|");
    const std::string second = fix("11=B|35=F|8=FIX.4.4|");
    Session s(first + fix("10=" + checkSum(first) + "|") + second +
              fix("10=" + checkSum(fix("8=FIX.4.4|")) + "|"));
    const auto walk = s.parseFile(w.schema.map);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, std::vector<Finding>{mismatch("8")});
}

TEST(ParseFIXFile, RequiredCheckLooksAtTheWholeFileInKeyOrder) {
    WalkSchema w;
    w.schema.group("453", Required);
    w.schema.field("21", Required);
    w.schema.field("54", Required);
    // 54 occurs in the second message only; 78 is optional, 453 and 21 never occur.
    const std::string first = fix("8=FIX.4.2|9=5|35=D|");
    const std::string second = fix("8=FIX.4.2|9=5|35=D|54=1|");
    Session s(first + second + fix("10=" + checkSum(second) + "|"));
    const auto walk = s.parseFile(w.schema.map);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings,
              (std::vector<Finding>{missing("11"), missing("21"), missing("G.453")}));
}

TEST(ParseFIXFile, RequiredGroupCountedAtTheTopLevelIsSeen) {
    WalkSchema w;
    w.schema.map[checks::wide("78")]->setRequirement(Required);
    const std::string body = fix("8=FIX.4.2|9=5|35=D|11=A|78=0|");
    Session s(body + fix("10=" + checkSum(body) + "|"));
    EXPECT_EQ(s.parseFile(w.schema.map).findings, std::vector<Finding>{});
}

}  // namespace
