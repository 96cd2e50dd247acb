// Validators made on several threads at once and run side by side report what they
// report one after another; the XML library's first initialisation is among the races.
#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

#include "fix/kxfixvalidator.h"

namespace {

constexpr int kThreads = 4;

std::vector<std::u16string> reports(KXFIXValidator& v, const char* source) {
    v.SetOption(u"SchemaFile", u"" KXVFIX_SOURCE_DIR "/schemas/FIX44.xml");
    KXConnTarget target;
    target.name = KXString(source);
    std::vector<std::u16string> out;
    out.push_back(std::u16string(1, static_cast<char16_t>(v.Validate(target))));
    for (int32_t i = 0; i < v.errorCount(); ++i) out.push_back(v.errorAt(i).message.c_str());
    return out;
}

TEST(Threads, SideBySideAsOneAfterAnother) {
    const char* sources[] = {KXVFIX_SOURCE_DIR "/examples/faults.fix",
                             KXVFIX_SOURCE_DIR "/examples/executions.fix"};
    std::vector<std::vector<std::u16string>> together(kThreads);
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t)
        threads.emplace_back([&together, &sources, t] {
            KXFIXValidator v;
            together[t] = reports(v, sources[t % 2]);
        });
    for (std::thread& t : threads) t.join();
    for (int t = 0; t < kThreads; ++t) {
        KXFIXValidator v;
        EXPECT_EQ(together[t], reports(v, sources[t % 2])) << "thread " << t;
    }
    EXPECT_GT(together[0].size(), 1U);  // the faulty file has findings to compare
}

}  // namespace
