// Validates files with validators from the plug-in, one validator per worker.
#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "plugin.h"
#include "report.h"

using ValidatorOptions = std::vector<std::pair<std::string, std::string>>;

// Applies the options in order; the name of the first the validator does not know, or
// empty when all were taken.
std::string applyOptions(KXValidator& validator, const ValidatorOptions& options);

// Validates every file with `jobs` validators at once and hands each result to `done`
// in the order of the files, on the calling thread. False when a validator could not
// be made.
bool validateFiles(const Plugin& plugin, const ValidatorOptions& options,
                   const std::vector<std::string>& files, int jobs,
                   const std::function<void(const FileResult&)>& done);
