#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

namespace {

// Records its destruction, so leaks and double destruction show up as counts (and under
// AddressSanitizer as reports).
struct CountedField : FIXField {
    CountedField(std::vector<int>& destroyed, int id) : destroyed(destroyed), id(id) {}
    ~CountedField() override { destroyed.push_back(id); }
    std::vector<int>& destroyed;
    int id;
};

TEST(FIXModel, ListsAndGroupsDestroyWhatTheyOwnOnceInOrder) {
    std::vector<int> destroyed;
    auto* dropped = new CountedField(destroyed, -1);
    {
        FIXFieldList list;
        for (int i = 0; i < 40; ++i)
            ASSERT_NE(list.append(new CountedField(destroyed, i)), nullptr);
        EXPECT_EQ(list.getAt(-1), nullptr);
        EXPECT_EQ(list.getAt(40), nullptr);
        list.removeAt(10);
        list.removeAt(39);  // outside now: nothing
        EXPECT_EQ(destroyed, std::vector<int>{10});
        list.append(dropped);
        list.dropLast();                         // forgets without destroying
        FIXField* group = list.append(nullptr);  // a new empty node
        EXPECT_EQ(list.getAt(39), group);
        EXPECT_EQ(std::u16string(group->getFormat().c_str()), u"String");
        EXPECT_EQ(group->getRequirement(), Optional);
        EXPECT_EQ(group->getChildren(), nullptr);
        FIXField* inner = group->addChild(new CountedField(destroyed, 40));
        EXPECT_EQ(group->getChildren()->getAt(0), inner);
        inner->addChild(new CountedField(destroyed, 41));
        const FIXFieldMap map{{KXWString(u"78"), group}, {KXWString(u"79"), inner}};  // refers only
        list.clear();     // destroys every entry, keeps the storage
        list.dropLast();  // empty: nothing
        EXPECT_EQ(list.getLast(), nullptr);
        list.append(new CountedField(destroyed, 42));
    }
    std::vector<int> expected{10};
    for (int i = 0; i < 43; ++i)
        if (i != 10) expected.push_back(i);
    EXPECT_EQ(destroyed, expected);  // each once, the dropped one not
    delete dropped;
}

TEST(FIXModel, DeepNestingIsDestroyedWithoutRecursion) {
    auto* root = new FIXField;
    FIXField* inner = root;
    for (int depth = 0; depth < 200000; ++depth) inner = inner->addChild(nullptr);
    ASSERT_NE(inner, nullptr);
    delete root;  // would overflow the stack if destruction recursed
}

}  // namespace
