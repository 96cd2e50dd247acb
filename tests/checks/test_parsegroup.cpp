#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <vector>

#include "checkharness.h"

namespace {

using checks::Finding;
using checks::mismatch;
using checks::missing;
using checks::Schema;
using checks::Session;
using checks::unknownTag;
using testutil::fix;

// Members 79 (required, pattern X|Y|Z), 80 (optional) and 81 (required).
struct GroupSchema {
    GroupSchema() {
        group = schema.group("78", Optional);
        schema.member(group, "79", Required, "X|Y|Z");
        schema.member(group, "80", Optional);
        schema.member(group, "81", Required);
    }
    Schema schema;
    FIXField* group;
};

TEST(ParseGroup, EachRepetitionIsOnePassInSchemaOrder) {
    GroupSchema g;
    Session s(fix("81=c|79=X|11=A|"));
    const auto walk = s.parseGroup(g.group, 2);
    EXPECT_EQ(walk.result, BATCH_OK);
    // Repetition 1 passes 79 and 80 by and reads 81; repetition 2 reads 79 and misses 81.
    EXPECT_EQ(walk.findings, (std::vector<Finding>{missing("79"), missing("81")}));
    EXPECT_EQ(s.nextTag(), "11");
}

TEST(ParseGroup, MemberValuesAreMatchedAgainstTheirPatterns) {
    GroupSchema g;
    Session s(fix("79=Q|80=anything|81=c|11=A|"));
    const auto walk = s.parseGroup(g.group, 1);
    EXPECT_EQ(walk.findings, std::vector<Finding>{mismatch("79")});
    EXPECT_EQ(s.nextTag(), "11");
}

TEST(ParseGroup, SurplusRepetitionReportsOnceAndReadsNothing) {
    const char* const counts[] = {
        "2", "3", "2147483647", "9223372036854775807", "2000000000", "99999999999999999999"};
    for (const char* count : counts) {
        GroupSchema g;
        Session s(fix("8=FIX.4.2|9=5|35=D|78=") + count + fix("|79=X|81=c|11=A|"));
        g.schema.field("8", Optional);
        g.schema.field("9", Optional);
        g.schema.field("35", Optional);
        g.schema.field("11", Optional);
        const auto start = std::chrono::steady_clock::now();
        const auto walk = s.parseFile(g.schema.map);
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(1)) << count;
        EXPECT_EQ(walk.result, BATCH_OK) << count;
        EXPECT_EQ(walk.findings, (std::vector<Finding>{missing("79"), missing("81")})) << count;
    }
}

TEST(ParseGroup, CountsWithoutRepetitionsLeaveTheNextFieldToTheTopLevel) {
    struct CountCase {
        const char* count;
        BATCHERR result;
        std::vector<Finding> findings;
    };
    const CountCase cases[] = {
        {"0", BATCH_CHECK_FAILED, {unknownTag("79")}},
        {"-1", BATCH_CHECK_FAILED, {unknownTag("79")}},
        {"x", BATCH_CHECK_FAILED, {unknownTag("79")}},
        {"", BATCH_CHECK_FAILED, {unknownTag("79")}},
        {"-2147483648", BATCH_CHECK_FAILED, {unknownTag("79")}},
        // Digits before other characters count: two repetitions, then 11.
        {"2x", BATCH_OK, {}},
    };
    for (const auto& c : cases) {
        GroupSchema g;
        g.schema.field("8", Optional);
        g.schema.field("9", Optional);
        g.schema.field("35", Optional);
        g.schema.field("11", Optional);
        Session s(fix("8=FIX.4.2|9=5|35=D|78=") + c.count + fix("|79=X|81=a|79=Y|81=b|11=A|"));
        const auto walk = s.parseFile(g.schema.map);
        EXPECT_EQ(walk.result, c.result) << c.count;
        EXPECT_EQ(walk.findings, c.findings) << c.count;
    }
}

TEST(ParseGroup, EndOfInputEndsEveryRemainingRepetition) {
    GroupSchema g;
    Session s(fix("79=X|80=Y|81=a|") + "79=Z");
    const auto walk = s.parseGroup(g.group, 5);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, std::vector<Finding>{});  // 81 is missing, but the input ended
}

TEST(ParseGroup, GroupsWithoutMembersReadNothing) {
    Schema schema;
    FIXField* counterOnly = schema.group("78", Optional);
    FIXField* noList = schema.field("90", Optional);
    noList->setIsField(0);
    for (FIXField* group : {counterOnly, noList}) {
        Session s(fix("79=X|"));
        const auto walk = s.parseGroup(group, 3);
        EXPECT_EQ(walk.findings, std::vector<Finding>{});
        EXPECT_EQ(s.nextTag(), "79");
    }
}

TEST(ParseGroup, EntryZeroIsNeverVisitedAndPrefixesAreDroppedOnlyAfterTheFirstCharacter) {
    Schema schema;
    FIXField* group = schema.field("90", Optional);
    group->setIsField(0);
    schema.member(group, "77", Required);  // entry 0: neither read nor reported
    schema.member(group, "XY.5", Required);
    schema.member(group, ".6", Required);
    Session unread(fix("77=a|"));
    EXPECT_EQ(unread.parseGroup(group, 1).findings,
              (std::vector<Finding>{missing("XY.5"), missing(".6")}));
    EXPECT_EQ(unread.nextTag(), "77");

    // XY.5 is compared as ".5"; ".6" keeps its first two characters.
    Session read(fix(".5=b|.6=c|"));
    EXPECT_EQ(read.parseGroup(group, 1).findings, std::vector<Finding>{});
    EXPECT_EQ(read.nextTag(), "");
}

// Parent 100 with the required nested group 78 (member 79) and the optional member 101.
struct NestedSchema {
    NestedSchema() {
        schema.field("8", Optional);
        schema.field("9", Optional);
        schema.field("35", Optional);
        schema.field("11", Optional);
        parent = schema.group("100", Optional);
        FIXField* nested = schema.nestedGroup(parent, "78", Required);
        schema.member(nested, "79", Required);
        schema.member(parent, "101", Optional);
    }
    Schema schema;
    FIXField* parent;
};

TEST(ParseGroup, NestedGroupsAreWalkedWithinTheirParentsRepetition) {
    NestedSchema n;
    Session present(fix("8=FIX.4.2|9=5|35=D|100=2|78=2|79=X|79=Y|101=a|78=1|79=Z|11=A|"));
    const auto walk = present.parseFile(n.schema.map);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, std::vector<Finding>{});  // nor at the end for G.78

    NestedSchema m;
    Session absent(fix("8=FIX.4.2|9=5|35=D|100=2|78=1|79=X|101=a|101=b|11=A|"));
    const auto second = absent.parseFile(m.schema.map);
    EXPECT_EQ(second.result, BATCH_OK);
    EXPECT_EQ(second.findings, std::vector<Finding>{missing("G.78")});  // once, within the walk
}

TEST(ParseGroup, DeepNestingDoesNotExhaustTheStack) {
    constexpr int kDepth = 200000;
    Schema schema;
    FIXField* group = schema.group("1000", Optional);
    FIXField* top = group;
    std::string source;
    for (int i = 1; i < kDepth; ++i) {
        group = schema.nestedGroup(group, std::to_string(1000 + i), Required);
        source += std::to_string(1000 + i) + "=1|";
    }
    schema.member(group, "5", Required);
    source += "5=x|";
    Session s(fix(source));
    const auto walk = s.parseGroup(top, 1);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, std::vector<Finding>{});
    EXPECT_EQ(s.nextTag(), "");
}

}  // namespace
