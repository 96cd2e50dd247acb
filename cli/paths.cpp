#include "paths.h"

#include <unistd.h>

#include <climits>

#include "paths_config.h"

namespace {

// The directory above the program's bin/, in the build tree as when installed.
std::string installRoot() {
    char buffer[PATH_MAX];
    const ssize_t n = readlink("/proc/self/exe", buffer, sizeof buffer - 1);
    if (n <= 0) return ".";
    std::string path(buffer, static_cast<size_t>(n));
    for (int up = 0; up < 2; ++up) {
        const size_t slash = path.rfind('/');
        if (slash == std::string::npos) return ".";
        path.erase(slash == 0 ? 1 : slash);
    }
    return path;
}

}  // namespace

std::string defaultPluginPath() {
    return installRoot() + "/" KXVFIX_RELATIVE_PLUGIN;
}

std::string defaultSchemaPath() {
    return installRoot() + "/" KXVFIX_RELATIVE_SCHEMA;
}
