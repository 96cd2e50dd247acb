#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

namespace {

// Records its own destruction, so double destruction and leaks show up as counts (and
// under AddressSanitizer as reports).
class CountedField : public FIXField {
  public:
    explicit CountedField(std::vector<int>& destroyed, int id) : destroyed_(destroyed), id_(id) {}
    ~CountedField() override { destroyed_.push_back(id_); }

  private:
    std::vector<int>& destroyed_;
    int id_;
};

TEST(FIXField, FreshNodeDefaults) {
    FIXField node;
    EXPECT_EQ(std::u16string(node.getFormat().c_str()), u"String");
    EXPECT_EQ(node.getTag().length() + node.getQualifiedTag().length() + node.getName().length() +
                  node.getValue().length(),
              0);
    EXPECT_EQ(node.getRequirement(), Optional);
    EXPECT_EQ(node.getChildren(), nullptr);
}

TEST(FIXFieldList, GrowsBySixteenKeepingOrder) {
    std::vector<int> destroyed;
    {
        FIXFieldList list;
        for (int i = 0; i < 40; ++i)
            ASSERT_NE(list.append(new CountedField(destroyed, i)), nullptr);
        ASSERT_EQ(list.getCount(), 40);
        EXPECT_EQ(list.getAt(-1), nullptr);
        EXPECT_EQ(list.getAt(40), nullptr);
        list.removeAt(10);
        list.removeAt(40);  // outside: nothing
        EXPECT_EQ(destroyed, std::vector<int>{10});
        EXPECT_EQ(list.getCount(), 39);
    }
    std::vector<int> expected{10};
    for (int i = 0; i < 40; ++i)
        if (i != 10) expected.push_back(i);
    EXPECT_EQ(destroyed, expected);  // in order, each once
}

TEST(FIXFieldList, DropLastForgetsWithoutDestroying) {
    std::vector<int> destroyed;
    auto* node = new CountedField(destroyed, 1);
    {
        FIXFieldList stack;
        stack.append(node);
        stack.dropLast();
        stack.dropLast();  // empty: nothing
        EXPECT_EQ(stack.getCount(), 0);
        EXPECT_EQ(stack.getLast(), nullptr);
    }
    EXPECT_TRUE(destroyed.empty());
    FIXFieldList owner;
    owner.append(node);
    owner.removeAt(0);
    EXPECT_EQ(destroyed, std::vector<int>{1});
}

TEST(FIXFieldList, AppendingNullMakesAnEmptyNode) {
    FIXFieldList list;
    FIXField* made = list.append(nullptr);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(list.getLast(), made);
    list.clear();
    EXPECT_EQ(list.getCount(), 0);
    EXPECT_NE(list.append(nullptr), nullptr);  // storage kept after clear
}

TEST(FIXField, GroupOwnsItsWholeSubtree) {
    std::vector<int> destroyed;
    {
        FIXFieldList top;
        auto* outer = new CountedField(destroyed, 0);
        top.append(outer);
        auto* inner = new CountedField(destroyed, 1);
        FIXField* first = outer->addChild(new CountedField(destroyed, 2));
        EXPECT_EQ(first, outer->getChildren()->getAt(0));
        outer->addChild(inner);
        inner->addChild(new CountedField(destroyed, 3));
        inner->addChild(nullptr);
        // The map only refers: a second node under the same key replaces the first there.
        FIXFieldMap map;
        map[KXWString(u"78")] = outer;
        map[KXWString(u"78")] = inner;
        EXPECT_EQ(map.size(), 1u);
        EXPECT_EQ(map[KXWString(u"78")], inner);
    }
    std::sort(destroyed.begin(), destroyed.end());
    EXPECT_EQ(destroyed, (std::vector<int>{0, 1, 2, 3}));
}

}  // namespace

namespace {

TEST(FIXField, DeepNestingIsDestroyedWithoutRecursion) {
    auto* root = new FIXField;
    FIXField* inner = root;
    for (int depth = 0; depth < 200000; ++depth) inner = inner->addChild(nullptr);
    ASSERT_NE(inner, nullptr);
    delete root;  // would overflow the stack if destruction recursed
}

}  // namespace
