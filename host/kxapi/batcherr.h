// Result and error-kind codes shared by the host and its plug-ins.
#pragma once

#include <cstdint>

enum BATCHERR : int32_t {
    BATCH_OK = 0,
    BATCH_CHECK_FAILED = 4,  // also the code of every logged diagnostic
    BATCH_UNKNOWN_OPTION = 12,
    BATCH_NOT_PERFORMED = 19,
};

enum KXVALERROR : int32_t {
    KXVAL_FIELD_ERROR = 2,  // a field is missing or does not match its pattern
    KXVAL_OTHER_ERROR = 3,
};
