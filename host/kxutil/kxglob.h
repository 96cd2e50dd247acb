// Logging, truth values and message translation of the host.
#pragma once

#include <cstdint>

#include "kxapi/batcherr.h"
#include "kxexport.h"

namespace KXGlob {

enum LogLevel : int32_t { kWarning = 2, kError = 4, kFatal = 8 };

// Receives every formatted log line (in character set 0, no line break).
using LogSink = void (*)(int32_t level, BATCHERR code, const char* line, void* context);

// printf-style: %d takes an int32_t, %s a zero-terminated UTF-16 text, %% a percent sign.
KXUTIL_API BATCHERR LogMessage(int32_t level, BATCHERR code, const char* format, ...);
// Replaces the sink (standard error by default); null restores the default. Set it
// before validators run: it is not synchronised with logging threads.
KXUTIL_API void SetLogSink(LogSink sink, void* context);

KXUTIL_API const char* BoolToStr(bool value);
// words: "True.False.true.false" style, true and false words alternating. Answers true
// exactly when text equals one of the true words.
KXUTIL_API bool StrToBool(const char* text, const char* words);

}  // namespace KXGlob

// The text to show for a message; no catalogue is installed, so the message itself.
KXUTIL_API const char* lgettext(const char* text);
