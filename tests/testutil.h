// Helpers shared by the tests: files written for one test and removed after it.
#pragma once

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>

namespace testutil {

// A file under the temporary directory, holding the given bytes, removed on destruction.
class TempFile {
  public:
    explicit TempFile(const std::string& bytes, const std::string& suffix = ".dat") {
        const char* dir = std::getenv("TMPDIR");
        std::string pattern = std::string(dir != nullptr ? dir : "/tmp") + "/kxvfixXXXXXX" + suffix;
        const int fd = mkstemps(pattern.data(), static_cast<int>(suffix.size()));
        if (fd >= 0) ::close(fd);
        path_ = pattern;
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
