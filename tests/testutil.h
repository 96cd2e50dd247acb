// Helpers shared by the tests: files written for one test and removed after it.
#pragma once

#if defined(_WIN32)
#include <windows.h>

#include <atomic>
#else
#include <unistd.h>
#endif

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>

namespace testutil {

#if defined(_WIN32)
// The system's directory for temporary files, with its trailing backslash.
inline std::string temporaryDirectory() {
    char dir[MAX_PATH + 1];
    const DWORD n = GetTempPathA(sizeof dir, dir);
    return n > 0 && n < sizeof dir ? std::string(dir, n) : std::string(".\\");
}

// A name no other test process uses.
inline std::string temporaryName(const std::string& suffix) {
    static std::atomic<unsigned> counter{0};
    return temporaryDirectory() + "kxvfix" + std::to_string(GetCurrentProcessId()) + "-" +
           std::to_string(counter++) + suffix;
}
#else
inline std::string temporaryDirectory() {
    const char* dir = std::getenv("TMPDIR");
    return std::string(dir != nullptr ? dir : "/tmp") + "/";
}

inline std::string temporaryName(const std::string& suffix) {
    std::string pattern = temporaryDirectory() + "kxvfixXXXXXX" + suffix;
    const int fd = mkstemps(pattern.data(), static_cast<int>(suffix.size()));
    if (fd >= 0) ::close(fd);
    return pattern;
}
#endif

// A file under the temporary directory, holding the given bytes, removed on destruction.
class TempFile {
  public:
    explicit TempFile(const std::string& bytes, const std::string& suffix = ".dat")
        : path_(temporaryName(suffix)) {
        std::ofstream(path_, std::ios::binary) << bytes;
    }
    TempFile(const TempFile&) = delete;
    TempFile& operator=(const TempFile&) = delete;
    ~TempFile() { std::remove(path_.c_str()); }

    const std::string& path() const { return path_; }
    const char* c_str() const { return path_.c_str(); }

  private:
    std::string path_;
};
// UTF-16 bytes of ASCII text, least or most significant byte first.
inline std::string utf16(const std::string& text, bool msbFirst) {
    std::string out;
    for (const char c : text) {
        out += msbFirst ? '\0' : c;
        out += msbFirst ? c : '\0';
    }
    return out;
}

// "|" in a readable message stands for the field separator SOH.
inline std::string fix(std::string text) {
    for (char& c : text)
        if (c == '|') c = '\x01';
    return text;
}

}  // namespace testutil
