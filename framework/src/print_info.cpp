// print_info.cpp - CPrintInfo: the record of one print job.
#include <afxext.h>

namespace {
constexpr DWORD kPrintInfoDialogFlags = PD_ALLPAGES | PD_USEDEVMODECOPIES | PD_NOSELECTION;
constexpr UINT kLastPossiblePage = 0xFFFF;
} // namespace

CPrintInfo::CPrintInfo() : m_pPD(new CPrintDialog(FALSE, kPrintInfoDialogFlags))
{
    SetMinPage(1);
    SetMaxPage(kLastPossiblePage);
    m_pPD->m_pd.nFromPage = 1;
    m_pPD->m_pd.nToPage = static_cast<WORD>(kLastPossiblePage);
}

CPrintInfo::~CPrintInfo() { delete m_pPD; }

void CPrintInfo::SetMinPage(UINT nMinPage)
{
    if (m_pPD != NULL)
        m_pPD->m_pd.nMinPage = static_cast<WORD>(nMinPage);
}

void CPrintInfo::SetMaxPage(UINT nMaxPage)
{
    if (m_pPD != NULL)
        m_pPD->m_pd.nMaxPage = static_cast<WORD>(nMaxPage);
}

UINT CPrintInfo::GetMinPage() const { return m_pPD == NULL ? 0 : m_pPD->m_pd.nMinPage; }
UINT CPrintInfo::GetMaxPage() const { return m_pPD == NULL ? 0 : m_pPD->m_pd.nMaxPage; }
UINT CPrintInfo::GetFromPage() const { return m_pPD == NULL ? 0 : m_pPD->m_pd.nFromPage; }
UINT CPrintInfo::GetToPage() const { return m_pPD == NULL ? 0 : m_pPD->m_pd.nToPage; }
UINT CPrintInfo::GetOffsetPage() const { return m_nOffsetPage; }
