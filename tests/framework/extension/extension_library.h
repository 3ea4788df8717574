// extension_library.h - the test extension library afx_test_extension.dll,
// which holds resources that only the framework's extension-module chain
// can find.
#ifndef TAVO_TESTS_FRAMEWORK_EXTENSION_LIBRARY_H
#define TAVO_TESTS_FRAMEWORK_EXTENSION_LIBRARY_H

#include <afxwin.h>

// Whether the library's entry point has run its process attach.
AFX_EXT_API BOOL ExtensionLibraryAttached();

#endif
