// The walk is the hot loop: once every distinct tag has been met, reading more fields
// must not allocate.
#include <gtest/gtest.h>

#include <cstdlib>
#include <new>
#include <string>

#include "checkharness.h"

namespace {

int64_t allocations = 0;

}  // namespace

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

namespace {

using checks::checkSum;
using checks::Schema;
using checks::Session;
using testutil::fix;

int64_t allocationsOfWalk(int messages) {
    Schema schema;
    schema.field("8", Required, "FIX.4.2|FIX.4.4");
    schema.field("9", Required);
    schema.field("35", Required, "D|F");
    schema.field("11", Required);
    schema.field("10", Required);
    FIXField* parties = schema.group("453", Optional);
    schema.member(parties, "448", Required);
    FIXField* subIds = schema.nestedGroup(parties, "802", Optional);
    schema.member(subIds, "523", Required);
    const std::string body =
        fix("8=FIX.4.4|9=60|35=D|11=ORDER-1|453=2|448=A|802=1|523=X|448=B|802=1|523=Y|");
    std::string source;
    for (int i = 0; i < messages; ++i) source += body + fix("10=" + checkSum(body) + "|");
    Session s(source);
    const int64_t before = allocations;
    const auto walk = s.parseFile(schema.map);
    const int64_t used = allocations - before;
    EXPECT_EQ(walk.findings, std::vector<checks::Finding>{});
    return used;
}

TEST(SteadyState, MoreMessagesCostNoMoreAllocations) {
    EXPECT_EQ(allocationsOfWalk(500), allocationsOfWalk(1));
}

}  // namespace
