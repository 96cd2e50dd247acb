// How findings reach the user: text lines or JSON lines, and the closing summary.
#pragma once

#include <cstdint>
#include <ostream>
#include <string>
#include <vector>

#include "commandline.h"

struct Finding {
    int32_t kind;
    std::string file;  // the error's own file: source, schema path or "?"
    std::string message;
};

struct FileResult {
    std::string source;
    int32_t result = 0;
    std::vector<Finding> findings;
};

struct Summary {
    int files = 0;
    int findings = 0;
    int notValidated = 0;
};

const char* kindName(int32_t kind);
// Control characters shown as \xNN, \r, \n, \t; everything else unchanged.
std::string escapeControls(const std::string& text);
std::string jsonString(const std::string& text);

void printFile(std::ostream& out, OutputFormat format, const FileResult& file);
void printSummary(std::ostream& out, OutputFormat format, const Summary& summary);
