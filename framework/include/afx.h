// afx.h - the core of the application framework (MFC 8.0 compatible subset).
//
// Classes: CObject, CString, CException, CSimpleException, CResourceException,
// CPoint, CSize, CRect (through <atltypes.h>-style inline classes below).
// Also: the export macros (AFX_EXT_CLASS), AFX_EXTENSION_MODULE and the
// global helpers of the framework (AfxGetApp lives in <afxwin.h>).
//
// The framework is built as afx.dll. Text is 8-bit throughout: TCHAR is char,
// so the project never defines UNICODE.
#ifndef TAVO_FRAMEWORK_AFX_H
#define TAVO_FRAMEWORK_AFX_H

#if defined(UNICODE) || defined(_UNICODE)
#error "The framework layer is 8-bit: build without UNICODE."
#endif

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
#include <commdlg.h>

// The packed, signed coordinates of a mouse message (as <windowsx.h> has
// them; that header's function-like macros would clash with member names).
#ifndef GET_X_LPARAM
#define GET_X_LPARAM(lp) static_cast<int>(static_cast<short>(LOWORD(lp)))
#endif
#ifndef GET_Y_LPARAM
#define GET_Y_LPARAM(lp) static_cast<int>(static_cast<short>(HIWORD(lp)))
#endif

#include <cstdarg>
#include <string>

// ---------------------------------------------------------------------------
// Linkage
// ---------------------------------------------------------------------------

// Classes and functions of afx.dll. _AFX_FRAMEWORK_BUILD is defined only while
// afx.dll itself is compiled.
#ifdef _AFX_FRAMEWORK_BUILD
#define AFX_FRAMEWORK_CLASS __declspec(dllexport)
#define AFX_FRAMEWORK_API __declspec(dllexport)
#else
#define AFX_FRAMEWORK_CLASS __declspec(dllimport)
#define AFX_FRAMEWORK_API __declspec(dllimport)
#endif

// Classes of a framework extension library: exported while that library is
// built (it defines _AFXEXT), imported by its users.
#ifndef AFX_EXT_CLASS
#ifdef _AFXEXT
#define AFX_EXT_CLASS __declspec(dllexport)
#define AFX_EXT_API __declspec(dllexport)
#define AFX_EXT_DATA __declspec(dllexport)
#else
#define AFX_EXT_CLASS __declspec(dllimport)
#define AFX_EXT_API __declspec(dllimport)
#define AFX_EXT_DATA __declspec(dllimport)
#endif
#endif

#ifndef AFXAPI
#define AFXAPI __stdcall
#endif
#ifndef AFX_CDECL
#define AFX_CDECL __cdecl
#endif
#ifndef AFX_NOVTABLE
#define AFX_NOVTABLE
#endif
#ifndef afx_msg
#define afx_msg
#endif
#ifndef AFX_MSG_CALL
#define AFX_MSG_CALL
#endif

#ifndef ASSERT
#define ASSERT(f) ((void)0)
#endif
#ifndef VERIFY
#define VERIFY(f) ((void)(f))
#endif
#ifndef TRACE
#define TRACE(...) ((void)0)
#endif
#ifndef UNUSED_ALWAYS
#define UNUSED_ALWAYS(x) (void)(x)
#endif

// GetSafeHwnd, GetSafeHdc and GetSafeHandle may be called through a null
// pointer, as the framework allows; reading `this` back through a volatile
// keeps the compiler from assuming that it is never null.
template <class T>
inline const T* AfxNullableThis(const T* p) noexcept
{
    const T* volatile q = p;
    return q;
}

// ---------------------------------------------------------------------------
// Geometry: CSize, CPoint, CRect (inline, as the framework's ATL types are)
// ---------------------------------------------------------------------------

class CPoint;
class CRect;

