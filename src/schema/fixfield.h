// One Field or Group of a schema: its tag, texts, value pattern, requirement and, for a
// group, its ordered children, which it owns.
#pragma once

#include <cstdint>
#include <map>
#include <vector>

#include "kxutil/kxwstring.h"
#include "kxvfixexport.h"
#include "schema/valuepattern.h"

class FIXFieldList;

enum FIXRequirement : int32_t { Required = 0, Optional = 1, Conditional = 2 };

class KXVFIX_API FIXField {
  public:
    FIXField();
    FIXField(const FIXField&) = delete;
    FIXField& operator=(const FIXField&) = delete;
    virtual ~FIXField();

    // Appends child (a new empty node when null) to the children, creating the list on
    // first use. Null, and nothing changed, when storage cannot be obtained.
    FIXField* addChild(FIXField* child);

    const KXWString& getTag() const { return tag; }
    void setTag(const KXWString& t) { tag = t; }
    const KXWString& getQualifiedTag() const { return qualifiedTag; }
    void setQualifiedTag(const KXWString& t) { qualifiedTag = t; }
    const KXWString& getName() const { return name; }
    void setName(const KXWString& t) { name = t; }
    const KXWString& getFormat() const { return format; }
    void setFormat(const KXWString& t) { format = t; }
    const KXWString& getValue() const { return value; }
    void setValue(const KXWString& t) {
        value = t;
        pattern.assign(value.view());
    }
    // The value pattern, ready for matching.
    const ValuePattern& getPattern() const { return pattern; }
    int32_t getRequirement() const { return requirement; }
    void setRequirement(int32_t r) { requirement = r; }
    int32_t getIsField() const { return isField; }
    void setIsField(int32_t f) { isField = f; }
    int32_t getOrdinal() const { return ordinal; }
    void setOrdinal(int32_t o) { ordinal = o; }
    FIXFieldList* getChildren() const { return children; }
    // Stores the pointer; a list that was there before is not destroyed.
    void setChildren(FIXFieldList* list) { children = list; }

  private:
    // Moves the children into out, leaving this node without a list.
    void detachChildren(std::vector<FIXField*>& out);

    KXWString tag;
    KXWString qualifiedTag;
    KXWString name;
    KXWString format;
    KXWString value;
    ValuePattern pattern;  // views into value
    // A node whose schema entry has no Requirement is optional, as any unrecognised
    // requirement text is.
    int32_t requirement = Optional;
    int32_t isField = 1;
    int32_t ordinal = -1;  // -1 until the node is placed
    FIXFieldList* children = nullptr;
};

// Tag text to definition: top-level fields under their tag, groups under the tag of their
// counter field. Values are not owned.
using FIXFieldMap = std::map<KXWString, FIXField*>;
