// Shared by the fuzz targets: a quiet log, the XML library started once, and one scratch
// file per process that each input overwrites (the readers take paths, not buffers).
#pragma once

#include <unistd.h>

#include <xercesc/util/PlatformUtils.hpp>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "kxutil/kxglob.h"

namespace fuzz {

inline void quietLog(int32_t, BATCHERR, const char*, void*) {}

inline void start() {
    KXGlob::SetLogSink(quietLog, nullptr);
    xercesc::XMLPlatformUtils::Initialize();
}

class ScratchFile {
  public:
    explicit ScratchFile(const char* suffix) {
        const char* dir = std::getenv("TMPDIR");
        path_ = std::string(dir != nullptr ? dir : "/tmp") + "/kxvfix-fuzzXXXXXX" + suffix;
        const int fd =
            mkstemps(path_.data(), static_cast<int>(std::char_traits<char>::length(suffix)));
        if (fd < 0) std::abort();
        ::close(fd);
    }
    ~ScratchFile() { std::remove(path_.c_str()); }
    const char* write(const uint8_t* data, size_t size) {
        FILE* f = std::fopen(path_.c_str(), "wb");
        if (f == nullptr || std::fwrite(data, 1, size, f) != size || std::fclose(f) != 0)
            std::abort();
        return path_.c_str();
    }
    std::u16string widePath() const { return std::u16string(path_.begin(), path_.end()); }

  private:
    std::string path_;
};

}  // namespace fuzz
