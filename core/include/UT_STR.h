// UT_STR: 8-bit string helpers of the portability library.
//
// Null strings are handled, never dereferenced: Dup(null) is null; a null
// string compares before every other and equal only to another null; AToI(null)
// is 0.
#pragma once

#include "Tavo_CoreApi.h"

class TAVO_CORE_API UT_STR {
public:
    // A heap copy of s, released by its owner with delete[].
    static char* Dup(const char* s);
    // 0 when equal; below 0 when a sorts first, above 0 otherwise.
    static int Compare(const char* a, const char* b);
    // The same, ignoring the case of ASCII letters.
    static int ICompare(const char* a, const char* b);
    // Decimal text to int: leading white space, an optional sign, then digits;
    // the conversion stops at the first other character. No digits give 0; a
    // value beyond the int range is saturated to INT_MIN or INT_MAX.
    static int AToI(const char* s);
};
