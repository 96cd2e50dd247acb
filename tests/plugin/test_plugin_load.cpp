// The plug-in as a host meets it: loaded with dlopen, validators from NewValidator.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <string>

#include "kxapi/kxvalidator.h"
#include "kxutil/kxglob.h"

#if defined(KXVFIX_TEST_MIMALLOC)
namespace {

std::atomic<int> hostNews{0};

}  // namespace

// This host brings its own allocator; the plug-in must neither replace nor use it.
// Only with the plug-in's allocator bound: without it the plug-in would share these.
void* operator new(size_t size) {
    ++hostNews;
    if (void* p = std::malloc(size != 0 ? size : 1)) return p;
    throw std::bad_alloc();
}
void operator delete(void* p) noexcept {
    std::free(p);
}
void operator delete(void* p, size_t) noexcept {
    std::free(p);
}
#endif

namespace {

using NewFn = KXValidator* (*)();
using DeleteFn = void (*)(KXValidator*);

class PluginTest : public ::testing::Test {
  protected:
    static void SetUpTestSuite() {
        handle_ = dlopen(KXVFIX_PLUGIN_PATH, RTLD_NOW | RTLD_LOCAL);
        ASSERT_NE(handle_, nullptr) << dlerror();
        newValidator_ = reinterpret_cast<NewFn>(dlsym(handle_, "NewValidator"));
        deleteValidator_ = reinterpret_cast<DeleteFn>(dlsym(handle_, "DeleteValidator"));
        ASSERT_NE(newValidator_, nullptr);
        ASSERT_NE(deleteValidator_, nullptr);
    }

    static std::u16string get(const KXValidator& v, const char16_t* name) {
        KXWString value;
        EXPECT_EQ(v.GetOption(name, value), BATCH_OK);
        return value.c_str();
    }

    static void* handle_;
    static NewFn newValidator_;
    static DeleteFn deleteValidator_;
};

void* PluginTest::handle_ = nullptr;
NewFn PluginTest::newValidator_ = nullptr;
DeleteFn PluginTest::deleteValidator_ = nullptr;

TEST_F(PluginTest, OptionsRoundTripByEitherName) {
    KXValidator* v = newValidator_();
    ASSERT_NE(v, nullptr);
    EXPECT_EQ(get(*v, u"SchemaFile"), u"");
    EXPECT_EQ(get(*v, u"Unicode"), u"False");
    EXPECT_EQ(v->SetOption(u"schemafile", u"/schemas/FIX44.xml"), BATCH_OK);
    EXPECT_EQ(get(*v, u"SchemaFile"), u"/schemas/FIX44.xml");
    EXPECT_EQ(v->SetOption(u"SchemaFile", u""), BATCH_OK);
    EXPECT_EQ(get(*v, u"schemafile"), u"");
    for (const auto* text : {u"True", u"true"}) {
        v->SetOption(u"Unicode", u"False");
        EXPECT_EQ(v->SetOption(u"Unicode", text), BATCH_OK);
        EXPECT_EQ(get(*v, u"Unicode"), u"True");
    }
    for (const auto* text : {u"False", u"yes", u""}) {
        v->SetOption(u"Unicode", u"True");
        EXPECT_EQ(v->SetOption(u"Unicode", text), BATCH_OK);
        EXPECT_EQ(get(*v, u"Unicode"), u"False");
    }
    KXWString value;
    EXPECT_EQ(v->SetOption(u"unicode", u"True"), BATCH_UNKNOWN_OPTION);
    EXPECT_EQ(v->GetOption(u"Schema", value), BATCH_UNKNOWN_OPTION);
    deleteValidator_(v);
}

TEST_F(PluginTest, OptionTableInItsOrder) {
    KXValidator* v = newValidator_();
    ASSERT_EQ(v->OptionDefCount(), 2);
    const KXOptionDef* const* defs = v->GetOptionDefs();
    EXPECT_EQ(std::u16string(defs[0]->alternateName().c_str()), u"SchemaFile");
    EXPECT_EQ(std::u16string(defs[0]->description().c_str()), u"A Schema Specification File");
    EXPECT_EQ(defs[0]->code(), 5);
    EXPECT_EQ(std::u16string(defs[1]->name().c_str()), u"Unicode");
    EXPECT_STREQ(defs[1]->defaultValue().c_str(), "False");
    EXPECT_EQ(defs[2], nullptr);
    deleteValidator_(v);
    deleteValidator_(nullptr);
}

TEST_F(PluginTest, ValidatorsAreIndependent) {
    KXValidator* a = newValidator_();
    KXValidator* b = newValidator_();
    a->SetOption(u"SchemaFile", u"a.xml");
    EXPECT_EQ(get(*b, u"SchemaFile"), u"");
    deleteValidator_(a);
    EXPECT_EQ(get(*b, u"Unicode"), u"False");
    deleteValidator_(b);
}

#if defined(KXVFIX_TEST_MIMALLOC)
TEST_F(PluginTest, PluginAllocatesFromItsOwnAllocatorOnly) {
    // Asked through the plug-in's dependencies, so this host never links the allocator.
    using InHeapFn = bool (*)(const void*);
    const auto inPluginHeap = reinterpret_cast<InHeapFn>(dlsym(handle_, "mi_is_in_heap_region"));
    ASSERT_NE(inPluginHeap, nullptr);
    deleteValidator_(newValidator_());  // the XML library's first initialisation allocates
    const int before = hostNews.load();
    KXValidator* v = newValidator_();
    // The host libraries allocate through the host (the error list); the validator
    // object itself comes from the plug-in's allocator.
    EXPECT_TRUE(inPluginHeap(v));
    EXPECT_LE(hostNews.load() - before, 1);
    int* own = new int(7);
    EXPECT_FALSE(inPluginHeap(own));
    delete own;
    // The plug-in's operator new is its own, never offered to the process.
    Dl_info info{};
    void* exportedNew = dlsym(handle_, "_Znwm");
    ASSERT_NE(exportedNew, nullptr);
    ASSERT_NE(dladdr(exportedNew, &info), 0);
    EXPECT_EQ(std::string(info.dli_fname).find("libkxvfix"), std::string::npos);
    deleteValidator_(v);
}
#endif

}  // namespace
