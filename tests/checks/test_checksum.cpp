#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "checkharness.h"

namespace {

using checks::checkSum;
using checks::Finding;
using checks::kCheckSumLength;
using checks::kCheckSumValue;
using checks::Schema;
using checks::Session;
using testutil::fix;

// A FIX 4.4 schema of the fields the messages below carry.
struct Fix44Schema : Schema {
    Fix44Schema() {
        Schema& schema = *this;
        for (const char* tag : {"9", "49", "56", "34", "52", "10"}) schema.field(tag, Required);
        schema.field("8", Required, "FIX.4.4");
        schema.field("35", Required, "0|A|D|8");
        for (const char* tag : {"98", "108", "11", "21", "55", "60", "38", "44", "37", "17", "150",
                                "39", "151", "14", "6"})
            schema.field(tag, Optional);
        schema.field("54", Optional, "1|2");
        schema.field("40", Optional, "1|2");
        FIXField* parties = schema.group("453", Optional);
        schema.member(parties, "448", Required);
        schema.member(parties, "447", Optional);
        schema.member(parties, "452", Optional);
    }
};

// BeginString and BodyLength before the body ("|" for SOH), without the CheckSum field.
std::string unsealed(const std::string& body) {
    const std::string bytes = fix(body);
    return fix("8=FIX.4.4|9=" + std::to_string(bytes.size()) + "|") + bytes;
}

std::string sealed(const std::string& body) {
    const std::string message = unsealed(body);
    return message + fix("10=" + checkSum(message) + "|");
}

const std::string kLogon = "35=A|49=BUYSIDE|56=SELLSIDE|34=1|52=20240105-09:30:00.000|98=0|108=30|";
const std::string kOrder =
    "35=D|49=BUYSIDE|56=SELLSIDE|34=2|52=20240105-09:30:01.250|11=ORD-0001|453=2|448=TRADER1|"
    "447=D|452=11|448=FIRM9|447=D|452=1|21=1|55=ABCD|54=1|60=20240105-09:30:01.249|38=100|40=2|"
    "44=25.50|";
const std::string kReport =
    "35=8|49=SELLSIDE|56=BUYSIDE|34=2|52=20240105-09:30:01.300|37=EX-77|11=ORD-0001|17=F-1|"
    "150=0|39=0|55=ABCD|54=1|151=100|14=0|6=0|";
const std::string kHeartbeat = "35=0|49=BUYSIDE|56=SELLSIDE|34=3|52=20240105-09:30:30.000|";

// An order whose CheckSum is the given one, the ClOrdID's letters chosen to reach it.
std::string orderSummingTo(unsigned target) {
    std::string id(11, 'A');
    const auto sumOf = [](const std::string& id) {
        const std::string message = unsealed("35=D|49=B|56=S|34=2|52=X|11=" + id + "|");
        return std::stoi(checkSum(message));
    };
    unsigned delta = (target + 256 - static_cast<unsigned>(sumOf(id))) % 256;
    for (char& c : id) {
        const unsigned step = std::min(delta, 25u);
        c = static_cast<char>(c + step);
        delta -= step;
    }
    return unsealed("35=D|49=B|56=S|34=2|52=X|11=" + id + "|");
}

TEST(CheckSum, RealMessagesWithTheirCheckSumsDrawNoFinding) {
    Fix44Schema schema;
    Session s(sealed(kLogon) + sealed(kOrder) + sealed(kReport) + sealed(kHeartbeat));
    const auto walk = s.parseFile(schema.map);
    EXPECT_EQ(walk.result, BATCH_OK);
    EXPECT_EQ(walk.findings, std::vector<Finding>{});
}

TEST(CheckSum, EachCheckSumFieldIsJudgedOnItsOwnMessage) {
    const std::string order17 = orderSummingTo(17);
    const std::string order0 = orderSummingTo(0);
    ASSERT_EQ(checkSum(order17), "017");
    ASSERT_EQ(checkSum(order0), "000");
    const std::string wrong =
        unsealed(kOrder) + fix("10=" + checkSum(unsealed(kOrder) + "\x01") + "|");  // off by 1
    struct SumCase {
        const char* name;
        std::string source;
        std::vector<Finding> findings;
    };
    const SumCase cases[] = {
        {"wrong value", sealed(kLogon) + wrong + sealed(kHeartbeat), {kCheckSumValue}},
        {"two digits, right value", sealed(kLogon) + order17 + fix("10=17|"), {kCheckSumLength}},
        {"four digits, right value", order17 + fix("10=0017|"), {kCheckSumLength}},
        {"two digits, wrong value", order17 + fix("10=18|"), {kCheckSumLength, kCheckSumValue}},
        {"letters read as 0", order0 + fix("10=abc|"), {}},
        {"letters against a non-zero total", order17 + fix("10=abc|"), {kCheckSumValue}},
        {"first message without CheckSum", unsealed(kLogon) + sealed(kOrder), {}},
        {"last message without CheckSum", sealed(kLogon) + unsealed(kHeartbeat), {}},
    };
    for (const auto& c : cases) {
        Fix44Schema schema;
        Session s(c.source);
        const auto walk = s.parseFile(schema.map);
        EXPECT_EQ(walk.result, BATCH_OK) << c.name;
        EXPECT_EQ(walk.findings, c.findings) << c.name;
    }
}

}  // namespace
