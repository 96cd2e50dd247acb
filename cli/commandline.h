// What the user asked for on the command line.
#pragma once

#include <string>
#include <utility>
#include <vector>

enum class OutputFormat { Text, Json };

struct CommandLine {
    std::string schema;  // empty: the bundled FIX 4.4 schema
    bool unicode = false;
    std::vector<std::pair<std::string, std::string>> options;  // -o NAME=VALUE, in order
    std::string plugin;                                        // empty: the installed plug-in
    OutputFormat format = OutputFormat::Text;
    bool quiet = false;
    int jobs = 1;
    std::vector<std::string> files;
};

struct ParseResult {
    enum Action { Run, Help, Version, UsageError } action = Run;
    std::string error;  // for UsageError
};

ParseResult parseCommandLine(int argc, const char* const* argv, CommandLine& out);
const char* usageText();
