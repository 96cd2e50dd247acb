// The plug-in as a host meets it: loaded at run time, validators from NewValidator.
#include <gtest/gtest.h>

#if defined(_WIN32)
#include <windows.h>
#else
#include <dlfcn.h>
#endif

#include <atomic>
#include <cstdlib>
#include <new>
#include <string>

#include "kxapi/kxvalidator.h"

#if defined(KXVFIX_TEST_MIMALLOC)
static std::atomic<int> hostNews{0};

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

using NewFn = KXValidator*(KX_STDCALL*)();
using DeleteFn = void(KX_STDCALL*)(KXValidator*);

#if defined(_WIN32)
void* openPlugin() {
    return reinterpret_cast<void*>(LoadLibraryA(KXVFIX_PLUGIN_PATH));
}
void* findSymbol(void* library, const char* name) {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(library), name));
}
// Hosts look the entry points up by their decorated standard-call names.
constexpr const char* kNewName = "_NewValidator@0";
constexpr const char* kDeleteName = "_DeleteValidator@4";
#else
void* openPlugin() {
    return dlopen(KXVFIX_PLUGIN_PATH, RTLD_NOW | RTLD_LOCAL);
}
void* findSymbol(void* library, const char* name) {
    return dlsym(library, name);
}
constexpr const char* kNewName = "NewValidator";
constexpr const char* kDeleteName = "DeleteValidator";
#endif

class PluginTest : public ::testing::Test {
  protected:
    static void SetUpTestSuite() {
        handle_ = openPlugin();
        ASSERT_NE(handle_, nullptr) << KXVFIX_PLUGIN_PATH;
        newValidator_ = reinterpret_cast<NewFn>(findSymbol(handle_, kNewName));
        deleteValidator_ = reinterpret_cast<DeleteFn>(findSymbol(handle_, kDeleteName));
        ASSERT_NE(newValidator_, nullptr);
        ASSERT_NE(deleteValidator_, nullptr);
    }
    static std::u16string get(const KXValidator& v, const char16_t* name) {
        KXWString value;
        EXPECT_EQ(v.GetOption(name, value), BATCH_OK);
        return value.c_str();
    }

    static inline void* handle_ = nullptr;
    static inline NewFn newValidator_ = nullptr;
    static inline DeleteFn deleteValidator_ = nullptr;
};

TEST_F(PluginTest, OptionsRoundTripInTableOrderAndValidatorsAreIndependent) {
    KXValidator* v = newValidator_();
    KXValidator* other = newValidator_();
    ASSERT_NE(v, nullptr);
    ASSERT_EQ(v->OptionDefCount(), 2);
    const KXOptionDef* const* defs = v->GetOptionDefs();
    EXPECT_EQ(std::u16string(defs[0]->alternateName().c_str()), u"SchemaFile");
    EXPECT_EQ(std::u16string(defs[1]->name().c_str()), u"Unicode");
    EXPECT_STREQ(defs[1]->defaultValue().c_str(), "False");
    EXPECT_EQ(defs[2], nullptr);
    EXPECT_EQ(get(*v, u"Unicode"), u"False");
    EXPECT_EQ(v->SetOption(u"schemafile", u"/schemas/FIX44.xml"), BATCH_OK);
    EXPECT_EQ(get(*v, u"SchemaFile"), u"/schemas/FIX44.xml");
    EXPECT_EQ(v->SetOption(u"Unicode", u"True"), BATCH_OK);
    EXPECT_EQ(get(*other, u"schemafile"), u"");
    EXPECT_EQ(get(*other, u"Unicode"), u"False");
    deleteValidator_(other);
    int i = 0;  // alternating, so that every setting shows
    for (const char16_t* text : {u"False", u"true", u"yes", u"True", u""}) {
        EXPECT_EQ(v->SetOption(u"Unicode", text), BATCH_OK);
        EXPECT_EQ(get(*v, u"Unicode"), i++ % 2 == 0 ? u"False" : u"True");
    }
    KXWString value;
    EXPECT_EQ(v->SetOption(u"unicode", u"True"), BATCH_UNKNOWN_OPTION);  // names are exact
    EXPECT_EQ(v->GetOption(u"Schema", value), BATCH_UNKNOWN_OPTION);
    deleteValidator_(v);
}

#if defined(_WIN32)
TEST_F(PluginTest, ExportsOnlyTheDecoratedStandardCallNames) {
    for (const char* name : {"NewValidator", "DeleteValidator", "NewValidator@0",
                             "DeleteValidator@4", "_NewValidator", "_DeleteValidator"})
        EXPECT_EQ(findSymbol(handle_, name), nullptr) << name;
}

TEST_F(PluginTest, DeleteValidatorTakesItsArgumentOffTheStack) {
    KXValidator* v = newValidator_();
    ASSERT_NE(v, nullptr);
    // Called by hand, so that a caller-cleans convention shows as a stack 4 bytes lower;
    // the stack pointer is put back either way.
    int32_t drift = 0;
    asm volatile(
        "movl %%esp, %%esi\n\t"
        "pushl %1\n\t"
        "call *%2\n\t"
        "movl %%esp, %0\n\t"
        "subl %%esi, %0\n\t"
        "movl %%esi, %%esp"
        : "=r"(drift)
        : "r"(v), "r"(deleteValidator_)
        : "esi", "eax", "ecx", "edx", "memory", "cc");
    EXPECT_EQ(drift, 0);
}
#endif

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