class CSize : public tagSIZE {
public:
    CSize() noexcept
    {
        cx = 0;
        cy = 0;
    }
    CSize(int initCX, int initCY) noexcept
    {
        cx = initCX;
        cy = initCY;
    }
    CSize(SIZE initSize) noexcept
    {
        cx = initSize.cx;
        cy = initSize.cy;
    }
    CSize(POINT initPt) noexcept
    {
        cx = initPt.x;
        cy = initPt.y;
    }
    CSize(DWORD dwSize) noexcept
    {
        cx = (short)LOWORD(dwSize);
        cy = (short)HIWORD(dwSize);
    }

    BOOL operator==(SIZE size) const noexcept { return cx == size.cx && cy == size.cy; }
    BOOL operator!=(SIZE size) const noexcept { return !(*this == size); }
    void operator+=(SIZE size) noexcept
    {
        cx += size.cx;
        cy += size.cy;
    }
    void operator-=(SIZE size) noexcept
    {
        cx -= size.cx;
        cy -= size.cy;
    }
    void SetSize(int width, int height) noexcept
    {
        cx = width;
        cy = height;
    }

    CSize operator+(SIZE size) const noexcept { return CSize(cx + size.cx, cy + size.cy); }
    CSize operator-(SIZE size) const noexcept { return CSize(cx - size.cx, cy - size.cy); }
    CSize operator-() const noexcept { return CSize(-cx, -cy); }
    inline CPoint operator+(POINT point) const noexcept;
    inline CPoint operator-(POINT point) const noexcept;
};

class CPoint : public tagPOINT {
public:
    CPoint() noexcept
    {
        x = 0;
        y = 0;
    }
    CPoint(int initX, int initY) noexcept
    {
        x = initX;
        y = initY;
    }
    CPoint(POINT initPt) noexcept
    {
        x = initPt.x;
        y = initPt.y;
    }
    CPoint(SIZE initSize) noexcept
    {
        x = initSize.cx;
        y = initSize.cy;
    }
    // The packed coordinates of a mouse message: signed 16-bit x and y.
    CPoint(LPARAM dwPoint) noexcept
    {
        x = GET_X_LPARAM(dwPoint);
        y = GET_Y_LPARAM(dwPoint);
    }

    void Offset(int xOffset, int yOffset) noexcept
    {
        x += xOffset;
        y += yOffset;
    }
    void Offset(POINT point) noexcept { Offset(point.x, point.y); }
    void Offset(SIZE size) noexcept { Offset(size.cx, size.cy); }
    void SetPoint(int X, int Y) noexcept
    {
        x = X;
        y = Y;
    }

    BOOL operator==(POINT point) const noexcept { return x == point.x && y == point.y; }
    BOOL operator!=(POINT point) const noexcept { return !(*this == point); }
    void operator+=(SIZE size) noexcept { Offset(size); }
    void operator-=(SIZE size) noexcept { Offset(-size.cx, -size.cy); }
    void operator+=(POINT point) noexcept { Offset(point); }
    void operator-=(POINT point) noexcept { Offset(-point.x, -point.y); }

    CPoint operator+(SIZE size) const noexcept { return CPoint(x + size.cx, y + size.cy); }
    CPoint operator-(SIZE size) const noexcept { return CPoint(x - size.cx, y - size.cy); }
    CPoint operator-() const noexcept { return CPoint(-x, -y); }
    CPoint operator+(POINT point) const noexcept { return CPoint(x + point.x, y + point.y); }
    CSize operator-(POINT point) const noexcept { return CSize(x - point.x, y - point.y); }
};

inline CPoint CSize::operator+(POINT point) const noexcept { return CPoint(cx + point.x, cy + point.y); }
inline CPoint CSize::operator-(POINT point) const noexcept { return CPoint(cx - point.x, cy - point.y); }

