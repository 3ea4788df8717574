// Tavo_WiDrawWnd: printing. The host application drives the framework's print
// protocol; the window lays out the page grid from what it shows, installs
// the print dialog, turns the current-page choice into a page range and
// prints each page with its header, its corner marks and its part of the
// drawing.
#include "Tavo_WiDrawWnd.h"

#include <afxext.h>

#include "Gui_Msg.h"
#include "Tavo_WiPrintDialog.h"
#include "Tavo_WiPrintMath.h"
#include "Tavo_WiResourceIds.h"

using namespace Tavo_WiPrintMath;

namespace {

// The dialog flags: the current-page choice (the template's selection) is
// offered, and copies are the printer driver's.
constexpr DWORD PrintDialogFlags = PD_SELECTION | PD_USEDEVMODECOPIES;

// The paper of the application's default printer; false when there is no
// printer or no device context for it.
bool FetchDefaultPaper(Paper& paper)
{
    CWinApp* app = AfxGetApp();
    if (!app)
        return false;
    CPrintInfo defaults;
    if (!app->GetPrinterDeviceDefaults(&defaults.m_pPD->m_pd))
        return false;
    HDC hdc = defaults.m_pPD->m_pd.hDC;
    if (!hdc)
        hdc = defaults.m_pPD->CreatePrinterDC();
    if (!hdc)
        return false;
    CDC dc;
    dc.Attach(hdc);
    TEXTMETRICA metrics = {};
    dc.GetTextMetrics(&metrics);
    paper.width = dc.GetDeviceCaps(HORZRES);
    paper.height = dc.GetDeviceCaps(VERTRES);
    paper.textHeight = metrics.tmHeight;
    ::DeleteDC(dc.Detach());
    defaults.m_pPD->m_pd.hDC = nullptr;
    return true;
}

} // namespace

Tavo_WiWin32Surface* Tavo_WiDrawWnd::GetPrintSurface()
{
    return nullptr;
}

void Tavo_WiDrawWnd::OnPreparePrinting(CPrintInfo* info)
{
    if (!info)
        return;
    delete info->m_pPD;
    auto* dialog = new Tavo_WiPrintDialog(FALSE, PrintDialogFlags, nullptr);
    dialog->m_layout = &m_printLayout;
    info->m_pPD = dialog;

    // At the zero level the whole drawing is printed, else what the window shows.
    Tavo_GrWRect area;
    if (m_drawing && m_mapping)
        area = GetZoomLevel() == 0.0 ? m_drawing->GetBounds() : GetWorldClipBox();
    m_printLayout = OnePage(area);
    info->m_nCurPage = 1;
    dialog->m_pd.nMaxPage = 1;
    if (!m_drawing || area.x1 == area.x2 || area.y1 == area.y2)
        return;

    Paper paper;
    if (!FetchDefaultPaper(paper))
        return;
    m_printLayout = LayOutPages(area, m_drawing->GetBounds(), paper);
    info->m_nCurPage = static_cast<UINT>(m_printLayout.m_currentPage);
    dialog->m_pd.nMaxPage = static_cast<WORD>(DialogPageCount(m_printLayout));
}

void Tavo_WiDrawWnd::OnBeginPrinting(CDC*, CPrintInfo* info)
{
    if (!info || !info->m_pPD)
        return;
    PRINTDLG& pd = info->m_pPD->m_pd;
    if (!(pd.Flags & PD_SELECTION))
        return;
    const WORD current = static_cast<WORD>(std::clamp(m_printLayout.m_currentPage, 0, MaxDialogPage));
    pd.nFromPage = current;
    pd.nToPage = current;
}

void Tavo_WiDrawWnd::OnEndPrinting(CDC*, CPrintInfo*) {}

CString Tavo_WiDrawWnd::GetPrintHeader(const Tavo_WiPrintLayout& layout)
{
    // A layout without columns has no grid to name a place in; count one.
    const int columns = std::max(layout.m_numCols, 1);
    const long long index = static_cast<long long>(layout.m_page) - 1;
    return (Gui_Msg(TAVO_WI_IDS_PRINT_HEADER) << layout.m_page << Tavo_GrSaturate(index % columns + 1)
                                              << layout.m_numCols << Tavo_GrSaturate(index / columns + 1)
                                              << layout.m_numRows)
        .GetValue();
}

void Tavo_WiDrawWnd::OnPrint(CDC* dc, CPrintInfo* info)
{
    if (!dc || !info || !m_drawing || !m_mapping || !IsPageOfGrid(m_printLayout, info->m_nCurPage))
        return;
    dc->SetViewportOrg(0, 0);
    m_printLayout.m_page = static_cast<int>(info->m_nCurPage);

    // Capabilities and metrics come from the attribute handle, output goes
    // to the output handle (the framework's CDC does both).
    CRect page(0, 0, dc->GetDeviceCaps(HORZRES), dc->GetDeviceCaps(VERTRES));
    CRgn clip;
    clip.CreateRectRgnIndirect(&page);
    dc->SelectClipRgn(&clip);

    dc->TextOut(0, 0, GetPrintHeader(m_printLayout));

    // Everything else is drawn beneath the header.
    TEXTMETRICA metrics = {};
    dc->GetTextMetrics(&metrics);
    const int hh = HeaderHeight(metrics.tmHeight);
    page.bottom -= hh;
    dc->SetViewportOrg(0, hh);
    dc->IntersectClipRect(&page);

    // Corner marks show where the pages join.
    const int mark = CornerMarkLength(page.Width());
    const int w = page.Width() - 1;
    const int h = page.Height() - 1;
    const POINT corners[4][3] = {{{mark, 0}, {0, 0}, {0, mark}},
                                 {{mark, h}, {0, h}, {0, h - mark}},
                                 {{w - mark, 0}, {w, 0}, {w, mark}},
                                 {{w - mark, h}, {w, h}, {w, h - mark}}};
    for (const auto& corner : corners) {
        dc->MoveTo(corner[0]);
        dc->LineTo(corner[1]);
        dc->LineTo(corner[2]);
    }

    // Without a print surface the page carries only its header and marks.
    Tavo_WiWin32Surface* surface = GetPrintSurface();
    if (!surface)
        return;
    // Binding sets the device context's text alignment and background mode
    // for the surface's pass; the next page's header is drawn with the
    // host's settings again, so they are given back afterwards.
    const int savedDC = dc->SaveDC();
    surface->SetDC(dc->m_hDC);
    const bool savedBlackAndWhite = surface->IsBlackAndWhite();
    const int savedThicken = surface->GetThickenVertLine();
    // True-colour devices, printers included, report -1 colours: they print in colour.
    const int colours = dc->GetDeviceCaps(NUMCOLORS);
    surface->SetBlackAndWhiteFlag(colours >= 0 && colours <= 2);
    surface->SetThickenVertLine(0);

    Tavo_GrMapping pageMapping(*m_mapping);
    pageMapping.SetDeviceWindowSize(page.Width(), page.Height(), true, nullptr);
    pageMapping.SetWorldClipBox(PageBox(m_printLayout, m_printLayout.m_page));
    m_drawing->Draw(*surface, pageMapping, nullptr);

    surface->SetBlackAndWhiteFlag(savedBlackAndWhite);
    surface->SetThickenVertLine(savedThicken);
    dc->RestoreDC(savedDC);
}
