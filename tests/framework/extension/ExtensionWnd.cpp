// ExtensionWnd.cpp - the test extension library: its entry point joins the
// framework's extension-module chain, and CExtensionWnd is a window class
// whose message map chains to CWnd's across the library boundary.
#include "ExtensionWnd.h"

#include <afxdllx.h>

namespace {

constexpr LRESULT kPingAnswer = 0x5A5A;

AFX_EXTENSION_MODULE g_extensionModule = {};
BOOL g_attached = FALSE;

UINT g_pingMessage = ::RegisterWindowMessageA("TavoAfxTestExtensionPing");

}  // namespace

extern "C" BOOL WINAPI DllMain(HINSTANCE hInstance, DWORD dwReason, LPVOID)
{
  if (dwReason == DLL_PROCESS_ATTACH && !g_attached) {
    g_attached = TRUE;
    AfxInitExtensionModule(g_extensionModule, hInstance);
    new CDynLinkLibrary(g_extensionModule);  // owned by the framework's chain
  }
  return TRUE;
}

BOOL ExtensionLibraryAttached() { return g_attached; }

BEGIN_MESSAGE_MAP(CExtensionWnd, CWnd)
  ON_WM_CREATE()
  ON_REGISTERED_MESSAGE(g_pingMessage, &CExtensionWnd::OnPing)
END_MESSAGE_MAP()

BOOL CExtensionWnd::CreateChild(CWnd* pParent, UINT nID)
{
  return Create(NULL, NULL, WS_CHILD | WS_VISIBLE, CRect(0, 0, 50, 40), pParent, nID);
}

UINT CExtensionWnd::GetPingMessage() { return g_pingMessage; }

int CExtensionWnd::OnCreate(LPCREATESTRUCT lpCreateStruct)
{
  ++m_createCount;
  return CWnd::OnCreate(lpCreateStruct);
}

LRESULT CExtensionWnd::OnPing(WPARAM, LPARAM lParam)
{
  m_lastPing = lParam;
  return kPingAnswer;
}