class CRect : public tagRECT {
public:
    CRect() noexcept { left = top = right = bottom = 0; }
    CRect(int l, int t, int r, int b) noexcept
    {
        left = l;
        top = t;
        right = r;
        bottom = b;
    }
    CRect(const RECT& srcRect) noexcept { ::CopyRect(this, &srcRect); }
    CRect(LPCRECT lpSrcRect) noexcept { ::CopyRect(this, lpSrcRect); }
    CRect(POINT point, SIZE size) noexcept
    {
        left = point.x;
        top = point.y;
        right = left + size.cx;
        bottom = top + size.cy;
    }
    CRect(POINT topLeft, POINT bottomRight) noexcept
    {
        left = topLeft.x;
        top = topLeft.y;
        right = bottomRight.x;
        bottom = bottomRight.y;
    }

    int Width() const noexcept { return right - left; }
    int Height() const noexcept { return bottom - top; }
    CSize Size() const noexcept { return CSize(Width(), Height()); }
    // TopLeft and BottomRight view the two corners in place, as the
    // framework's do (a RECT is two POINTs in a row).
    CPoint& TopLeft() noexcept { return *reinterpret_cast<CPoint*>(this); }
    CPoint& BottomRight() noexcept { return *(reinterpret_cast<CPoint*>(this) + 1); }
    const CPoint& TopLeft() const noexcept { return *reinterpret_cast<const CPoint*>(this); }
    const CPoint& BottomRight() const noexcept { return *(reinterpret_cast<const CPoint*>(this) + 1); }
    CPoint CenterPoint() const noexcept { return CPoint((left + right) / 2, (top + bottom) / 2); }

    operator LPRECT() noexcept { return this; }
    operator LPCRECT() const noexcept { return this; }

    BOOL IsRectEmpty() const noexcept { return ::IsRectEmpty(this); }
    BOOL IsRectNull() const noexcept { return left == 0 && right == 0 && top == 0 && bottom == 0; }
    BOOL PtInRect(POINT point) const noexcept { return ::PtInRect(this, point); }

    void SetRect(int x1, int y1, int x2, int y2) noexcept { ::SetRect(this, x1, y1, x2, y2); }
    void SetRect(POINT topLeft, POINT bottomRight) noexcept
    {
        ::SetRect(this, topLeft.x, topLeft.y, bottomRight.x, bottomRight.y);
    }
    void SetRectEmpty() noexcept { ::SetRectEmpty(this); }
    void CopyRect(LPCRECT lpSrcRect) noexcept { ::CopyRect(this, lpSrcRect); }
    BOOL EqualRect(LPCRECT lpRect) const noexcept { return ::EqualRect(this, lpRect); }

    void InflateRect(int x, int y) noexcept { ::InflateRect(this, x, y); }
    void InflateRect(SIZE size) noexcept { ::InflateRect(this, size.cx, size.cy); }
    void InflateRect(LPCRECT lpRect) noexcept
    {
        left -= lpRect->left;
        top -= lpRect->top;
        right += lpRect->right;
        bottom += lpRect->bottom;
    }
    void InflateRect(int l, int t, int r, int b) noexcept
    {
        left -= l;
        top -= t;
        right += r;
        bottom += b;
    }
    void DeflateRect(int x, int y) noexcept { ::InflateRect(this, -x, -y); }
    void DeflateRect(SIZE size) noexcept { ::InflateRect(this, -size.cx, -size.cy); }
    void DeflateRect(LPCRECT lpRect) noexcept
    {
        left += lpRect->left;
        top += lpRect->top;
        right -= lpRect->right;
        bottom -= lpRect->bottom;
    }
    void DeflateRect(int l, int t, int r, int b) noexcept
    {
        left += l;
        top += t;
        right -= r;
        bottom -= b;
    }

    void OffsetRect(int x, int y) noexcept { ::OffsetRect(this, x, y); }
    void OffsetRect(POINT point) noexcept { ::OffsetRect(this, point.x, point.y); }
    void OffsetRect(SIZE size) noexcept { ::OffsetRect(this, size.cx, size.cy); }
    void MoveToXY(int x, int y) noexcept { OffsetRect(x - left, y - top); }
    void MoveToXY(POINT point) noexcept { MoveToXY(point.x, point.y); }

