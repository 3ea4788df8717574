// string.cpp - CString, the framework's 8-bit string, on std::string.
#include <afx.h>

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <cstring>

namespace {

std::string FromNullable(LPCSTR lpsz) { return lpsz == NULL ? std::string() : std::string(lpsz); }

int ClampIndex(int value, int length) { return std::max(0, std::min(value, length)); }

int Sign(int value) { return value < 0 ? -1 : (value > 0 ? 1 : 0); }

} // namespace

CString::CString(LPCSTR lpsz)
{
    if (lpsz != NULL && IS_INTRESOURCE(lpsz)) {
        LoadString(static_cast<UINT>(reinterpret_cast<UINT_PTR>(lpsz)));
        return;
    }
    m_text = FromNullable(lpsz);
}

CString::CString(LPCSTR lpch, int nLength)
{
    if (lpch != NULL && nLength > 0)
        m_text.assign(lpch, static_cast<size_t>(nLength));
}

CString::CString(char ch, int nRepeat)
{
    if (nRepeat > 0)
        m_text.assign(static_cast<size_t>(nRepeat), ch);
}

CString& CString::operator=(LPCSTR lpsz)
{
    m_text = FromNullable(lpsz);
    return *this;
}

CString& CString::operator=(char ch)
{
    m_text.assign(1, ch);
    return *this;
}

char CString::GetAt(int nIndex) const noexcept
{
    if (nIndex < 0 || nIndex >= GetLength())
        return '\0';
    return m_text[static_cast<size_t>(nIndex)];
}

void CString::SetAt(int nIndex, char ch) noexcept
{
    if (nIndex < 0 || nIndex >= GetLength())
        return;
    m_text[static_cast<size_t>(nIndex)] = ch;
}

CString& CString::operator+=(const CString& string)
{
    m_text += string.m_text;
    return *this;
}

CString& CString::operator+=(LPCSTR lpsz)
{
    if (lpsz != NULL)
        m_text += lpsz;
    return *this;
}

CString& CString::operator+=(char ch)
{
    m_text += ch;
    return *this;
}

CString operator+(const CString& string1, const CString& string2)
{
    CString result(string1);
    result += string2;
    return result;
}

CString operator+(const CString& string, LPCSTR lpsz)
{
    CString result(string);
    result += lpsz;
    return result;
}

CString operator+(LPCSTR lpsz, const CString& string)
{
    CString result(lpsz);
    result += string;
    return result;
}

CString operator+(const CString& string, char ch)
{
    CString result(string);
    result += ch;
    return result;
}

CString operator+(char ch, const CString& string)
{
    CString result(ch);
    result += string;
    return result;
}

int CString::Compare(LPCSTR lpsz) const noexcept { return Sign(std::strcmp(m_text.c_str(), lpsz == NULL ? "" : lpsz)); }

int CString::CompareNoCase(LPCSTR lpsz) const noexcept
{
    return Sign(::lstrcmpiA(m_text.c_str(), lpsz == NULL ? "" : lpsz));
}

CString CString::Mid(int nFirst) const { return Mid(nFirst, GetLength()); }

CString CString::Mid(int nFirst, int nCount) const
{
    const int first = ClampIndex(nFirst, GetLength());
    const int count = ClampIndex(nCount, GetLength() - first);
    return CString(m_text.c_str() + first, count);
}

CString CString::Left(int nCount) const { return Mid(0, nCount); }

CString CString::Right(int nCount) const
{
    const int count = ClampIndex(nCount, GetLength());
    return Mid(GetLength() - count, count);
}

int CString::Find(char ch, int nStart) const noexcept
{
    if (nStart < 0 || nStart >= GetLength())
        return -1;
    const size_t pos = m_text.find(ch, static_cast<size_t>(nStart));
    return pos == std::string::npos ? -1 : static_cast<int>(pos);
}

int CString::Find(LPCSTR lpszSub, int nStart) const noexcept
{
    if (lpszSub == NULL || nStart < 0 || nStart > GetLength())
        return -1;
    const size_t pos = m_text.find(lpszSub, static_cast<size_t>(nStart));
    return pos == std::string::npos ? -1 : static_cast<int>(pos);
}

