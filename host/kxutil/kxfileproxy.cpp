#include "kxutil/kxfileproxy.h"

#include <algorithm>
#include <cerrno>
#include <cstring>

#include "kxutil/kxstring.h"
#include "kxutil/kxwstring.h"

#if defined(_WIN32)
#include <fcntl.h>
#include <io.h>
#include <sys/stat.h>
#include <windows.h>
#else
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#endif

namespace {

constexpr int32_t kMinBufferSize = 2;
constexpr int32_t kMaxBufferSize = 1 << 24;

bool isDirectory(int32_t fd) {
#if defined(_WIN32)
    struct _stat64 st;
    return _fstat64(fd, &st) == 0 && (st.st_mode & _S_IFDIR) != 0;
#else
    struct stat st;
    return fstat(fd, &st) == 0 && S_ISDIR(st.st_mode);
#endif
}

int32_t openReadOnly(const char16_t* path) {
#if defined(_WIN32)
    const int32_t fd =
        _wopen(reinterpret_cast<const wchar_t*>(path), _O_RDONLY | _O_BINARY | _O_NOINHERIT);
#else
    KXString narrow;
    narrow.Assign(path, KX_CSET_DEFAULT);
    const int32_t fd = ::open(narrow.c_str(), O_RDONLY | O_CLOEXEC);
#endif
    if (fd >= 0 && isDirectory(fd)) {
#if defined(_WIN32)
        _close(fd);
#else
        ::close(fd);
#endif
        return -1;
    }
    return fd;
}

// Reads at an absolute offset, so that descriptors shared by copies never race on the
// descriptor's own offset.
int32_t readAt(int32_t fd, unsigned char* buffer, int32_t count, int64_t offset) {
#if defined(_WIN32)
    // A duplicate shares the file pointer, so the offset goes with the read itself.
    const auto handle = reinterpret_cast<HANDLE>(_get_osfhandle(fd));
    if (handle == INVALID_HANDLE_VALUE) return -1;
    OVERLAPPED at{};
    at.Offset = static_cast<DWORD>(offset);
    at.OffsetHigh = static_cast<DWORD>(static_cast<uint64_t>(offset) >> 32);
    DWORD n = 0;
    if (ReadFile(handle, buffer, static_cast<DWORD>(count), &n, &at))
        return static_cast<int32_t>(n);
    return GetLastError() == ERROR_HANDLE_EOF ? 0 : -1;
#else
    for (;;) {
        const ssize_t n = ::pread(fd, buffer, static_cast<size_t>(count), offset);
        if (n >= 0 || errno != EINTR) return static_cast<int32_t>(n);
    }
#endif
}

int32_t duplicate(int32_t fd) {
#if defined(_WIN32)
    return _dup(fd);
#else
    return ::fcntl(fd, F_DUPFD_CLOEXEC, 0);
#endif
}

void closeDescriptor(int32_t fd) {
#if defined(_WIN32)
    _close(fd);
#else
    ::close(fd);
#endif
}

}  // namespace

#if defined(_WIN32)
// An importer that binds a constant to a reference links to the DLL's own definition.
constexpr char16_t KXFileProxy::kEndOfData;
constexpr int32_t KXFileProxy::kDefaultBufferSize;
#endif

KXFileProxy::KXFileProxy() = default;

KXFileProxy::KXFileProxy(const KXFileProxy& other) {
    copyFrom(other);
}

KXFileProxy& KXFileProxy::operator=(const KXFileProxy& other) {
    if (this != &other) {
        close(false);
        copyFrom(other);
    }
    return *this;
}

KXFileProxy::~KXFileProxy() {
    close(false);
    delete[] buffer_;
}

void KXFileProxy::copyFrom(const KXFileProxy& other) {
    fd_ = other.fd_ >= 0 ? duplicate(other.fd_) : -1;
    unitSize_ = other.unitSize_;
    msbFirst_ = other.msbFirst_;
    designMode_ = other.designMode_;
    hasPutBack_ = other.hasPutBack_;
    putBack_ = other.putBack_;
    bufferSize_ = other.bufferSize_;
    bufferLength_ = other.bufferLength_;
    bufferPos_ = other.bufferPos_;
    bufferStart_ = other.bufferStart_;
    lastPos_ = other.lastPos_;
    if (other.buffer_ != nullptr) {
        delete[] buffer_;
        buffer_ = new unsigned char[static_cast<size_t>(bufferSize_)];
        std::memcpy(buffer_, other.buffer_, static_cast<size_t>(bufferLength_));
    }
}

