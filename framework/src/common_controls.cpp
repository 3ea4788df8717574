// common_controls.cpp - CStatusBarCtrl over the common status bar control:
// each member sends the control one of its messages.
#include <afxcmn.h>

#include <vector>

namespace {

// SB_GETTEXTLENGTH and SB_GETTEXT answer the length in the low word and the
// drawing type in the high word.
int SplitLengthAndType(LRESULT answer, int* pType)
{
    if (pType != NULL)
        *pType = HIWORD(answer);
    return LOWORD(answer);
}

} // namespace

BOOL CStatusBarCtrl::Create(DWORD dwStyle, const RECT& rect, CWnd* pParentWnd, UINT nID)
{
    INITCOMMONCONTROLSEX classes = {sizeof(classes), ICC_BAR_CLASSES};
    ::InitCommonControlsEx(&classes);
    return CWnd::Create(STATUSCLASSNAMEA, NULL, dwStyle, rect, pParentWnd, nID);
}

BOOL CStatusBarCtrl::SetParts(int nParts, int* pWidths)
{
    return static_cast<BOOL>(::SendMessageA(m_hWnd, SB_SETPARTS, nParts, reinterpret_cast<LPARAM>(pWidths)));
}

int CStatusBarCtrl::GetParts(int nParts, int* pParts) const
{
    return static_cast<int>(::SendMessageA(m_hWnd, SB_GETPARTS, nParts, reinterpret_cast<LPARAM>(pParts)));
}

BOOL CStatusBarCtrl::SetText(LPCTSTR lpszText, int nPane, int nType)
{
    return static_cast<BOOL>(
        ::SendMessageA(m_hWnd, SB_SETTEXTA, static_cast<WPARAM>(nPane | nType), reinterpret_cast<LPARAM>(lpszText)));
}

int CStatusBarCtrl::GetTextLength(int nPane, int* pType) const
{
    return SplitLengthAndType(::SendMessageA(m_hWnd, SB_GETTEXTLENGTHA, nPane, 0), pType);
}

CString CStatusBarCtrl::GetText(int nPane, int* pType) const
{
    const int length = GetTextLength(nPane, NULL);
    std::vector<char> buffer(static_cast<size_t>(length) + 1, '\0');
    SplitLengthAndType(::SendMessageA(m_hWnd, SB_GETTEXTA, nPane, reinterpret_cast<LPARAM>(buffer.data())), pType);
    return CString(buffer.data());
}

BOOL CStatusBarCtrl::GetRect(int nPane, LPRECT lpRect) const
{
    return static_cast<BOOL>(::SendMessageA(m_hWnd, SB_GETRECT, nPane, reinterpret_cast<LPARAM>(lpRect)));
}

void CStatusBarCtrl::SetMinHeight(int nMin) { ::SendMessageA(m_hWnd, SB_SETMINHEIGHT, nMin, 0); }

void CStatusBarCtrl::SetSimple(BOOL bSimple) { ::SendMessageA(m_hWnd, SB_SIMPLE, bSimple, 0); }

BOOL CStatusBarCtrl::IsSimple() const { return static_cast<BOOL>(::SendMessageA(m_hWnd, SB_ISSIMPLE, 0, 0)); }
