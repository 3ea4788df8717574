// Tavo_DxfReader: splits the text into lines and pairs.
#include "Tavo_DxfReader.h"

#include <cerrno>
#include <cmath>
#include <cstdlib>
#include <cstring>

namespace {

// Longest number text worth parsing: anything longer is not a number a
// drawing holds (and would cost strtod time in proportion to its length).
constexpr size_t kLongestNumberText = 64;

std::string_view Trimmed(std::string_view text)
{
    size_t begin = 0;
    size_t end = text.size();
    while (begin < end && (text[begin] == ' ' || text[begin] == '\t'))
        ++begin;
    while (end > begin && (text[end - 1] == ' ' || text[end - 1] == '\t'))
        --end;
    return text.substr(begin, end - begin);
}

// A copy that strtod and strtoll can read: they need a terminating zero.
bool Terminated(std::string_view text, char (&buffer)[kLongestNumberText + 1])
{
    text = Trimmed(text);
    if (text.empty() || text.size() > kLongestNumberText)
        return false;
    std::memcpy(buffer, text.data(), text.size());
    buffer[text.size()] = '\0';
    return true;
}

} // namespace

bool Tavo_DxfParseInt(std::string_view text, long long& value)
{
    char buffer[kLongestNumberText + 1];
    if (!Terminated(text, buffer))
        return false;
    char* end = nullptr;
    errno = 0;
    const long long number = std::strtoll(buffer, &end, 10);
    if (errno != 0 || end == buffer || *end != '\0')
        return false;
    value = number;
    return true;
}

bool Tavo_DxfParseDouble(std::string_view text, double& value)
{
    char buffer[kLongestNumberText + 1];
    if (!Terminated(text, buffer))
        return false;
    char* end = nullptr;
    const double number = std::strtod(buffer, &end);
    if (end == buffer || *end != '\0' || !std::isfinite(number))
        return false;
    value = number;
    return true;
}

Tavo_DxfReader::Tavo_DxfReader(const char* data, size_t size) : m_data(data), m_size(data ? size : 0)
{
    // A UTF-8 byte order mark before the first code.
    if (m_size >= 3 && std::memcmp(m_data, "\xEF\xBB\xBF", 3) == 0)
        m_position = 3;
}

bool Tavo_DxfReader::NextLine(std::string_view& line)
{
    if (m_position >= m_size)
        return false;
    const size_t begin = m_position;
    size_t end = begin;
    while (end < m_size && m_data[end] != '\n' && m_data[end] != '\r')
        ++end;
    line = std::string_view(m_data + begin, end - begin);
    if (end < m_size && m_data[end] == '\r')
        ++end;
    if (end < m_size && m_data[end] == '\n')
        ++end;
    m_position = end;
    ++m_line;
    return true;
}

bool Tavo_DxfReader::Fail(int line, std::string message)
{
    m_error = std::move(message);
    m_errorLine = line;
    return false;
}

bool Tavo_DxfReader::Next(Tavo_DxfPair& pair)
{
    if (m_hasPushedBack) {
        m_hasPushedBack = false;
        pair = m_pushedBack;
        return true;
    }
    if (!m_error.empty())
        return false;
    std::string_view codeLine;
    if (!NextLine(codeLine))
        return false;
    const int codeLineNumber = m_line;
    long long code = 0;
    if (!Tavo_DxfParseInt(codeLine, code) || code < -32768 || code > 32767)
        return Fail(codeLineNumber, "expected a group code (a number) but found \"" + std::string(Trimmed(codeLine).substr(0, 40)) + "\"");
    std::string_view valueLine;
    if (!NextLine(valueLine))
        return Fail(codeLineNumber, "the file ends after group code " + std::to_string(code) + ", before its value");
    size_t end = valueLine.size();
    while (end > 0 && (valueLine[end - 1] == ' ' || valueLine[end - 1] == '\t'))
        --end;
    pair.code = static_cast<int>(code);
    pair.value = valueLine.substr(0, end);
    pair.line = codeLineNumber;
    return true;
}

void Tavo_DxfReader::PushBack(const Tavo_DxfPair& pair)
{
    m_pushedBack = pair;
    m_hasPushedBack = true;
}