int32_t KXFileProxy::openfile(const char16_t* path, const char* mode, KX_CSET cset) {
    close(true);
    if (path == nullptr || mode == nullptr || mode[0] != 'r') return -1;
    if (cset != KX_CSET_BYTE && cset != KX_CSET_UTF16) return -1;
    fd_ = openReadOnly(path);
    if (fd_ < 0) return -1;
    unitSize_ = cset == KX_CSET_UTF16 ? 2 : 1;
    msbFirst_ = false;
    resetBuffer(0);
    return 0;
}

int32_t KXFileProxy::openfile(const char* path, const char* mode, KX_CSET cset) {
    if (path == nullptr) return -1;
    KXWString wide;
    wide.Assign(path, KX_CSET_DEFAULT);
    return openfile(wide.c_str(), mode, cset);
}

int32_t KXFileProxy::close(bool keepBuffer) {
    if (!keepBuffer) {
        delete[] buffer_;
        buffer_ = nullptr;
    }
    resetBuffer(0);
    if (fd_ < 0) return -1;
    closeDescriptor(fd_);
    fd_ = -1;
    return 0;
}

void KXFileProxy::setBufferSize(int32_t bytes) {
    const int64_t position = bufferStart_ + bufferPos_;
    const bool hadPutBack = hasPutBack_;
    bufferSize_ = std::clamp(bytes, kMinBufferSize, kMaxBufferSize);
    delete[] buffer_;
    buffer_ = nullptr;
    resetBuffer(position);
    hasPutBack_ = hadPutBack;
}

void KXFileProxy::resetBuffer(int64_t position) {
    bufferStart_ = position;
    bufferLength_ = bufferPos_ = 0;
    lastPos_ = position;
    hasPutBack_ = false;
}

bool KXFileProxy::refill() {
    if (fd_ < 0) return false;
    if (buffer_ == nullptr) buffer_ = new unsigned char[static_cast<size_t>(bufferSize_)];
    // Keep the bytes of a unit split by the end of the buffer.
    const int32_t left = bufferLength_ - bufferPos_;
    std::memmove(buffer_, buffer_ + bufferPos_, static_cast<size_t>(left));
    bufferStart_ += bufferPos_;
    bufferPos_ = 0;
    bufferLength_ = left;
    const int32_t n = readAt(fd_, buffer_ + left, bufferSize_ - left, bufferStart_ + left);
    if (n <= 0) return false;
    bufferLength_ += n;
    return true;
}

char16_t KXFileProxy::wgetchSlow() {
    if (hasPutBack_) {
        hasPutBack_ = false;
        return putBack_;
    }
    while (bufferLength_ - bufferPos_ < unitSize_) {
        if (!refill()) {
            lastPos_ = bufferStart_ + bufferPos_;
            return kEndOfData;
        }
    }
    return wgetch();
}

int32_t KXFileProxy::getch() {
    if (hasPutBack_) {
        hasPutBack_ = false;
        return putBack_ == kEndOfData ? -1 : putBack_;
    }
    while (bufferLength_ - bufferPos_ < unitSize_) {
        if (!refill()) {
            lastPos_ = bufferStart_ + bufferPos_;
            return -1;
        }
    }
    return wgetch();
}

int32_t KXFileProxy::read(char* buffer, int32_t count) {
    if (fd_ < 0 || buffer == nullptr || count < 0) return -1;
    int32_t done = 0;
    if (hasPutBack_ && count > 0) {
        hasPutBack_ = false;
        if (unitSize_ == 1 || count < 2) {
            buffer[done++] = static_cast<char>(putBack_);
        } else {
            const auto high = static_cast<char>(putBack_ >> 8);
            const auto low = static_cast<char>(putBack_ & 0xFF);
            buffer[done++] = msbFirst_ ? high : low;
            buffer[done++] = msbFirst_ ? low : high;
        }
    }
    while (done < count) {
        if (bufferPos_ == bufferLength_ && !refill()) break;
        const int32_t n = std::min(count - done, bufferLength_ - bufferPos_);
        std::memcpy(buffer + done, buffer_ + bufferPos_, static_cast<size_t>(n));
        bufferPos_ += n;
        done += n;
    }
    lastPos_ = bufferStart_ + bufferPos_;
    return done;
}

int32_t KXFileProxy::read(char16_t* buffer, int32_t count) {
    if (fd_ < 0 || buffer == nullptr || count < 0) return -1;
    int32_t done = 0;
    while (done < count) {
        const char16_t c = wgetch();
        if (c == kEndOfData) break;
        buffer[done++] = c;
    }
    return done;
}

int32_t KXFileProxy::seekSlow(int64_t position, int32_t origin) {
    if (origin != 0 || position < 0 || fd_ < 0) return -1;
    resetBuffer(position);
    return 0;
}
