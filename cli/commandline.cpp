#include "commandline.h"

#include <cstdlib>
#include <cstring>

namespace {

// Splits "--name=value" so both spellings of a long option with a value work.
bool takesValue(const std::string& arg, const char* shortName, const char* longName,
                std::string& inlineValue) {
    if (arg == shortName || arg == longName) return true;
    const size_t n = std::strlen(longName);
    if (arg.compare(0, n, longName) == 0 && arg.size() > n && arg[n] == '=') {
        inlineValue = arg.substr(n + 1);
        return true;
    }
    return false;
}

}  // namespace

const char* usageText() {
    return "usage: kxvalidate [options] FILE...\n"
           "Validates FIX tag=value files against a schema specification.\n"
           "\n"
           "  -s, --schema FILE        schema specification (default: bundled FIX 4.4)\n"
           "  -u, --unicode            the files are UTF-16 encoded\n"
           "  -o, --option NAME=VALUE  set any validator option by name (repeatable)\n"
           "  -j, --jobs N             validate N files at once (default 1)\n"
           "      --plugin PATH        validator plug-in library to load\n"
           "      --format text|json   output format (default text)\n"
           "  -q, --quiet              print only the summary\n"
           "  -h, --help               show this help\n"
           "      --version            show the version\n"
           "\n"
           "Exit status: 0 no findings, 1 findings, 2 a file was not validated or usage error.\n";
}

ParseResult parseCommandLine(int argc, const char* const* argv, CommandLine& out) {
    ParseResult result;
    auto fail = [&result](std::string message) {
        result.action = ParseResult::UsageError;
        result.error = std::move(message);
        return result;
    };
    bool onlyFiles = false;
    for (int i = 1; i < argc; ++i) {
        const std::string arg = argv[i];
        if (onlyFiles || arg.empty() || arg[0] != '-' || arg == "-") {
            out.files.push_back(arg);
            continue;
        }
        if (arg == "--") {
            onlyFiles = true;
            continue;
        }
        if (arg == "-h" || arg == "--help") {
            result.action = ParseResult::Help;
            return result;
        }
        if (arg == "--version") {
            result.action = ParseResult::Version;
            return result;
        }
        if (arg == "-u" || arg == "--unicode") {
            out.unicode = true;
            continue;
        }
        if (arg == "-q" || arg == "--quiet") {
            out.quiet = true;
            continue;
        }
        std::string value;
        const char* name = nullptr;
        for (const auto& [shortName, longName] :
             {std::pair{"-s", "--schema"}, std::pair{"-o", "--option"}, std::pair{"-j", "--jobs"},
              std::pair{"", "--plugin"}, std::pair{"", "--format"}}) {
            if (takesValue(arg, shortName, longName, value)) name = longName;
        }
        if (name == nullptr) return fail("unknown option " + arg);
        if (value.empty() && arg.find('=') == std::string::npos) {
            if (i + 1 >= argc) return fail(std::string("option ") + arg + " needs a value");
            value = argv[++i];
        }
        const std::string option = name;
        if (option == "--schema") {
            out.schema = value;
        } else if (option == "--plugin") {
            out.plugin = value;
        } else if (option == "--format") {
            if (value == "text") {
                out.format = OutputFormat::Text;
            } else if (value == "json") {
                out.format = OutputFormat::Json;
            } else {
                return fail("--format takes text or json, not " + value);
            }
        } else if (option == "--jobs") {
            char* end = nullptr;
            const long jobs = std::strtol(value.c_str(), &end, 10);
            if (end == value.c_str() || *end != 0 || jobs < 1 || jobs > 256)
                return fail("--jobs takes a number from 1 to 256, not " + value);
            out.jobs = static_cast<int>(jobs);
        } else {
            const size_t eq = value.find('=');
            if (eq == std::string::npos || eq == 0)
                return fail("--option takes NAME=VALUE, not " + value);
            out.options.emplace_back(value.substr(0, eq), value.substr(eq + 1));
        }
    }
    if (out.files.empty()) return fail("no file to validate");
    return result;
}
