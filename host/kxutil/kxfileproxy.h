// Buffered reader of one file. Every character of a source goes through wgetch, and every
// look-ahead is tell + seek, so those stay inline and touch the operating system only
// when the buffer runs out or a seek leaves it.
#pragma once

#include <cstdint>

#include "kxexport.h"
#include "kxutil/kxcset.h"

class KXUTIL_API KXFileProxy {
  public:
    static constexpr char16_t kEndOfData = 0xFFFF;
    static constexpr int32_t kDefaultBufferSize = 16384;

    KXFileProxy();
    // A copy reads the same file through its own descriptor, from the same position;
    // closing either never affects the other.
    KXFileProxy(const KXFileProxy& other);
    KXFileProxy& operator=(const KXFileProxy& other);
    virtual ~KXFileProxy();

    // Modes starting with "r" (such as "rb" and "rbu") are accepted; character sets
    // KX_CSET_BYTE and KX_CSET_UTF16. Directories are refused. -1 on failure, else 0.
    // Opening resets the byte order to least significant byte first.
    int32_t openfile(const char16_t* path, const char* mode, KX_CSET cset);
    int32_t openfile(const char* path, const char* mode, KX_CSET cset);
    int32_t close(bool keepBuffer);
    bool isOpen() const { return fd_ >= 0; }

    void setBufferSize(int32_t bytes);
    // Kept for the host's interface; it does not change how a file is read.
    void setDesignMode(bool on) { designMode_ = on; }
    void setMSBFirst(bool on) { msbFirst_ = on; }

    // The next unit as stored (a byte, or a 16-bit unit in the current byte order);
    // -1 at end of data.
    int32_t getch();
    // The next character; kEndOfData at end of data. In UTF-16 a lone last byte is
    // not a character and reads as end of data.
    char16_t wgetch() {
        if (!hasPutBack_ && bufferLength_ - bufferPos_ >= unitSize_) {
            lastPos_ = bufferStart_ + bufferPos_;
            const unsigned char* p = buffer_ + bufferPos_;
            bufferPos_ += unitSize_;
            if (unitSize_ == 1) return p[0];
            return msbFirst_ ? static_cast<char16_t>(p[0] << 8 | p[1])
                             : static_cast<char16_t>(p[1] << 8 | p[0]);
        }
        return wgetchSlow();
    }
    // Reads characters until stop(c) answers true, and returns that character, which is
    // consumed too; each character before it goes to take(c). kEndOfData when the data
    // ends first. The same as a wgetch loop, but a byte source is walked with its place
    // kept in registers, as the readers of every field need.
    template <typename Stop, typename Take>
    char16_t scan(Stop stop, Take take) {
        for (;;) {
            if (!hasPutBack_ && unitSize_ == 1 && bufferPos_ < bufferLength_) {
                const unsigned char* const start = buffer_ + bufferPos_;
                const unsigned char* const end = buffer_ + bufferLength_;
                const unsigned char* p = start;
                char16_t c = 0;
                bool stopped = false;
                while (p != end) {
                    c = *p++;
                    if ((stopped = stop(c))) break;
                    take(c);
                }
                bufferPos_ = static_cast<int32_t>(p - buffer_);
                lastPos_ = bufferStart_ + bufferPos_ - 1;
                if (stopped) return c;
            }
            const char16_t c = wgetch();
            if (c == kEndOfData || stop(c)) return c;
            take(c);
        }
    }
    // The bytes a byte source delivers next without refilling, for readers that take a
    // run of them in one go: their count, and where they start. None when the next
    // character must come through wgetch (UTF-16, a character given back, the buffer
    // used up); skipBuffered then consumes what was taken.
    int32_t buffered(const unsigned char*& bytes) const {
        if (hasPutBack_ || unitSize_ != 1) return 0;
        bytes = buffer_ + bufferPos_;
        return bufferLength_ - bufferPos_;
    }
    void skipBuffered(int32_t count) {
        bufferPos_ += count;
        lastPos_ = bufferStart_ + bufferPos_ - 1;
    }
    // The next wgetch, getch or read delivers c first.
    void wputBack(char16_t c) {
        putBack_ = c;
        hasPutBack_ = true;
    }

    // Bytes read; negative when the file is not open or reading failed.
    int32_t read(char* buffer, int32_t count);
    // Characters read, at most count, through wgetch.
    int32_t read(char16_t* buffer, int32_t count);

    // Position of the next character, a character given back counting as unread.
    int64_t tell() const { return hasPutBack_ ? lastPos_ : bufferStart_ + bufferPos_; }
    // origin 0: from the start of the file (the only origin). -1 on failure, else 0.
    int32_t seek(int64_t position, int32_t origin) {
        if (origin == 0 && position >= bufferStart_ && position <= bufferStart_ + bufferLength_) {
            hasPutBack_ = false;
            bufferPos_ = static_cast<int32_t>(position - bufferStart_);
            return 0;
        }
        return seekSlow(position, origin);
    }

  private:
    char16_t wgetchSlow();
    int32_t seekSlow(int64_t position, int32_t origin);
    bool refill();
    void resetBuffer(int64_t position);
    void copyFrom(const KXFileProxy& other);

    int32_t fd_ = -1;
    int32_t unitSize_ = 1;
    bool msbFirst_ = false;
    bool designMode_ = false;
    bool hasPutBack_ = false;
    char16_t putBack_ = 0;
    unsigned char* buffer_ = nullptr;
    int32_t bufferSize_ = kDefaultBufferSize;
    int32_t bufferLength_ = 0;  // bytes valid in buffer_
    int32_t bufferPos_ = 0;     // next byte to deliver
    int64_t bufferStart_ = 0;   // file offset of buffer_[0]
    int64_t lastPos_ = 0;       // position of the last unit delivered
};
