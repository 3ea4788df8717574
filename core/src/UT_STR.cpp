// UT_STR: copying, comparing and converting 8-bit strings.
#include "UT_STR.h"

#include <cctype>
#include <climits>
#include <cstring>

char* UT_STR::Dup(const char* s)
{
    if (!s)
        return nullptr;
    const size_t length = std::strlen(s);
    char* copy = new char[length + 1];
    std::memcpy(copy, s, length + 1);
    return copy;
}

namespace {

template <typename Fold>
int CompareFolded(const char* a, const char* b, Fold fold)
{
    if (!a || !b)
        return (a ? 1 : 0) - (b ? 1 : 0);
    for (;; ++a, ++b) {
        const int ca = fold(static_cast<unsigned char>(*a));
        const int cb = fold(static_cast<unsigned char>(*b));
        if (ca != cb)
            return ca < cb ? -1 : 1;
        if (ca == 0)
            return 0;
    }
}

int AsciiLower(int c)
{
    return c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c;
}

} // namespace

int UT_STR::Compare(const char* a, const char* b)
{
    return CompareFolded(a, b, [](int c) { return c; });
}

int UT_STR::ICompare(const char* a, const char* b)
{
    return CompareFolded(a, b, AsciiLower);
}

int UT_STR::AToI(const char* s)
{
    if (!s)
        return 0;
    while (*s == ' ' || (*s >= '\t' && *s <= '\r'))
        ++s;
    bool negative = false;
    if (*s == '+' || *s == '-')
        negative = *s++ == '-';
    long long value = 0;
    for (; *s >= '0' && *s <= '9'; ++s) {
        value = value * 10 + (*s - '0');
        if (value > static_cast<long long>(INT_MAX) + 1)
            value = static_cast<long long>(INT_MAX) + 1; // saturated; keep reading digits
    }
    if (negative)
        value = -value;
    if (value > INT_MAX)
        return INT_MAX;
    if (value < INT_MIN)
        return INT_MIN;
    return static_cast<int>(value);
}
