// kxvalidate: validates FIX files with the validator plug-in, as a host would.
#include <cstdio>
#include <iostream>

#include "commandline.h"
#include "paths.h"
#include "paths_config.h"
#include "plugin.h"
#include "runner.h"

namespace {

constexpr int kClean = 0;
constexpr int kFindings = 1;
constexpr int kNotValidated = 2;
constexpr int32_t kResultNotPerformed = BATCH_NOT_PERFORMED;

int usageError(const std::string& message) {
    std::cerr << "kxvalidate: " << message << "\n" << usageText();
    return kNotValidated;
}

}  // namespace

int main(int argc, char** argv) {
    CommandLine cmd;
    const ParseResult parsed = parseCommandLine(argc, argv, cmd);
    switch (parsed.action) {
        case ParseResult::Help:
            std::cout << usageText();
            return kClean;
        case ParseResult::Version:
            std::cout << "kxvalidate " KXVFIX_VERSION "\n";
            return kClean;
        case ParseResult::UsageError:
            return usageError(parsed.error);
        case ParseResult::Run:
            break;
    }

    const Plugin plugin(cmd.plugin.empty() ? defaultPluginPath() : cmd.plugin);
    if (!plugin.error().empty()) {
        std::cerr << "kxvalidate: " << plugin.error() << "\n";
        return kNotValidated;
    }
    ValidatorOptions options{{"SchemaFile", cmd.schema.empty() ? defaultSchemaPath() : cmd.schema}};
    if (cmd.unicode) options.emplace_back("Unicode", "True");
    options.insert(options.end(), cmd.options.begin(), cmd.options.end());
    {
        // Unknown option names are the user's mistake: refuse before any work.
        const Plugin::ValidatorPtr probe = plugin.newValidator();
        if (!probe) {
            std::cerr << "kxvalidate: the plug-in could not make a validator\n";
            return kNotValidated;
        }
        const std::string unknown = applyOptions(*probe, options);
        if (!unknown.empty()) return usageError("the validator has no option " + unknown);
    }

    Summary summary;
    const bool ran = validateFiles(plugin, options, cmd.files, cmd.jobs, [&](const FileResult& r) {
        ++summary.files;
        summary.findings += static_cast<int>(r.findings.size());
        if (r.result == kResultNotPerformed) ++summary.notValidated;
        if (!cmd.quiet) printFile(std::cout, cmd.format, r);
    });
    if (!ran) {
        std::cerr << "kxvalidate: the plug-in could not make a validator\n";
        return kNotValidated;
    }
    printSummary(std::cout, cmd.format, summary);
    std::cout.flush();
    if (summary.notValidated > 0) return kNotValidated;
    return summary.findings > 0 ? kFindings : kClean;
}
