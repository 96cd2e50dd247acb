#include <chrono>
#include <climits>
#include <cstdint>
#include <tuple>

#include "checkharness.h"
#include "fixprsr/decimal.h"

namespace {

TEST(IsLike, AlternativesSplitAtBarsUntilOneStartsTheRest) {
    // Pattern, values it matches, values it does not.
    const std::tuple<const char*, std::vector<const char*>, std::vector<const char*>> cases[] = {
        {"A|B|C", {"A", "B", "C"}, {"D", "A|B", "AB", ""}},
        {"FIX.4.2|FIX.4.4", {"FIX.4.2", "FIX.4.4"}, {"FIX.4.3", "fix.4.2", "FIX.4.", "FIX.4.44"}},
        // A leading bar or an empty alternative stops the splitting: the rest is one value.
        {"|A", {"|A"}, {"A", ""}},
        {"A||B", {"A", "|B"}, {"B", ""}},
        {"A|", {"A", ""}, {"|"}},
        {"", {""}, {"A"}},
        // Single characters, ASCII or not, longer alternatives and repeats alike.
        {"\xE9|AB|A|AB|Z|~", {"\xE9", "AB", "A", "Z", "~"}, {"B", "ABC", "e", "|", "AB|A"}},
    };
    Session s;
    for (const auto& [pattern, matching, failing] : cases) {
        for (const char* value : matching)
            EXPECT_EQ(s.checkValidField(pattern, value), BATCH_OK) << pattern << " ? " << value;
        for (const char* value : failing)
            EXPECT_EQ(s.checkValidField(pattern, value), BATCH_CHECK_FAILED)
                << pattern << " ? " << value;
    }
}

TEST(LeadingDecimal, ReadsLikeWcstolAndSaturates) {
    // Text, its value, and the repetition count it gives.
    const std::tuple<const char*, int64_t, int> cases[] = {
        {"017", 17, 17},
        {" \t+42", 42, 42},
        {"-7", -7, -7},
        {"2x", 2, 2},
        {"x2", 0, 0},
        {"", 0, 0},
        {"-", 0, 0},
        {"+ 1", 0, 0},
        {"2147483647", INT_MAX, INT_MAX},
        {"2147483648", 2147483648LL, INT_MAX},
        {"-2147483649", -2147483649LL, INT_MIN},
        {"9223372036854775807", INT64_MAX, INT_MAX},
        {"9223372036854775808", INT64_MAX, INT_MAX},
        {"-9223372036854775808", INT64_MIN, INT_MIN},
        {"-9223372036854775809", INT64_MIN, INT_MIN},
        {"99999999999999999999999", INT64_MAX, INT_MAX}};
    for (const auto& [text, value, count] : cases) {
        EXPECT_EQ(leadingDecimal(wide(text)), value) << text;
        EXPECT_EQ(repetitionCount(wide(text)), count) << text;
    }
}

TEST(ParseFIXFile, TopLevelFindingsAndTheErrorsThatStopTheWalk) {
    const std::string message = sealed("8=FIX.4.2|9=5|35=D|11=A|");
    const std::pair<std::string, Walk> cases[] = {
        {sealed("8=FIX.4.2|9=5|35=G|11=A|"), {BATCH_OK, {mismatch("35")}}},
        // Only the file's first three fields have places; a later 8 has its pattern only.
        {message + "11=B|35=F|" + sealed("8=FIX.4.3|"), {BATCH_OK, {mismatch("8")}}},
        // An empty tag ends the walk as the end of input does.
        {"8=FIX.4.2|9=5|35=D|=x|10=000|", {BATCH_OK, {missing("10")}}},
        // Structural errors stop the walk before the required check (of 10, among others).
        {"9=5|8=FIX.4.2|", {BATCH_CHECK_FAILED, {"Failed to find BeginString"}}},
        {"8=FIX.4.2|35=D|9=5|", {BATCH_CHECK_FAILED, {"Failed to find BodyLength"}}},
        {"8=FIX.4.2|9=5|11=A|35=D|", {BATCH_CHECK_FAILED, {"Failed to find MsgType"}}},
        {"8=FIX.4.2|9=5|035=D|", {BATCH_CHECK_FAILED, {"Failed to find MsgType"}}},
        // Tags match exactly, not by the number they resemble (011 for 11, 3: for 40).
        {"8=FIX.4.2|9=5|35=D|011=A|", {BATCH_CHECK_FAILED, {unknownTag("011")}}},
        {"8=FIX.4.2|9=5|35=D|3:=x|", {BATCH_CHECK_FAILED, {unknownTag("3:")}}},
        {"8=FIX.4.2|9=5|35=D|79=X|", {BATCH_CHECK_FAILED, {unknownTag("79")}}},
        {message + "\r\n" + message, {BATCH_CHECK_FAILED, {unknownTag("\r\n8")}}},
        {message + "\r\n", {BATCH_CHECK_FAILED, {unknownTag("\r\n")}}},
    };
    for (const auto& [source, walk] : cases) EXPECT_EQ(walkFile(source), walk) << source;
    // Header tags are looked up in the schema too.
    EXPECT_EQ(walkFile("8=FIX.4.2|9=5|35=D|", "9"), (Walk{BATCH_CHECK_FAILED, {unknownTag("9")}}));
}

TEST(ParseFIXFile, RequiredCheckLooksAtTheWholeFileInKeyOrder) {
    Schema schema;
    for (const char* tag : {"453", "38", "54", "78", "11"})
        schema.map[wide(tag)]->setRequirement(Required);
    // 54 and 78 occur in the second message only, 453, 38 and 11 never; G.77 is nested.
    Session s("8=FIX.4.2|9=5|35=D|" + sealed("8=FIX.4.2|9=5|35=D|78=0|54=1|") + "=x|11=A|");
    EXPECT_EQ(s.parseFile(schema.map),
              (Walk{BATCH_OK, {missing("11"), missing("38"), missing("G.453")}}));
}

// FIX 4.4 messages, given without BeginString, BodyLength and CheckSum.
const std::string kOrder =
    "35=D|49=BUYSIDE|56=SELLSIDE|34=2|52=20240105-09:30:01.250|11=ORD-0001|453=2|448=TRADER1|"
    "447=D|452=11|448=FIRM9|447=D|452=1|55=ABCD|54=1|60=20240105-09:30:01.249|38=100|40=1|";
const std::string kHeartbeat = "35=0|49=BUYSIDE|56=SELLSIDE|34=3|52=20240105-09:30:30.000|";

std::string headed(const std::string& body) {
    return "8=FIX.4.4|9=" + std::to_string(body.size()) + "|" + body;
}

TEST(CheckSum, EachCheckSumFieldIsJudgedOnItsOwnMessage) {
    const std::string beat = sealed(headed(kHeartbeat)), order = headed(kOrder);
    const std::pair<std::string, Walk> cases[] = {
        {beat + sealed(order) + beat, {BATCH_OK, {}}},
        {beat + order + "10=" + checkSum(order + "\x01") + "|" + beat, {BATCH_OK, {kSumValue}}},
        {order + "10=0" + checkSum(order) + "|", {BATCH_OK, {kSumLength}}},
        // Right after a CheckSum the sum is 0, and a value without digits reads as 0.
        {beat + "10=01|", {BATCH_OK, {kSumLength, kSumValue}}},
        {beat + "10=abc|", {BATCH_OK, {}}},
        {order + "10=abc|", {BATCH_OK, {kSumValue}}},
        // The sum starts afresh at each 8 and after each CheckSum.
        {headed(kHeartbeat) + sealed(order), {BATCH_OK, {}}},
        {beat + sealed("34=9|"), {BATCH_OK, {}}},
    };
    for (const auto& [source, walk] : cases) EXPECT_EQ(walkFile(source), walk) << source;
}

TEST(ParseGroup, EachRepetitionIsOnePassInSchemaOrder) {
    const std::string head = "8=FIX.4.2|9=5|35=D|";
    const std::pair<std::string, Walk> cases[] = {
        // Repetition 1 passes 79 and 80 by and reads 81; repetition 2 reads 79 and misses 81.
        {sealed(head + "78=2|81=c|79=X|"), {BATCH_OK, {missing("79"), missing("81")}}},
        {sealed(head + "78=1|79=Q|80=anything|81=c|"), {BATCH_OK, {mismatch("79")}}},
        // The second repetition lacks 81, but the input ended.
        {head + "78=5|79=X|80=Y|81=a|79=Z", {BATCH_OK, {missing("10")}}},
        // Groups without members read nothing.
        {sealed(head + "90=3|95=3|"), {BATCH_OK, {}}},
        // The counter, entry 0, is never walked; "XY.5" is read as ".5", ".6" as itself.
        {sealed(head + "91=1|"), {BATCH_OK, {missing("XY.5"), missing(".6")}}},
        {sealed(head + "91=1|.5=b|.6=c|"), {BATCH_OK, {}}},
        // A nested group is walked within its parent's repetition, and only there reported.
        {sealed(head + "100=2|77=2|76=X|76=Y|101=a|77=1|76=Z|"), {BATCH_OK, {}}},
        {sealed(head + "100=2|77=1|76=X|101=a|101=b|"), {BATCH_OK, {missing("G.77")}}},
    };
    for (const auto& [source, walk] : cases) EXPECT_EQ(walkFile(source), walk) << source;
}

std::string counted(const std::string& count) {
    return sealed("8=FIX.4.2|9=5|35=D|78=" + count + "|79=X|81=a|79=Y|81=b|");
}

TEST(ParseGroup, CountOfTheCounterField) {
    // No repetition: the top level meets the member.
    const Walk unread{BATCH_CHECK_FAILED, {unknownTag("79")}};
    for (const char* count : {"0", "-1", "x", "", "-2147483648"})
        EXPECT_EQ(walkFile(counted(count)), unread) << count;
    EXPECT_EQ(walkFile(counted("2x")), (Walk{BATCH_OK, {}}));
    // A surplus repetition reads nothing: reported once, it ends the walk at any count.
    const Walk surplus{BATCH_OK, {missing("79"), missing("81")}};
    for (const char* count : {"3", "2000000000", "9223372036854775807", "99999999999999999999"}) {
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(walkFile(counted(count)), surplus) << count;
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(1)) << count;
    }
}

TEST(ParseGroup, DeepNestingDoesNotExhaustTheStack) {
    Schema schema;
    FIXField* group = nullptr;
    std::string source = "8=FIX.4.2|9=5|35=D|";
    // Tags past 99999 are also looked up other than by number.
    for (int tag = 100000; tag < 300000; ++tag) {
        group = schema.group(std::to_string(tag), Required, group);
        source += std::to_string(tag) + "=1|";
    }
    EXPECT_EQ(Session(sealed(source)).parseFile(schema.map), (Walk{BATCH_OK, {}}));
}

}  // namespace
