// Allocation failure injected into the plug-in's nothrow allocations.
#include <gtest/gtest.h>

#include <cstdlib>
#include <new>

#include "libmain/libmain.h"
#include "schema/fixfield.h"
#include "schema/fixfieldlist.h"

namespace {

// Allocations left before the nothrow forms start failing; negative: never.
int allocationsLeft = -1;

void* nothrowAllocate(size_t size) noexcept {
    if (allocationsLeft == 0) return nullptr;
    if (allocationsLeft > 0) --allocationsLeft;
    return std::malloc(size != 0 ? size : 1);
}

class FailingAllocations {
  public:
    explicit FailingAllocations(int after) { allocationsLeft = after; }
    ~FailingAllocations() { allocationsLeft = -1; }
};

}  // namespace

void* operator new(size_t size, const std::nothrow_t&) noexcept {
    return nothrowAllocate(size);
}
void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    return nothrowAllocate(size);
}
void operator delete(void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}
void operator delete[](void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}
void* operator new(size_t size) {
    if (void* p = std::malloc(size != 0 ? size : 1)) return p;
    throw std::bad_alloc();
}
void* operator new[](size_t size) {
    return operator new(size);
}
void operator delete(void* p) noexcept {
    std::free(p);
}
void operator delete[](void* p) noexcept {
    std::free(p);
}
void operator delete(void* p, size_t) noexcept {
    std::free(p);
}
void operator delete[](void* p, size_t) noexcept {
    std::free(p);
}

namespace {

TEST(AllocationFailure, AppendChangesNothingWhenTheListCannotGrow) {
    FIXFieldList list;
    for (int i = 0; i < FIXFieldList::kGrowth; ++i) ASSERT_NE(list.append(nullptr), nullptr);
    FIXField* extra = new FIXField;
    {
        const FailingAllocations failing(0);
        EXPECT_EQ(list.append(extra), nullptr);
        EXPECT_EQ(list.append(nullptr), nullptr);
    }
    EXPECT_EQ(list.getCount(), FIXFieldList::kGrowth);
    EXPECT_NE(list.getLast(), extra);
    EXPECT_EQ(list.append(extra), extra);  // storage comes back, so does append
}

TEST(AllocationFailure, AppendOfNullFailsWhenTheNodeCannotBeMade) {
    FIXFieldList list;
    const FailingAllocations failing(0);
    EXPECT_EQ(list.append(nullptr), nullptr);
    EXPECT_EQ(list.getCount(), 0);
}

TEST(AllocationFailure, AddChildLeavesTheNodeAsItWas) {
    FIXField group;
    FIXField* child = new FIXField;
    {
        const FailingAllocations failing(0);
        EXPECT_EQ(group.addChild(child), nullptr);
    }
    EXPECT_EQ(group.getChildren(), nullptr);
    EXPECT_EQ(group.addChild(child), child);
}

TEST(AllocationFailure, NewValidatorAnswersNull) {
    {
        const FailingAllocations failing(0);
        EXPECT_EQ(NewValidator(), nullptr);
    }
    KXValidator* v = NewValidator();
    EXPECT_NE(v, nullptr);
    DeleteValidator(v);
}

}  // namespace