    void NormalizeRect() noexcept
    {
        if (left > right) {
            const int t = left;
            left = right;
            right = t;
        }
        if (top > bottom) {
            const int t = top;
            top = bottom;
            bottom = t;
        }
    }
    BOOL IntersectRect(LPCRECT lpRect1, LPCRECT lpRect2) noexcept { return ::IntersectRect(this, lpRect1, lpRect2); }
    BOOL UnionRect(LPCRECT lpRect1, LPCRECT lpRect2) noexcept { return ::UnionRect(this, lpRect1, lpRect2); }
    BOOL SubtractRect(LPCRECT lpRectSrc1, LPCRECT lpRectSrc2) noexcept
    {
        return ::SubtractRect(this, lpRectSrc1, lpRectSrc2);
    }

    void operator=(const RECT& srcRect) noexcept { ::CopyRect(this, &srcRect); }
    BOOL operator==(const RECT& rect) const noexcept { return ::EqualRect(this, &rect); }
    BOOL operator!=(const RECT& rect) const noexcept { return !::EqualRect(this, &rect); }
    void operator+=(POINT point) noexcept { OffsetRect(point); }
    void operator+=(SIZE size) noexcept { OffsetRect(size); }
    void operator+=(LPCRECT lpRect) noexcept { InflateRect(lpRect); }
    void operator-=(POINT point) noexcept { OffsetRect(-point.x, -point.y); }
    void operator-=(SIZE size) noexcept { OffsetRect(-size.cx, -size.cy); }
    void operator-=(LPCRECT lpRect) noexcept { DeflateRect(lpRect); }
    void operator&=(const RECT& rect) noexcept { ::IntersectRect(this, this, &rect); }
    void operator|=(const RECT& rect) noexcept { ::UnionRect(this, this, &rect); }

    CRect operator+(POINT point) const noexcept
    {
        CRect r(*this);
        r.OffsetRect(point);
        return r;
    }
    CRect operator-(POINT point) const noexcept
    {
        CRect r(*this);
        r.OffsetRect(-point.x, -point.y);
        return r;
    }
    CRect operator+(SIZE size) const noexcept
    {
        CRect r(*this);
        r.OffsetRect(size);
        return r;
    }
    CRect operator-(SIZE size) const noexcept
    {
        CRect r(*this);
        r.OffsetRect(-size.cx, -size.cy);
        return r;
    }
    CRect operator+(LPCRECT lpRect) const noexcept
    {
        CRect r(*this);
        r.InflateRect(lpRect);
        return r;
    }
    CRect operator-(LPCRECT lpRect) const noexcept
    {
        CRect r(*this);
        r.DeflateRect(lpRect);
        return r;
    }
    CRect operator&(const RECT& rect2) const noexcept
    {
        CRect r;
        ::IntersectRect(&r, this, &rect2);
        return r;
    }
    CRect operator|(const RECT& rect2) const noexcept
    {
        CRect r;
        ::UnionRect(&r, this, &rect2);
        return r;
    }
};

// ---------------------------------------------------------------------------
// CObject
// ---------------------------------------------------------------------------

// The root of the framework's class tree. Objects are not copyable.
class AFX_FRAMEWORK_CLASS CObject {
public:
    virtual ~CObject() = default;
    CObject(const CObject&) = delete;
    CObject& operator=(const CObject&) = delete;

protected:
    CObject() = default;
};

// ---------------------------------------------------------------------------
// CString: the framework's 8-bit string
// ---------------------------------------------------------------------------

class AFX_FRAMEWORK_CLASS CString {
public:
    CString() = default;
    CString(const CString& stringSrc) = default;
    CString(CString&& stringSrc) noexcept = default;
    // A null pointer gives the empty string; a resource id made with
    // MAKEINTRESOURCE loads that string, as the framework's constructor does.
    CString(LPCSTR lpsz);
    CString(LPCSTR lpch, int nLength);
    CString(char ch, int nRepeat = 1);
    ~CString() = default;