int CString::ReverseFind(char ch) const noexcept
{
    const size_t pos = m_text.rfind(ch);
    return pos == std::string::npos ? -1 : static_cast<int>(pos);
}

CString& CString::MakeUpper()
{
    std::transform(m_text.begin(), m_text.end(), m_text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return *this;
}

CString& CString::MakeLower()
{
    std::transform(m_text.begin(), m_text.end(), m_text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return *this;
}

int CString::Replace(char chOld, char chNew)
{
    const int count = static_cast<int>(std::count(m_text.begin(), m_text.end(), chOld));
    std::replace(m_text.begin(), m_text.end(), chOld, chNew);
    return count;
}

int CString::Replace(LPCSTR lpszOld, LPCSTR lpszNew)
{
    if (lpszOld == NULL || *lpszOld == '\0')
        return 0;
    const std::string oldText(lpszOld);
    const std::string newText = FromNullable(lpszNew);
    int count = 0;
    for (size_t pos = m_text.find(oldText); pos != std::string::npos;
         pos = m_text.find(oldText, pos + newText.size())) {
        m_text.replace(pos, oldText.size(), newText);
        ++count;
    }
    return count;
}

CString& CString::TrimLeft()
{
    const auto first = std::find_if(m_text.begin(), m_text.end(), [](unsigned char c) { return !std::isspace(c); });
    m_text.erase(m_text.begin(), first);
    return *this;
}

CString& CString::TrimRight()
{
    const auto last = std::find_if(m_text.rbegin(), m_text.rend(), [](unsigned char c) { return !std::isspace(c); });
    m_text.erase(last.base(), m_text.end());
    return *this;
}

CString& CString::Trim() { return TrimRight().TrimLeft(); }

void CString::Format(LPCSTR lpszFormat, ...)
{
    va_list args;
    va_start(args, lpszFormat);
    FormatV(lpszFormat, args);
    va_end(args);
}

void CString::FormatV(LPCSTR lpszFormat, va_list argList)
{
    m_text.clear();
    if (lpszFormat == NULL)
        return;
    va_list measure;
    va_copy(measure, argList);
    const int length = std::vsnprintf(nullptr, 0, lpszFormat, measure);
    va_end(measure);
    if (length <= 0)
        return;
    m_text.resize(static_cast<size_t>(length) + 1);
    std::vsnprintf(&m_text[0], m_text.size(), lpszFormat, argList);
    m_text.resize(static_cast<size_t>(length));
}

void CString::AppendFormat(LPCSTR lpszFormat, ...)
{
    CString appended;
    va_list args;
    va_start(args, lpszFormat);
    appended.FormatV(lpszFormat, args);
    va_end(args);
    *this += appended;
}

BOOL CString::LoadString(UINT nID)
{
    // With no buffer, LoadStringW hands back the resource's own text, so a
    // string of any length converts in one go.
    const HINSTANCE module = AfxFindStringResourceHandle(nID);
    LPCWSTR resourceText = NULL;
    const int wideLength = ::LoadStringW(module, nID, reinterpret_cast<LPWSTR>(&resourceText), 0);
    if (wideLength <= 0 || resourceText == NULL)
        return FALSE;
    const int length = ::WideCharToMultiByte(CP_ACP, 0, resourceText, wideLength, NULL, 0, NULL, NULL);
    if (length <= 0)
        return FALSE;
    std::string text(static_cast<size_t>(length), '\0');
    ::WideCharToMultiByte(CP_ACP, 0, resourceText, wideLength, &text[0], length, NULL, NULL);
    m_text = std::move(text);
    return TRUE;
}

LPSTR CString::GetBuffer(int nMinBufLength)
{
    if (nMinBufLength > GetLength())
        m_text.resize(static_cast<size_t>(nMinBufLength));
    return &m_text[0];
}

LPSTR CString::GetBufferSetLength(int nNewLength)
{
    m_text.resize(static_cast<size_t>(std::max(nNewLength, 0)));
    return &m_text[0];
}

void CString::ReleaseBuffer(int nNewLength)
{
    if (nNewLength < 0) {
        m_text.resize(std::strlen(m_text.c_str()));
        return;
    }
    m_text.resize(std::min(static_cast<size_t>(nNewLength), m_text.size()));
}
