// Shared by the tests of the checks: schemas built in code, sources written to files ("|"
// standing for SOH), and the result and messages of one walk.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "fix/kxfixvalidator.h"
#include "schema/fixfieldlist.h"
#include "testutil.h"

inline KXWString wide(const std::string& text) {
    return KXWString(std::u16string(text.begin(), text.end()).c_str());
}

inline std::string narrow(const KXWString& text) {
    return std::string(text.c_str(), text.c_str() + text.length());
}

// The three-digit CheckSum of the text: its bytes' sum modulo 256.
inline std::string checkSum(const std::string& text) {
    unsigned sum = 0;
    for (const char c : testutil::fix(text)) sum += static_cast<unsigned char>(c);
    const std::string digits = std::to_string(sum % 256);
    return std::string(3 - digits.size(), '0') + digits;
}

// The text followed by its CheckSum field.
inline std::string sealed(const std::string& text) {
    return text + "10=" + checkSum(text) + "|";
}

// A walk's result and the messages of its findings, in order.
using Walk = std::pair<BATCHERR, std::vector<std::string>>;
inline std::string missing(const std::string& tag) {
    return "Field " + tag + " is missing";
}
inline std::string mismatch(const std::string& tag) {
    return "Field " + tag + " failed to match specified value";
}
inline std::string unknownTag(const std::string& tag) {
    return "Failed to match tag=" + tag + " in schema file";
}
const std::string kSumLength = "The Checksum length is incorrect";
const std::string kSumValue = "The Checksum is incorrect";

// The schema of the tests, its definitions owned here: top-level fields, all optional but
// 10, the patterns FIX.4.2|FIX.4.4 on 8 and 0|A|D|F on 35; the group 453 of 448, 447 and
// 452; the group 78 of 79 (required, X|Y|Z), 80 (optional) and 81 (required); the group 100
// of the required group 77 (of 76) and of 101; the group 91 of XY.5 and .6.
class Schema {
  public:
    Schema() {
        for (const char* tag : {"9", "11", "34", "38", "40", "49", "52", "54", "55", "56", "60"})
            field(tag, Optional);
        field("10", Required);
        field("8", Optional, "FIX.4.2|FIX.4.4");
        field("35", Optional, "0|A|D|F");
        FIXField* parties = group("453", Optional);
        for (const char* tag : {"448", "447", "452"}) field(tag, Optional, "", parties);
        FIXField* g78 = group("78", Optional);
        field("79", Required, "X|Y|Z", g78);
        field("80", Optional, "", g78);
        field("81", Required, "", g78);
        FIXField* parent = group("100", Optional);
        field("76", Required, "", group("77", Required, parent));
        field("101", Optional, "", parent);
        field("90", Optional)->setIsField(0);  // a group without a list
        group("95", Optional);                 // a group of its counter alone
        FIXField* prefixed = group("91", Optional);
        for (const char* tag : {"XY.5", ".6"}) field(tag, Required, "", prefixed);
    }
    // A top-level field, or the next member of group when one is given.
    FIXField* field(const std::string& tag, int32_t requirement, const std::string& pattern = "",
                    FIXField* group = nullptr) {
        FIXField* node = group != nullptr ? group->addChild(nullptr) : roots_.append(nullptr);
        node->setTag(wide(tag));
        node->setRequirement(requirement);
        node->setValue(wide(pattern));
        if (group == nullptr) map[wide(tag)] = node;
        return node;
    }
    // A group counted by counterTag, its entry 0, required so that walking it would show;
    // the map holds nested groups too.
    FIXField* group(const std::string& counterTag, int32_t requirement,
                    FIXField* parent = nullptr) {
        FIXField* node = field(counterTag, requirement, "", parent);
        node->setTag(wide("G." + counterTag));
        node->setIsField(0);
        field(counterTag, Required, "", node);
        map[wide(counterTag)] = node;
        return node;
    }

    FIXFieldMap map;

  private:
    FIXFieldList roots_;
};

// The validator's friend: a validator and a reader over one source file, for one walk.
struct KXFIXValidatorAccess {
    explicit KXFIXValidatorAccess(const std::string& source = "") : file(testutil::fix(source)) {
        validator.sourceName = u"source.fix";
        EXPECT_EQ(doc.openfile(file.c_str(), "rbu", KX_CSET_BYTE), 0);
        doc.isFIXFile();
    }

    // Findings about a field, and only those, are field errors.
    Walk parseFile(FIXFieldMap& map) {
        Walk walk{validator.parseFIXFile(map, doc, sum), {}};
        for (int32_t i = 0; i < validator.errorCount(); ++i) {
            const KXValError& e = validator.errorAt(i);
            walk.second.push_back(narrow(e.message));
            const bool aboutField = walk.second.back().find("Field ") == 0;
            EXPECT_EQ(e.kind, aboutField ? KXVAL_FIELD_ERROR : KXVAL_OTHER_ERROR);
            EXPECT_EQ(narrow(e.file) + std::to_string(e.line) + std::to_string(e.column),
                      "source.fix-1-1");
        }
        return walk;
    }
    BATCHERR checkValidField(const std::string& pattern, const std::string& value) {
        return validator.checkValidField(wide(pattern), wide(value));
    }

  private:
    testutil::TempFile file;
    KXFIXDoc doc;
    KXFIXValidator validator;
    int64_t sum = 0;
};
using Session = KXFIXValidatorAccess;

// The walk of a whole source over the schema.
inline Walk walkFile(const std::string& source, const char* undefinedTag = "") {
    Schema schema;
    schema.map.erase(wide(undefinedTag));
    return Session(source).parseFile(schema.map);
}
