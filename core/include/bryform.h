// bryform: printf-style formatting into a string the caller uses at once.
//
// The result lives in one of kBryformSlots buffers of the calling thread, used
// in turn: it stays valid until that many further bryform calls on the thread.
// The caller never frees it. A null format gives "".
#pragma once

#include "Tavo_CoreApi.h"

#include <cstdio> // __MINGW_PRINTF_FORMAT: the printf dialect of the runtime

constexpr int kBryformSlots = 8;

TAVO_CORE_API const char* bryform(const char* format, ...) __attribute__((format(__MINGW_PRINTF_FORMAT, 1, 2)));
