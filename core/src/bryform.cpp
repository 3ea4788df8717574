// bryform: formats into rotating per-thread buffers.
#include "bryform.h"

#include <cstdarg>
#include <cstdio>
#include <string>

const char* bryform(const char* format, ...)
{
    thread_local std::string slots[kBryformSlots];
    thread_local int next = 0;
    if (!format)
        return "";

    std::string& out = slots[next];
    next = (next + 1) % kBryformSlots;

    va_list args;
    va_start(args, format);
    va_list measure;
    va_copy(measure, args);
    const int length = std::vsnprintf(nullptr, 0, format, measure);
    va_end(measure);
    if (length < 0) {
        va_end(args);
        out.clear();
        return out.c_str();
    }
    out.assign(static_cast<size_t>(length) + 1, '\0');
    std::vsnprintf(&out[0], out.size(), format, args);
    va_end(args);
    out.resize(static_cast<size_t>(length));
    return out.c_str();
}
