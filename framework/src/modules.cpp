// modules.cpp - instance and resource handles, extension libraries and the
// chain of CDynLinkLibrary links that resource lookup searches.
#include <afxwin.h>

#include <mutex>
#include <vector>

namespace {

constexpr UINT kStringsPerBlock = 16; // string resources come in blocks of 16

// The chain is built at library load, possibly on a loader thread, and read
// by the user-interface thread.
std::mutex& ChainMutex()
{
    static std::mutex mutex;
    return mutex;
}

CDynLinkLibrary* g_firstLibrary = NULL; // the chain, newest first; links not owned
HINSTANCE g_resourceHandle = NULL;      // NULL: follow the instance handle

bool HasResource(HINSTANCE hInst, LPCSTR lpszName, LPCSTR lpszType)
{
    return hInst != NULL && ::FindResourceA(hInst, lpszName, lpszType) != NULL;
}

// Whether string nID has text in hInst: its block must exist and hold a
// non-empty entry for it (a block can be shared by strings of other modules).
bool HasString(HINSTANCE hInst, UINT nID)
{
    if (hInst == NULL)
        return false;
    const HRSRC block = ::FindResourceA(hInst, MAKEINTRESOURCEA(nID / kStringsPerBlock + 1), RT_STRING);
    if (block == NULL)
        return false;
    const auto* entry = static_cast<const WORD*>(::LockResource(::LoadResource(hInst, block)));
    if (entry == NULL)
        return false;
    // Each entry is a length followed by that many UTF-16 characters.
    for (UINT index = 0; index < nID % kStringsPerBlock; ++index)
        entry += 1 + *entry;
    return *entry != 0;
}

// The modules of the chain in search order: application libraries, newest
// first, then system libraries. Copied out so that no lock is held while the
// system looks into a module (resource lookup may take the loader's lock,
// which a library being loaded holds while it joins the chain).
std::vector<HMODULE> ChainInSearchOrder()
{
    std::vector<HMODULE> modules;
    std::lock_guard<std::mutex> lock(ChainMutex());
    for (int pass = 0; pass < 2; ++pass) {
        const BOOL wantSystem = pass == 1;
        for (CDynLinkLibrary* link = g_firstLibrary; link != NULL; link = link->m_pNextDLL) {
            if (link->m_bSystem == wantSystem)
                modules.push_back(link->m_hResource);
        }
    }
    return modules;
}

template <class Has>
HINSTANCE FindInChain(Has has)
{
    const HINSTANCE resourceHandle = AfxGetResourceHandle();
    if (has(resourceHandle))
        return resourceHandle;
    for (const HMODULE module : ChainInSearchOrder()) {
        if (has(module))
            return module;
    }
    return resourceHandle;
}

void AddToChain(CDynLinkLibrary* link)
{
    std::lock_guard<std::mutex> lock(ChainMutex());
    link->m_pNextDLL = g_firstLibrary;
    g_firstLibrary = link;
}

void RemoveFromChain(CDynLinkLibrary* link)
{
    std::lock_guard<std::mutex> lock(ChainMutex());
    for (CDynLinkLibrary** next = &g_firstLibrary; *next != NULL; next = &(*next)->m_pNextDLL) {
        if (*next == link) {
            *next = link->m_pNextDLL;
            link->m_pNextDLL = NULL;
            return;
        }
    }
}

} // namespace

HINSTANCE AfxGetInstanceHandle()
{
    const CWinApp* app = AfxGetApp();
    if (app != NULL && app->m_hInstance != NULL)
        return app->m_hInstance;
    return ::GetModuleHandleA(NULL);
}

HINSTANCE AfxGetResourceHandle() { return g_resourceHandle != NULL ? g_resourceHandle : AfxGetInstanceHandle(); }

void AfxSetResourceHandle(HINSTANCE hInstResource) { g_resourceHandle = hInstResource; }

HINSTANCE AfxFindResourceHandle(LPCSTR lpszName, LPCSTR lpszType)
{
    return FindInChain([&](HINSTANCE h) { return HasResource(h, lpszName, lpszType); });
}

HINSTANCE AfxFindStringResourceHandle(UINT nID)
{
    return FindInChain([&](HINSTANCE h) { return HasString(h, nID); });
}

BOOL AfxInitExtensionModule(AFX_EXTENSION_MODULE& state, HMODULE hModule)
{
    if (state.bInitialized)
        return TRUE;
    if (hModule == NULL)
        return FALSE;
    state.hModule = hModule;
    state.hResource = hModule;
    state.pFirstSharedClass = NULL;
    state.pFirstSharedFactory = NULL;
    state.bInitialized = TRUE;
    return TRUE;
}

void AfxTermExtensionModule(AFX_EXTENSION_MODULE& state, BOOL bAll)
{
    if (!state.bInitialized && !bAll)
        return;
    for (;;) {
        CDynLinkLibrary* victim = NULL;
        {
            std::lock_guard<std::mutex> lock(ChainMutex());
            for (CDynLinkLibrary* link = g_firstLibrary; link != NULL; link = link->m_pNextDLL) {
                if (bAll || link->m_hModule == state.hModule) {
                    victim = link;
                    break;
                }
            }
        }
        if (victim == NULL)
            break;
        delete victim; // its destructor takes it out of the chain
    }
}

CDynLinkLibrary::CDynLinkLibrary(AFX_EXTENSION_MODULE& state, BOOL bSystem)
    : m_hModule(state.hModule), m_hResource(state.hResource), m_bSystem(bSystem)
{
    AddToChain(this);
}

CDynLinkLibrary::CDynLinkLibrary(HINSTANCE hModule, HINSTANCE hResource) : m_hModule(hModule), m_hResource(hResource)
{
    AddToChain(this);
}

CDynLinkLibrary::~CDynLinkLibrary() { RemoveFromChain(this); }
