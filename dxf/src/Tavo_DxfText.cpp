// Decoding DXF strings, their control codes and MTEXT formatting.
#include "Tavo_DxfText.h"

#include <algorithm>
#include <cstdint>

namespace {

constexpr char32_t kReplacement = 0xFFFD;
constexpr char32_t kDegree = 0xB0;
constexpr char32_t kPlusMinus = 0xB1;
constexpr char32_t kDiameter = 0xD8; // shown as the letter O with stroke, the nearest in Windows-1252
constexpr char32_t kHardSpace = 0xA0;
constexpr char32_t kParagraph = 0x2029; // stands for \P until the lines are split

// Windows-1252's characters at 0x80 ... 0x9F (0: none there).
constexpr char16_t kCp1252High[32] = {
    0x20AC,
    0,
    0x201A,
    0x0192,
    0x201E,
    0x2026,
    0x2020,
    0x2021,
    0x02C6,
    0x2030,
    0x0160,
    0x2039,
    0x0152,
    0,
    0x017D,
    0,
    0,
    0x2018,
    0x2019,
    0x201C,
    0x201D,
    0x2022,
    0x2013,
    0x2014,
    0x02DC,
    0x2122,
    0x0161,
    0x203A,
    0x0153,
    0,
    0x017E,
    0x0178,
};

// The characters of the raw string: UTF-8 decoded (bad sequences become
// U+FFFD), or Windows-1252 bytes.
std::u32string Decode(std::string_view raw, bool utf8)
{
    std::u32string out;
    out.reserve(raw.size());
    for (size_t i = 0; i < raw.size();) {
        const unsigned char lead = static_cast<unsigned char>(raw[i]);
        if (lead < 0x80 || !utf8) {
            if (lead >= 0x80 && lead <= 0x9F && kCp1252High[lead - 0x80] != 0)
                out.push_back(kCp1252High[lead - 0x80]);
            else
                out.push_back(lead);
            ++i;
            continue;
        }
        int length = lead >= 0xF0 && lead <= 0xF4 ? 4 : lead >= 0xE0 ? 3
            : lead >= 0xC2 && lead <= 0xDF                           ? 2
                                                                     : 0;
        if (lead > 0xF4)
            length = 0;
        char32_t value = length == 2 ? lead & 0x1F : length == 3 ? lead & 0x0F
                                                                 : lead & 0x07;
        bool good = length > 0 && i + length <= raw.size();
        for (int k = 1; good && k < length; ++k) {
            const unsigned char next = static_cast<unsigned char>(raw[i + k]);
            good = (next & 0xC0) == 0x80;
            value = (value << 6) | (next & 0x3F);
        }
        if (!good) {
            out.push_back(kReplacement);
            ++i;
            continue;
        }
        out.push_back(value > 0x10FFFF ? kReplacement : value);
        i += length;
    }
    return out;
}

int HexDigit(char32_t c)
{
    if (c >= '0' && c <= '9')
        return int(c - '0');
    if (c >= 'a' && c <= 'f')
        return int(c - 'a' + 10);
    if (c >= 'A' && c <= 'F')
        return int(c - 'A' + 10);
    return -1;
}

// \U+XXXX at text[i] (i at the backslash): the character and the length.
bool UnicodeEscape(const std::u32string& text, size_t i, char32_t& value, size_t& length)
{
    if (i + 7 > text.size() || (text[i + 1] != 'U' && text[i + 1] != 'u') || text[i + 2] != '+')
        return false;
    value = 0;
    for (size_t k = 3; k < 7; ++k) {
        const int digit = HexDigit(text[i + k]);
        if (digit < 0)
            return false;
        value = value * 16 + char32_t(digit);
    }
    length = 7;
    return true;
}

// %%x control codes at text[i]; false when there is none.
bool ControlCode(const std::u32string& text, size_t i, std::u32string& out, size_t& length)
{
    if (i + 2 >= text.size() || text[i] != '%' || text[i + 1] != '%')
        return false;
    const char32_t code = text[i + 2];
    length = 3;
    switch (code) {
    case 'd':
    case 'D': out.push_back(kDegree); return true;
    case 'p':
    case 'P': out.push_back(kPlusMinus); return true;
    case 'c':
    case 'C': out.push_back(kDiameter); return true;
    case '%': out.push_back('%'); return true;
    case 'u':
    case 'U':
    case 'o':
    case 'O':
    case 'k':
    case 'K': return true; // look switches
    default: break;
    }
    if (code >= '0' && code <= '9') {
        char32_t value = 0;
        size_t k = i + 2;
        while (k < text.size() && k < i + 5 && text[k] >= '0' && text[k] <= '9')
            value = value * 10 + (text[k++] - '0');
        out.push_back(value);
        length = k - i;
        return true;
    }
    return false;
}

// TEXT: control codes and escapes replaced.
std::u32string Expand(const std::u32string& text)
{
    std::u32string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size();) {
        size_t length = 0;
        char32_t value = 0;
        if (text[i] == '\\' && UnicodeEscape(text, i, value, length)) {
            out.push_back(value);
            i += length;
        } else if (ControlCode(text, i, out, length)) {
            i += length;
        } else {
            out.push_back(text[i++]);
        }
    }
    return out;
}

