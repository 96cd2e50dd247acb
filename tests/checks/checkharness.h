// Shared by the tests of the checks: schemas built in code, sources written to files, and
// the findings of one walk in a readable form.
#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <ostream>
#include <string>
#include <vector>

#include "fix/kxfixvalidator.h"
#include "fixprsr/kxfixdoc.h"
#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"
#include "testutil.h"

struct KXFIXValidatorAccess {
    static void setSourceName(KXFIXValidator& v, const char16_t* name) { v.sourceName = name; }
    static BATCHERR parseFIXFile(KXFIXValidator& v, FIXFieldMap& map, KXFIXDoc& doc,
                                 int64_t& total) {
        return v.parseFIXFile(map, doc, total);
    }
    static BATCHERR parseGroup(KXFIXValidator& v, FIXFieldList* fields, KXFIXDoc& doc,
                               int repetitions, int64_t& total) {
        return v.parseGroup(fields, doc, repetitions, total);
    }
    static bool isLike(KXFIXValidator& v, const KXWString& value, const KXWString& pattern) {
        return v.isLike(value, pattern);
    }
    static BATCHERR checkValidField(KXFIXValidator& v, const KXWString& pattern,
                                    const KXWString& value) {
        return v.checkValidField(pattern, value);
    }
};

namespace checks {

inline KXWString wide(const std::string& text) {
    KXWString out;
    for (const char c : text) out += static_cast<char16_t>(static_cast<unsigned char>(c));
    return out;
}

inline std::string narrow(const KXWString& text) {
    std::string out;
    for (int32_t i = 0; i < text.length(); ++i) out += static_cast<char>(text[i]);
    return out;
}

// The three-digit CheckSum of everything before it: its bytes' sum modulo 256.
inline std::string checkSum(const std::string& bytes) {
    unsigned sum = 0;
    for (const char c : bytes) sum += static_cast<unsigned char>(c);
    const std::string digits = std::to_string(sum % 256);
    return std::string(3 - digits.size(), '0') + digits;
}

// A schema's definitions, owned here, and the field map over them.
class Schema {
  public:
    FIXField* field(const std::string& tag, int32_t requirement, const std::string& pattern = "") {
        FIXField* node = define(roots_.append(nullptr), tag, requirement, pattern);
        map[wide(tag)] = node;
        return node;
    }
    // A group counted by the field counterTag; entry 0 of its list is that counter.
    FIXField* group(const std::string& counterTag, int32_t requirement) {
        return makeGroup(roots_.append(nullptr), counterTag, requirement);
    }
    FIXField* nestedGroup(FIXField* parent, const std::string& counterTag, int32_t requirement) {
        return makeGroup(parent->addChild(nullptr), counterTag, requirement);
    }
    FIXField* member(FIXField* group, const std::string& tag, int32_t requirement,
                     const std::string& pattern = "") {
        return define(group->addChild(nullptr), tag, requirement, pattern);
    }

    FIXFieldMap map;

  private:
    static FIXField* define(FIXField* node, const std::string& tag, int32_t requirement,
                            const std::string& pattern) {
        node->setTag(wide(tag));
        node->setRequirement(requirement);
        node->setValue(wide(pattern));
        return node;
    }
    FIXField* makeGroup(FIXField* node, const std::string& counterTag, int32_t requirement) {
        define(node, "G." + counterTag, requirement, "");
        node->setIsField(0);
        define(node->addChild(nullptr), counterTag, requirement, "");
        map[wide(counterTag)] = node;
        return node;
    }

    FIXFieldList roots_;
};

struct Finding {
    int kind;
    std::string message;
    bool operator==(const Finding& other) const {
        return kind == other.kind && message == other.message;
    }
};

inline std::ostream& operator<<(std::ostream& out, const Finding& f) {
    return out << "{" << f.kind << ", \"" << f.message << "\"}";
}

struct Walk {
    BATCHERR result;
    std::vector<Finding> findings;
};

// A validator and a reader over a source file, both living as long as the session.
class Session {
  public:
    explicit Session(const std::string& source) : file_(source) {
        KXFIXValidatorAccess::setSourceName(validator_, u"source.fix");
        EXPECT_EQ(doc_.openfile(file_.c_str(), "rbu", KX_CSET_BYTE), 0);
        isFix_ = doc_.isFIXFile();
    }

    Walk parseFile(FIXFieldMap& map) {
        int64_t total = 0;
        const BATCHERR result = KXFIXValidatorAccess::parseFIXFile(validator_, map, doc_, total);
        return {result, findings()};
    }
    Walk parseGroup(FIXField* group, int repetitions) {
        int64_t total = 0;
        const BATCHERR result = KXFIXValidatorAccess::parseGroup(validator_, group->getChildren(),
                                                                 doc_, repetitions, total);
        return {result, findings()};
    }
    // The tag the walk left the reader on.
    std::string nextTag() {
        KXWString tag;
        doc_.peekTag(tag);
        return narrow(tag);
    }
    bool isFix() const { return isFix_; }

  private:
    std::vector<Finding> findings() {
        std::vector<Finding> out;
        for (int32_t i = 0; i < validator_.errorCount(); ++i) {
            const KXValError& e = validator_.errorAt(i);
            EXPECT_EQ(narrow(e.file), "source.fix");
            EXPECT_EQ(e.line, -1);
            EXPECT_EQ(e.column, -1);
            out.push_back({e.kind, narrow(e.message)});
        }
        validator_.clearErrors();
        return out;
    }

    testutil::TempFile file_;
    KXFIXDoc doc_;
    KXFIXValidator validator_;
    bool isFix_ = false;
};

constexpr int kField = KXVAL_FIELD_ERROR;
constexpr int kOther = KXVAL_OTHER_ERROR;

inline Finding missing(const std::string& tag) {
    return {kField, "Field " + tag + " is missing"};
}
inline Finding mismatch(const std::string& tag) {
    return {kField, "Field " + tag + " failed to match specified value"};
}
inline Finding unknownTag(const std::string& tag) {
    return {kOther, "Failed to match tag=" + tag + " in schema file"};
}
const Finding kCheckSumLength{kOther, "The Checksum length is incorrect"};
const Finding kCheckSumValue{kOther, "The Checksum is incorrect"};

}  // namespace checks