    CString& operator=(const CString& stringSrc) = default;
    CString& operator=(CString&& stringSrc) noexcept = default;
    CString& operator=(LPCSTR lpsz);
    CString& operator=(char ch);

    // Attributes
    int GetLength() const noexcept { return static_cast<int>(m_text.size()); }
    BOOL IsEmpty() const noexcept { return m_text.empty(); }
    void Empty() noexcept { m_text.clear(); }
    operator LPCSTR() const noexcept { return m_text.c_str(); }
    LPCSTR GetString() const noexcept { return m_text.c_str(); }
    // Out-of-range indices give '\0' (GetAt) or are ignored (SetAt).
    char GetAt(int nIndex) const noexcept;
    char operator[](int nIndex) const noexcept { return GetAt(nIndex); }
    void SetAt(int nIndex, char ch) noexcept;

    // Concatenation
    CString& operator+=(const CString& string);
    CString& operator+=(LPCSTR lpsz);
    CString& operator+=(char ch);
    void Append(LPCSTR lpsz) { *this += lpsz; }
    void AppendChar(char ch) { *this += ch; }
    friend AFX_FRAMEWORK_API CString operator+(const CString& string1, const CString& string2);
    friend AFX_FRAMEWORK_API CString operator+(const CString& string, LPCSTR lpsz);
    friend AFX_FRAMEWORK_API CString operator+(LPCSTR lpsz, const CString& string);
    friend AFX_FRAMEWORK_API CString operator+(const CString& string, char ch);
    friend AFX_FRAMEWORK_API CString operator+(char ch, const CString& string);

    // Comparison (a null pointer compares as the empty string)
    int Compare(LPCSTR lpsz) const noexcept;
    int CompareNoCase(LPCSTR lpsz) const noexcept;
    friend bool operator==(const CString& s1, const CString& s2) noexcept { return s1.m_text == s2.m_text; }
    friend bool operator==(const CString& s1, LPCSTR s2) noexcept { return s1.Compare(s2) == 0; }
    friend bool operator==(LPCSTR s1, const CString& s2) noexcept { return s2.Compare(s1) == 0; }
    friend bool operator!=(const CString& s1, const CString& s2) noexcept { return !(s1 == s2); }
    friend bool operator!=(const CString& s1, LPCSTR s2) noexcept { return !(s1 == s2); }
    friend bool operator!=(LPCSTR s1, const CString& s2) noexcept { return !(s1 == s2); }
    friend bool operator<(const CString& s1, const CString& s2) noexcept { return s1.m_text < s2.m_text; }

    // Extraction: counts and positions outside the string are clamped.
    CString Mid(int nFirst) const;
    CString Mid(int nFirst, int nCount) const;
    CString Left(int nCount) const;
    CString Right(int nCount) const;

    // Searching: the zero-based position, or -1.
    int Find(char ch, int nStart = 0) const noexcept;
    int Find(LPCSTR lpszSub, int nStart = 0) const noexcept;
    int ReverseFind(char ch) const noexcept;

    // Changing
    CString& MakeUpper();
    CString& MakeLower();
    int Replace(char chOld, char chNew);
    int Replace(LPCSTR lpszOld, LPCSTR lpszNew);
    CString& TrimLeft();
    CString& TrimRight();
    CString& Trim();

    // printf-style formatting; the result replaces the contents. A CString
    // argument for %s is passed as (LPCSTR)text: the compiler refuses the
    // object itself.
    void AFX_CDECL Format(LPCSTR lpszFormat, ...) __attribute__((format(gnu_printf, 2, 3)));
    void FormatV(LPCSTR lpszFormat, va_list argList);
    void AFX_CDECL AppendFormat(LPCSTR lpszFormat, ...) __attribute__((format(gnu_printf, 2, 3)));

    // Loads string nID from the first module of the resource chain that holds
    // it (AfxFindStringResourceHandle). FALSE, and the string unchanged, when
    // no module has it.
    BOOL LoadString(UINT nID);