// Index just past the ';' that ends a formatting code starting at i (or the
// end of the text when there is none).
size_t PastSemicolon(const std::u32string& text, size_t i)
{
    while (i < text.size() && text[i] != ';')
        ++i;
    return i < text.size() ? i + 1 : i;
}

// MTEXT: formatting removed, \P as kParagraph.
std::u32string StripFormatting(const std::u32string& text)
{
    std::u32string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size();) {
        const char32_t c = text[i];
        size_t length = 0;
        if (c == '{' || c == '}') {
            ++i;
            continue;
        }
        if (ControlCode(text, i, out, length)) {
            i += length;
            continue;
        }
        if (c != '\\' || i + 1 >= text.size()) {
            out.push_back(c);
            ++i;
            continue;
        }
        char32_t value = 0;
        if (UnicodeEscape(text, i, value, length)) {
            out.push_back(value);
            i += length;
            continue;
        }
        const char32_t code = text[i + 1];
        switch (code) {
        case 'P':
        case 'n':
            out.push_back(kParagraph);
            i += 2;
            break;
        case '~':
            out.push_back(kHardSpace);
            i += 2;
            break;
        case '\\':
        case '{':
        case '}':
            out.push_back(code);
            i += 2;
            break;
        case 'L':
        case 'l':
        case 'O':
        case 'o':
        case 'K':
        case 'k': i += 2; break;
        case 'S': {
            // \Sa^b; \Sa/b; \Sa#b; : a fraction, shown as a/b.
            size_t k = i + 2;
            while (k < text.size() && text[k] != ';') {
                const char32_t s = text[k++];
                out.push_back(s == '^' || s == '#' ? char32_t('/') : s);
            }
            i = k < text.size() ? k + 1 : k;
            break;
        }
        case 'f':
        case 'F':
        case 'H':
        case 'h':
        case 'W':
        case 'w':
        case 'Q':
        case 'q':
        case 'T':
        case 't':
        case 'A':
        case 'a':
        case 'C':
        case 'c':
        case 'p':
            i = PastSemicolon(text, i + 2);
            break;
        case 'M': // \M+nXXXX: a double-byte character of an Asian code page
            i = std::min(text.size(), i + 8);
            out.push_back('?');
            break;
        default:
            out.push_back(code);
            i += 2;
            break;
        }
    }
    return out;
}

std::string ToCp1252(const std::u32string& text, size_t begin, size_t end)
{
    std::string out;
    out.reserve(end - begin);
    for (size_t i = begin; i < end; ++i) {
        const char32_t c = text[i];
        if (c < 0x20 || c == 0x7F) {
            out.push_back(' ');
        } else if (c < 0x80 || (c >= 0xA0 && c <= 0xFF)) {
            out.push_back(static_cast<char>(c));
        } else {
            char mapped = '?';
            for (int k = 0; k < 32; ++k)
                if (kCp1252High[k] != 0 && kCp1252High[k] == c)
                    mapped = static_cast<char>(0x80 + k);
            out.push_back(mapped);
        }
    }
    return out;
}

} // namespace

std::string Tavo_DxfPlainText(std::string_view raw, bool utf8)
{
    const std::u32string text = Expand(Decode(raw, utf8));
    return ToCp1252(text, 0, text.size());
}

std::vector<std::string> Tavo_DxfPlainMText(std::string_view raw, bool utf8)
{
    const std::u32string text = StripFormatting(Decode(raw, utf8));
    std::vector<std::string> lines;
    size_t begin = 0;
    for (size_t i = 0; i <= text.size(); ++i) {
        if (i == text.size() || text[i] == kParagraph) {
            lines.push_back(ToCp1252(text, begin, i));
            begin = i + 1;
        }
    }
    return lines;
}
