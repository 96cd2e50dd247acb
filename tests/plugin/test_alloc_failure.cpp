// Allocation failure injected into the plug-in's nothrow allocations.
#include <gtest/gtest.h>

#include <new>

#include "libmain/libmain.h"
#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

namespace {

bool failing = false;  // whether nothrow allocations answer null

}  // namespace

// Served by the ordinary forms otherwise, so every deallocation matches its allocation.
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    return failing ? nullptr : ::operator new(size);
}
void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    return failing ? nullptr : ::operator new[](size);
}

namespace {

TEST(AllocationFailure, AppendAddChildAndNewValidatorAnswerNullAndChangeNothing) {
    FIXFieldList list;
    auto* extra = new FIXField;
    auto* child = new FIXField;
    failing = true;
    EXPECT_EQ(list.append(nullptr), nullptr);    // the node cannot be made
    EXPECT_EQ(extra->addChild(child), nullptr);  // nor the list of children
    EXPECT_EQ(NewValidator(), nullptr);
    failing = false;
    EXPECT_EQ(list.getCount(), 0);
    EXPECT_EQ(extra->getChildren(), nullptr);
    for (int i = 0; i < FIXFieldList::kGrowth; ++i) ASSERT_NE(list.append(nullptr), nullptr);
    failing = true;
    EXPECT_EQ(list.append(extra), nullptr);  // the list cannot grow
    failing = false;
    EXPECT_EQ(list.getCount(), FIXFieldList::kGrowth);
    EXPECT_NE(list.getLast(), extra);
    // Storage is back, and so is every answer.
    EXPECT_EQ(extra->addChild(child), child);
    EXPECT_EQ(list.append(extra), extra);
    KXValidator* v = NewValidator();
    EXPECT_NE(v, nullptr);
    DeleteValidator(v);
}

}  // namespace
