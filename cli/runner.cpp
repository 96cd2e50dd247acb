#include "runner.h"

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <thread>

#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

namespace {

std::string utf8(const KXWString& text) {
    KXString narrow;
    narrow.Assign(text.c_str(), KX_CSET_DEFAULT);
    return narrow.c_str();
}

// Shown as the validator will see it: invalid UTF-8 in a name is replaced.
std::string displayName(const std::string& path) {
    KXWString wide;
    wide.Assign(path.c_str(), KX_CSET_DEFAULT);
    return utf8(wide);
}

FileResult validateOne(KXValidator& validator, const std::string& path) {
    validator.clearErrors();
    KXConnTarget target;
    target.name = path.c_str();
    FileResult result;
    result.source = displayName(path);
    result.result = validator.Validate(target);
    for (int32_t i = 0; i < validator.errorCount(); ++i) {
        const KXValError& e = validator.errorAt(i);
        result.findings.push_back({e.kind, utf8(e.file), utf8(e.message)});
    }
    validator.clearErrors();
    return result;
}

}  // namespace

std::string applyOptions(KXValidator& validator, const ValidatorOptions& options) {
    for (const auto& [name, value] : options) {
        KXWString wideName;
        KXWString wideValue;
        wideName.Assign(name.c_str(), KX_CSET_DEFAULT);
        wideValue.Assign(value.c_str(), KX_CSET_DEFAULT);
        if (validator.SetOption(wideName.c_str(), wideValue.c_str()) != BATCH_OK) return name;
    }
    return {};
}

bool validateFiles(const Plugin& plugin, const ValidatorOptions& options,
                   const std::vector<std::string>& files, int jobs,
                   const std::function<void(const FileResult&)>& done) {
    const size_t workers = std::min(files.size(), static_cast<size_t>(jobs < 1 ? 1 : jobs));
    // Made one after another on this thread; each is then used by one worker only.
    std::vector<Plugin::ValidatorPtr> validators;
    for (size_t i = 0; i < workers; ++i) {
        validators.push_back(plugin.newValidator());
        if (!validators.back()) return false;
        applyOptions(*validators.back(), options);
    }
    if (workers <= 1) {
        for (const std::string& file : files) done(validateOne(*validators[0], file));
        return true;
    }
    std::vector<FileResult> results(files.size());
    std::vector<bool> finished(files.size(), false);
    std::mutex mutex;
    std::condition_variable ready;
    std::atomic<size_t> next{0};
    std::vector<std::thread> threads;
    for (size_t w = 0; w < workers; ++w) {
        threads.emplace_back([&, w] {
            for (size_t i = next++; i < files.size(); i = next++) {
                FileResult result = validateOne(*validators[w], files[i]);
                const std::lock_guard<std::mutex> lock(mutex);
                results[i] = std::move(result);
                finished[i] = true;
                ready.notify_one();
            }
        });
    }
    for (size_t i = 0; i < files.size(); ++i) {
        std::unique_lock<std::mutex> lock(mutex);
        ready.wait(lock, [&] { return finished[i]; });
        FileResult result = std::move(results[i]);
        lock.unlock();
        done(result);
    }
    for (std::thread& t : threads) t.join();
    return true;
}
