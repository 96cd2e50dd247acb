// Allocation failure injected into the plug-in's nothrow allocations.
#include <gtest/gtest.h>

#include <new>

#include "libmain/libmain.h"
#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

namespace {

int granted = -1;  // nothrow allocations still served; -1: all of them

}  // namespace

// Served by the ordinary forms otherwise, so every deallocation matches its allocation.
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    if (granted == 0) return nullptr;
    if (granted > 0) --granted;
    return ::operator new(size);
}
void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    if (granted == 0) return nullptr;
    if (granted > 0) --granted;
    return ::operator new[](size);
}

namespace {

TEST(AllocationFailure, AppendAddChildAndNewValidatorAnswerNullAndChangeNothing) {
    FIXFieldList list;
    auto* extra = new FIXField;
    auto* child = new FIXField;
    granted = 0;
    EXPECT_EQ(list.append(nullptr), nullptr);    // the node cannot be made
    EXPECT_EQ(extra->addChild(child), nullptr);  // nor the list of children
    EXPECT_EQ(NewValidator(), nullptr);
    granted = 1;
    EXPECT_EQ(extra->addChild(child), nullptr);  // the list, but not its storage
    granted = -1;
    EXPECT_EQ(list.getCount(), 0);
    EXPECT_EQ(extra->getChildren(), nullptr);
    for (int i = 0; i < FIXFieldList::kGrowth; ++i) ASSERT_NE(list.append(nullptr), nullptr);
    granted = 0;
    EXPECT_EQ(list.append(extra), nullptr);  // the list cannot grow
    granted = -1;
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
