// The walk is the hot loop: once every distinct tag has been met, reading more fields
// must not allocate.
#include <cstdlib>
#include <new>

#include "checkharness.h"

namespace {

int64_t allocations = 0;

int64_t allocationsOfWalk(int messages) {
    Schema schema;
    std::string source;
    for (int i = 0; i < messages; ++i)
        source += sealed("8=FIX.4.4|9=60|35=D|11=O-1|78=1|79=Y|81=a|100=2|77=1|76=X|77=1|76=Y|");
    Session s(source);
    const int64_t before = allocations;
    EXPECT_EQ(s.parseFile(schema.map), (Walk{BATCH_OK, {}}));
    return allocations - before;
}

TEST(SteadyState, MoreMessagesCostNoMoreAllocations) {
    EXPECT_EQ(allocationsOfWalk(500), allocationsOfWalk(1));
}

}  // namespace

// Every form the walk or the library may use, so that each allocation is counted and each
// release matches it, under the sanitizers too.
void* operator new(size_t size) {
    ++allocations;
    if (void* p = std::malloc(size != 0 ? size : 1)) return p;
    throw std::bad_alloc();
}
void* operator new[](size_t size) {
    return operator new(size);
}
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    ++allocations;
    return std::malloc(size != 0 ? size : 1);
}
void* operator new[](size_t size, const std::nothrow_t& tag) noexcept {
    return operator new(size, tag);
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
void operator delete(void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}
void operator delete[](void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}
