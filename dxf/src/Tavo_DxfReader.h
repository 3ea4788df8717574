// Tavo_DxfReader: the group-code pairs of an ASCII DXF text, one at a time.
//
// A DXF file is a sequence of pairs of lines: a group code (an integer,
// possibly padded with spaces) and its value. Lines end in "\n", "\r\n" or a
// lone "\r". The reader hands out each pair with the line number of its code
// line and never copies the text: a value points into the caller's buffer, so
// the buffer must outlive the reader and its pairs.
//
// Errors (Next returns false and Error() says why, with the line): a code line
// that is not an integer in -32768 ... 32767 (group codes are 16-bit), and a
// code line with no value line after it. The plain end of the text is not an
// error: Next returns false and AtEnd() is true.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

struct Tavo_DxfPair {
    int code = 0;
    std::string_view value; // without the line end and trailing spaces
    int line = 0;           // of the code line, 1-based
};

class Tavo_DxfReader {
public:
    Tavo_DxfReader(const char* data, size_t size);

    // The next pair; false at the end of the text or on an error.
    bool Next(Tavo_DxfPair& pair);
    // Hands out the pair given again at the next call of Next.
    void PushBack(const Tavo_DxfPair& pair);

    bool AtEnd() const { return m_error.empty() && m_position >= m_size && !m_hasPushedBack; }
    bool Failed() const { return !m_error.empty(); }
    const std::string& Error() const { return m_error; }
    int ErrorLine() const { return m_errorLine; }
    // The line the reader has reached (the last line read).
    int Line() const { return m_line; }

private:
    // The next line without its end; false at the end of the text.
    bool NextLine(std::string_view& line);
    bool Fail(int line, std::string message);

    const char* m_data;
    size_t m_size;
    size_t m_position = 0;
    int m_line = 0;
    Tavo_DxfPair m_pushedBack;
    bool m_hasPushedBack = false;
    std::string m_error;
    int m_errorLine = 0;
};

// Number parsing of values, strict: the whole value (spaces around it aside)
// must be the number. Doubles must be finite.
bool Tavo_DxfParseInt(std::string_view text, long long& value);
bool Tavo_DxfParseDouble(std::string_view text, double& value);
