// exceptions.cpp - CException and the resource exception.
#include <afx.h>

#include <cstring>

namespace {
constexpr const char* kResourceExceptionText = "A required resource was unavailable.";
}

void CException::Delete()
{
    if (m_bAutoDelete)
        delete this;
}

BOOL CException::GetErrorMessage(LPSTR lpszError, UINT nMaxError, PUINT pnHelpContext) const
{
    if (pnHelpContext != NULL)
        *pnHelpContext = 0;
    if (lpszError != NULL && nMaxError > 0)
        *lpszError = '\0';
    return FALSE;
}

BOOL CResourceException::GetErrorMessage(LPSTR lpszError, UINT nMaxError, PUINT pnHelpContext) const
{
    if (pnHelpContext != NULL)
        *pnHelpContext = 0;
    if (lpszError == NULL || nMaxError == 0)
        return FALSE;
    ::lstrcpynA(lpszError, kResourceExceptionText, static_cast<int>(nMaxError));
    return TRUE;
}

void AfxThrowResourceException() { throw new CResourceException(); }
