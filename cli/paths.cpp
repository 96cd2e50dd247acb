#include "paths.h"

#if defined(_WIN32)
#include <windows.h>

#include <algorithm>

#include "kxutil/kxstring.h"
#else
#include <unistd.h>

#include <climits>
#endif

#include "paths_config.h"

namespace {

#if defined(_WIN32)
constexpr char kSeparator = '\\';

// The program's own path, in the 8-bit character set its arguments come in.
std::string programPath() {
    std::u16string buffer(MAX_PATH, u'\0');
    for (;;) {
        const DWORD n = GetModuleFileNameW(nullptr, reinterpret_cast<wchar_t*>(buffer.data()),
                                           static_cast<DWORD>(buffer.size()));
        if (n == 0) return {};
        if (n < buffer.size()) {
            KXString narrow;
            narrow.Assign(buffer.c_str(), KX_CSET_DEFAULT, static_cast<int32_t>(n));
            return narrow.c_str();
        }
        buffer.resize(buffer.size() * 2);
    }
}

std::string native(std::string path) {
    std::replace(path.begin(), path.end(), '/', kSeparator);
    return path;
}
#else
constexpr char kSeparator = '/';

std::string programPath() {
    char buffer[PATH_MAX];
    const ssize_t n = readlink("/proc/self/exe", buffer, sizeof buffer - 1);
    return n > 0 ? std::string(buffer, static_cast<size_t>(n)) : std::string();
}

std::string native(std::string path) {
    return path;
}
#endif

// The directory above the program's bin/, in the build tree as when installed.
std::string installRoot() {
    std::string path = programPath();
    if (path.empty()) return ".";
    for (int up = 0; up < 2; ++up) {
        const size_t slash = path.rfind(kSeparator);
        if (slash == std::string::npos) return ".";
        path.erase(slash == 0 ? 1 : slash);
    }
    return path;
}

}  // namespace

std::string defaultPluginPath() {
    return installRoot() + kSeparator + native(KXVFIX_RELATIVE_PLUGIN);
}

std::string defaultSchemaPath() {
    return installRoot() + kSeparator + native(KXVFIX_RELATIVE_SCHEMA);
}
