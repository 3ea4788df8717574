// ViewerFrame: the viewer's main window: a menu bar, the drawing view and a
// status bar. It holds the document the view shows, turns menu commands and
// keys (through its accelerators) into the view's commands, opens, prints
// and exports, and passes live resizing on to the view.
#pragma once

#include "DrawingView.h"
#include "ViewerDocument.h"
#include "ViewerPrinting.h"
#include "ViewerStatusBar.h"

#include <afxwin.h>

#include <memory>
#include <string>

class ViewerFrame : public CWnd {
public:
    static constexpr UINT ViewId = 1;
    static constexpr UINT StatusBarId = 2;

    ViewerFrame();
    ~ViewerFrame() override;

    // Creates the hidden frame at (x, y) with its menu, view and status bar
    // and shows document in it.
    BOOL CreateFrame(std::unique_ptr<ViewerDocument> document, int x, int y, int width, int height);

    // ---- documents -------------------------------------------------------------
    // Opens the drawing file at path and shows it; false, with the reason in
    // error, when it was refused (the shown drawing stays).
    bool OpenFile(const std::string& path, std::string& error);
    void ShowDocument(std::unique_ptr<ViewerDocument> document);
    ViewerDocument* GetDocument() const { return m_document.get(); }

    // ---- printing and export -------------------------------------------------------
    // Print jobs for a printer that writes to a file go to this file (a
    // Windows path) instead of asking for one; empty: ask.
    void SetPrintOutput(const std::string& path) { m_printOutput = path; }
    // Prints through the print dialog and reports the outcome in the status bar.
    ViewerPrinting::Result Print();
    // Writes what the view shows to a PNG file; empty on success, else why not.
    std::string ExportView(const std::string& path);

    DrawingView& GetView() { return m_view; }
    ViewerStatusBar& GetStatusBar() { return m_statusBar; }

    BOOL PreTranslateMessage(MSG* msg) override;

    afx_msg void OnSize(UINT type, int width, int height);
    afx_msg void OnSetFocus(CWnd* oldWindow);
    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    afx_msg LRESULT OnCommandMessage(WPARAM wParam, LPARAM lParam);
    afx_msg LRESULT OnEnterSizeMove(WPARAM wParam, LPARAM lParam);
    afx_msg LRESULT OnExitSizeMove(WPARAM wParam, LPARAM lParam);

protected:
    DECLARE_MESSAGE_MAP()

private:
    void OnFileOpen();
    void OnFileExport();
    void ShowMessage(const std::string& text);
    void UpdateTitle();

    // Declared before the view: the view shows it, so it goes last.
    std::unique_ptr<ViewerDocument> m_document;
    ViewerStatusBar m_statusBar;
    DrawingView m_view;
    HACCEL m_accelerators = nullptr; // owned
    std::string m_printOutput;
};
