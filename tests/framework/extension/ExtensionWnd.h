// ExtensionWnd.h - a window class exported by a framework extension library
// (the test library afx_test_extension.dll), deriving from CWnd in another
// module and chaining its message map to CWnd's.
#ifndef TAVO_TESTS_FRAMEWORK_EXTENSION_WND_H
#define TAVO_TESTS_FRAMEWORK_EXTENSION_WND_H

#include <afxwin.h>

class AFX_EXT_CLASS CExtensionWnd : public CWnd {
public:
  CExtensionWnd() = default;
  ~CExtensionWnd() override = default;

  // A child window of the framework's default class.
  BOOL CreateChild(CWnd* pParent, UINT nID);

  // The registered message this class handles.
  static UINT GetPingMessage();

  int m_createCount = 0;
  LPARAM m_lastPing = 0;

protected:
  afx_msg int OnCreate(LPCREATESTRUCT lpCreateStruct);
  afx_msg LRESULT OnPing(WPARAM wParam, LPARAM lParam);

  DECLARE_MESSAGE_MAP()
};

// Whether the library's entry point has run its process attach.
AFX_EXT_API BOOL ExtensionLibraryAttached();

#endif
