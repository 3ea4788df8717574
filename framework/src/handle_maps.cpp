// handle_maps.cpp - the per-thread maps from Windows handles to framework
// objects: Attach/Detach/FromHandle of CWnd, CDC and CGdiObject, and the
// deletion of temporary objects.
#include "afx_internal.h"

using afx_internal::CurrentThreadState;

namespace afx_internal {

namespace {

void ReleaseWindowHandle(CWnd* pWnd) { pWnd->m_hWnd = NULL; }
void ReleaseDcHandles(CDC* pDC) { pDC->m_hDC = pDC->m_hAttribDC = NULL; }
void ReleaseGdiHandle(CGdiObject* pObject) { pObject->m_hObject = NULL; }

// A temporary GDI wrapper of the class that matches the object's type, so
// that CPen::FromHandle and friends return an object of their own class.
CGdiObject* NewTemporaryGdiObject(HGDIOBJ hObject)
{
    switch (::GetObjectType(hObject)) {
    case OBJ_PEN:
    case OBJ_EXTPEN:
        return new CPen;
    case OBJ_BRUSH:
        return new CBrush;
    case OBJ_FONT:
        return new CFont;
    case OBJ_REGION:
        return new CRgn;
    default:
        return new CGdiObject;
    }
}

} // namespace

// The state outlives the thread's other thread-local and static objects:
// windows and DCs held by globals may still reach it while the process
// ends. At thread exit only the temporary objects are deleted.
struct ThreadStateHolder {
    ThreadState* state = new ThreadState;
    ~ThreadStateHolder() { DeleteAllTemporaries(); }
};

ThreadState& CurrentThreadState()
{
    static thread_local ThreadStateHolder holder;
    return *holder.state;
}

void DeleteAllTemporaries()
{
    ThreadState& state = CurrentThreadState();
    state.windows.DeleteTemporaries(ReleaseWindowHandle);
    state.dcs.DeleteTemporaries(ReleaseDcHandles);
    state.gdiObjects.DeleteTemporaries(ReleaseGdiHandle);
}

CGdiObject* GdiObjectFromHandle(HGDIOBJ hObject)
{
    if (hObject == NULL)
        return NULL;
    auto& map = CurrentThreadState().gdiObjects;
    if (CGdiObject* permanent = map.LookupPermanent(hObject))
        return permanent;
    if (CGdiObject* temporary = map.LookupTemporary(hObject))
        return temporary;
    CGdiObject* created = NewTemporaryGdiObject(hObject);
    created->m_hObject = hObject;
    map.AddTemporary(hObject, created);
    return created;
}

} // namespace afx_internal

void AfxLockTempMaps() { ++CurrentThreadState().tempMapLocks; }

BOOL AfxUnlockTempMaps(BOOL bDeleteTemps)
{
    afx_internal::ThreadState& state = CurrentThreadState();
    if (state.tempMapLocks > 0)
        --state.tempMapLocks;
    if (state.tempMapLocks != 0)
        return FALSE;
    if (bDeleteTemps)
        afx_internal::DeleteAllTemporaries();
    return TRUE;
}

// ---------------------------------------------------------------------------
// CWnd
// ---------------------------------------------------------------------------

CWnd* CWnd::FromHandle(HWND hWnd)
{
    if (hWnd == NULL)
        return NULL;
    auto& map = CurrentThreadState().windows;
    if (CWnd* permanent = map.LookupPermanent(hWnd))
        return permanent;
    if (CWnd* temporary = map.LookupTemporary(hWnd)) {
        temporary->m_hWnd = hWnd; // a temporary may have been used to destroy the window
        return temporary;
    }
    CWnd* created = new CWnd;
    created->m_hWnd = hWnd;
    map.AddTemporary(hWnd, created);
    return created;
}

CWnd* CWnd::FromHandlePermanent(HWND hWnd)
{
    if (hWnd == NULL)
        return NULL;
    return CurrentThreadState().windows.LookupPermanent(hWnd);
}

void CWnd::DeleteTempMap() { CurrentThreadState().windows.DeleteTemporaries(afx_internal::ReleaseWindowHandle); }

BOOL CWnd::Attach(HWND hWndNew)
{
    if (hWndNew == NULL || m_hWnd != NULL)
        return FALSE;
    auto& map = CurrentThreadState().windows;
    if (map.LookupPermanent(hWndNew) != NULL)
        return FALSE; // another object has it
    m_hWnd = hWndNew;
    map.SetPermanent(hWndNew, this);
    return TRUE;
}

HWND CWnd::Detach()
{
    const HWND hWnd = m_hWnd;
    if (hWnd != NULL)
        CurrentThreadState().windows.RemovePermanent(hWnd, this);
    m_hWnd = NULL;
    return hWnd;
}

// ---------------------------------------------------------------------------
// CDC
// ---------------------------------------------------------------------------

CDC* CDC::FromHandle(HDC hDC)
{
    if (hDC == NULL)
        return NULL;
    auto& map = CurrentThreadState().dcs;
    if (CDC* permanent = map.LookupPermanent(hDC))
        return permanent;
    if (CDC* temporary = map.LookupTemporary(hDC))
        return temporary;
    CDC* created = new CDC;
    created->m_hDC = created->m_hAttribDC = hDC;
    map.AddTemporary(hDC, created);
    return created;
}

void CDC::DeleteTempMap() { CurrentThreadState().dcs.DeleteTemporaries(afx_internal::ReleaseDcHandles); }

BOOL CDC::Attach(HDC hDC)
{
    if (hDC == NULL || m_hDC != NULL)
        return FALSE;
    m_hDC = hDC;
    CurrentThreadState().dcs.SetPermanent(hDC, this);
    SetAttribDC(hDC);
    return TRUE;
}

HDC CDC::Detach()
{
    const HDC hDC = m_hDC;
    if (hDC != NULL)
        CurrentThreadState().dcs.RemovePermanent(hDC, this);
    ReleaseAttribDC();
    ReleaseOutputDC();
    return hDC;
}

// ---------------------------------------------------------------------------
// CGdiObject
// ---------------------------------------------------------------------------

CGdiObject* CGdiObject::FromHandle(HGDIOBJ hObject) { return afx_internal::GdiObjectFromHandle(hObject); }

void CGdiObject::DeleteTempMap() { CurrentThreadState().gdiObjects.DeleteTemporaries(afx_internal::ReleaseGdiHandle); }

BOOL CGdiObject::Attach(HGDIOBJ hObject)
{
    if (hObject == NULL || m_hObject != NULL)
        return FALSE;
    m_hObject = hObject;
    CurrentThreadState().gdiObjects.SetPermanent(hObject, this);
    return TRUE;
}

HGDIOBJ CGdiObject::Detach()
{
    const HGDIOBJ hObject = m_hObject;
    if (hObject != NULL)
        CurrentThreadState().gdiObjects.RemovePermanent(hObject, this);
    m_hObject = NULL;
    return hObject;
}
