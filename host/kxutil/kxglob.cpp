#include "kxutil/kxglob.h"

#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <string>

#include "kxutil/utf.h"

namespace {

struct Sink {
    KXGlob::LogSink sink = nullptr;
    void* context = nullptr;
};
Sink logSink;

void writeToStderr(const char* line) {
    std::fputs(line, stderr);
    std::fputc('\n', stderr);
}

}  // namespace

namespace KXGlob {

BATCHERR LogMessage(int32_t level, BATCHERR code, const char* format, ...) {
    std::string line;
    va_list args;
    va_start(args, format);
    for (const char* p = format != nullptr ? format : ""; *p != 0; ++p) {
        if (*p != '%' || p[1] == 0) {
            line += *p;
            continue;
        }
        switch (*++p) {
            case 'd':
                line += std::to_string(va_arg(args, int32_t));
                break;
            case 's': {
                const auto* text = va_arg(args, const char16_t*);
                if (text == nullptr) text = u"(null)";
                std::string utf8;
                kxutil::fromUtf16(text, std::char_traits<char16_t>::length(text), KX_CSET_DEFAULT,
                                  utf8);
                line += utf8;
                break;
            }
            default:  // %% and anything unknown stand for themselves
                line += *p;
        }
    }
    va_end(args);
    if (logSink.sink != nullptr) {
        logSink.sink(level, code, line.c_str(), logSink.context);
    } else {
        writeToStderr(line.c_str());
    }
    return BATCH_OK;
}

void SetLogSink(LogSink sink, void* context) {
    logSink.sink = sink;
    logSink.context = context;
}

const char* BoolToStr(bool value) {
    return value ? "True" : "False";
}

bool StrToBool(const char* text, const char* words) {
    if (text == nullptr || words == nullptr) return false;
    const size_t length = std::strlen(text);
    bool trueWord = true;
    for (const char* word = words;; trueWord = !trueWord) {
        const char* end = std::strchr(word, '.');
        const size_t n = end != nullptr ? static_cast<size_t>(end - word) : std::strlen(word);
        if (trueWord && n == length && std::strncmp(word, text, n) == 0) return true;
        if (end == nullptr) return false;
        word = end + 1;
    }
}

}  // namespace KXGlob

const char* lgettext(const char* text) {
    return text;
}