    // Direct buffer access: the buffer holds at least nMinBufLength characters
    // plus the terminating zero; ReleaseBuffer(-1) takes the length from the
    // first zero character, ReleaseBuffer(n) sets it to n.
    LPSTR GetBuffer(int nMinBufLength);
    LPSTR GetBuffer() { return GetBuffer(0); }
    LPSTR GetBufferSetLength(int nNewLength);
    void ReleaseBuffer(int nNewLength = -1);

private:
    std::string m_text;
};

typedef CString CStringA;

// ---------------------------------------------------------------------------
// Exceptions: thrown as pointers, released with Delete()
// ---------------------------------------------------------------------------

class AFX_FRAMEWORK_CLASS CException : public CObject {
public:
    explicit CException(BOOL bAutoDelete = TRUE) : m_bAutoDelete(bAutoDelete) {}
    // Deletes the exception object if it was allocated on the heap by the
    // thrower (auto-delete), as every framework exception is.
    void Delete();
    virtual BOOL GetErrorMessage(LPSTR lpszError, UINT nMaxError, PUINT pnHelpContext = NULL) const;

protected:
    BOOL m_bAutoDelete = TRUE;
};

class AFX_FRAMEWORK_CLASS CSimpleException : public CException {
public:
    explicit CSimpleException(BOOL bAutoDelete = TRUE) : CException(bAutoDelete) {}
};

// Thrown by AfxThrowResourceException: a Windows resource (a window class, a
// GDI object) could not be created or found.
class AFX_FRAMEWORK_CLASS CResourceException : public CSimpleException {
public:
    CResourceException() : CSimpleException(TRUE) {}
    BOOL GetErrorMessage(LPSTR lpszError, UINT nMaxError, PUINT pnHelpContext = NULL) const override;
};

// Throws a heap-allocated CResourceException*; catch it by pointer and call
// Delete() on it.
[[noreturn]] AFX_FRAMEWORK_API void AFXAPI AfxThrowResourceException();

// ---------------------------------------------------------------------------
// Modules and resources
// ---------------------------------------------------------------------------

class CRuntimeClass;
class COleObjectFactory;

// Describes one extension library; filled by AfxInitExtensionModule.
struct AFX_EXTENSION_MODULE {
    BOOL bInitialized;
    HMODULE hModule;
    HMODULE hResource;
    CRuntimeClass* pFirstSharedClass;
    COleObjectFactory* pFirstSharedFactory;
};

// Fills state for the library hModule (its own resources). A second call for
// an initialised record changes nothing and succeeds.
AFX_FRAMEWORK_API BOOL AFXAPI AfxInitExtensionModule(AFX_EXTENSION_MODULE& state, HMODULE hModule);
// Removes and deletes the chain entries made for state (all of them when
// bAll is TRUE).
AFX_FRAMEWORK_API void AFXAPI AfxTermExtensionModule(AFX_EXTENSION_MODULE& state, BOOL bAll = FALSE);

// The module whose window classes and windows the framework creates, and
// the module searched first for resources. Both default to the executable
// (GetModuleHandle(NULL)) and follow the current CWinApp's m_hInstance.
AFX_FRAMEWORK_API HINSTANCE AFXAPI AfxGetInstanceHandle();
AFX_FRAMEWORK_API HINSTANCE AFXAPI AfxGetResourceHandle();
AFX_FRAMEWORK_API void AFXAPI AfxSetResourceHandle(HINSTANCE hInstResource);

// The module that holds resource lpszName of type lpszType: the resource
// handle first, then every CDynLinkLibrary of the chain, newest first
// (application libraries before system libraries). When no module has it the
// resource handle is returned, so that the caller's load fails there.
AFX_FRAMEWORK_API HINSTANCE AFXAPI AfxFindResourceHandle(LPCSTR lpszName, LPCSTR lpszType);
// The same for string nID, found through the string block that holds it.
AFX_FRAMEWORK_API HINSTANCE AFXAPI AfxFindStringResourceHandle(UINT nID);

#endif // TAVO_FRAMEWORK_AFX_H
