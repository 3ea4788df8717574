// Soak::Engine: what a user relies on after every step, and the census of
// what the process holds whenever no window is left.
#include "soak_checks.h"
#include "soak_engine.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiScrollee.h"
#include "Tavo_WiViewMath.h"

#include <cmath>
#include <cstdlib>
#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <sstream>

namespace Soak {

namespace {

std::string Format(const char* format, ...)
{
    char text[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    return text;
}

std::string Describe(const Tavo_GrWRect& r)
{
    return Format("(%d, %d, %d, %d)", r.x1, r.y1, r.x2, r.y2);
}

// Whether the side low ... high of a clip box spans a view of that length:
// a unit more or less, as the corners are rounded to whole units; where the
// view reaches beyond the int range, the side is cut at its end.
bool SpansView(int low, int high, double length)
{
    const double side = static_cast<double>(high) - low;
    const double slack = 1.0 + 1e-9 * length;
    if (low == INT_MIN || high == INT_MAX)
        return side <= length + slack;
    return std::fabs(side - length) <= slack;
}

} // namespace

std::string DescribeView(SoakHost& host)
{
    SoakDrawWnd& wnd = host.Wnd();
    CRect client(0, 0, 0, 0);
    ::GetClientRect(host.Scrollee(), &client);
    const auto visible = [&](UINT id) { return ::IsWindowVisible(::GetDlgItem(host.DrawWnd(), id)) ? 1 : 0; };
    std::string text = Format("client %d x %d, bars %d %d", client.Width(), client.Height(),
                              visible(Tavo_WiScrollWnd::HorzBarId), visible(Tavo_WiScrollWnd::VertBarId));
    if (const Tavo_GrMapping* mapping = wnd.GetMapping())
        text += Format(", mapping %d x %d, scale %g, level %g (%d), drawing ", mapping->GetDeviceWindowWidth(),
                       mapping->GetDeviceWindowHeight(), mapping->GetTransform().GetScale(),
                       mapping->GetRealZoomLevel(), mapping->GetZoomLevel()) +
            Describe(wnd.GetDrawing()->GetBounds());
    return text;
}

std::string Engine::Check()
{
    if (!m_stepFault.empty()) {
        std::string fault;
        fault.swap(m_stepFault);
        return fault;
    }
    for (size_t i = 0; i < m_hosts.size(); ++i) {
        const std::string fault = CheckWindow(*m_hosts[i]);
        if (!fault.empty())
            return Format("window %u: ", static_cast<unsigned>(i)) + fault + " [" + DescribeView(*m_hosts[i]) + "]";
    }
    std::string fault = CheckInteractionEnded();
    if (fault.empty())
        fault = CheckCensus();
    return fault;
}

std::string Engine::CheckWindow(SoakHost& host)
{
    return CheckView(host);
}

std::string CheckView(SoakHost& host)
{
    if (!host.IsAlive())
        return "the drawing window is gone";
    SoakDrawWnd& wnd = host.Wnd();
    const Tavo_GrMapping* mapping = wnd.GetMapping();
    if (!wnd.GetDrawing()) {
        if (mapping)
            return "a mapping without a drawing";
        if (wnd.GetWorldClipBox() != Tavo_GrWRect() || wnd.GetZoomLevel() != 0.0)
            return "an unbound window shows a view";
        return "";
    }
    if (!mapping)
        return "a drawing without a mapping";

    const double level = wnd.GetZoomLevel();
    if (!std::isfinite(level) || level < 0.0 || level > mapping->GetMaxZoomLevel())
        return Format("zoom level %g outside 0 ... %d", level, mapping->GetMaxZoomLevel());

    // The view is only defined for a window that is shown with an area (a
    // window that never had one keeps the scroll window's first model).
    CRect client(0, 0, 0, 0);
    ::GetClientRect(host.Scrollee(), &client);
    if (client.IsRectEmpty() || !::IsWindowVisible(host.Scrollee()) || ::IsIconic(host.Handle()))
        return "";

    // Setting the position again clamps it into the range: it stays where
    // it is exactly when it lies inside.
    const CPoint position = wnd.GetScrollPosition();
    wnd.SetScrollPosition(position);
    if (wnd.GetScrollPosition() != position)
        return Format("scroll position (%ld, %ld) outside its range (clamped to (%ld, %ld))", position.x, position.y,
                      wnd.GetScrollPosition().x, wnd.GetScrollPosition().y);
    if (mapping->GetDeviceWindowWidth() != client.Width() || mapping->GetDeviceWindowHeight() != client.Height())
        return Format("mapping sized %d x %d for a client area of %d x %d", mapping->GetDeviceWindowWidth(),
                      mapping->GetDeviceWindowHeight(), client.Width(), client.Height());

    const Tavo_GrWRect clip = wnd.GetWorldClipBox();
    if (clip != mapping->GetWorldClipBox())
        return "world clip box " + Describe(clip) + " differs from the mapping's " + Describe(mapping->GetWorldClipBox());
    if (clip.x1 > clip.x2 || clip.y1 > clip.y2)
        return "world clip box " + Describe(clip) + " not normalised";
    const double scale = mapping->GetTransform().GetScale();
    if (!(scale > 0.0) || !std::isfinite(scale))
        return Format("scale %g", scale);
    // The view's size in world units; corners rounded to whole units may
    // put what is read from them a unit off.
    const double viewWidth = client.Width() / scale;
    const double viewHeight = client.Height() / scale;
    if (!SpansView(clip.x1, clip.x2, viewWidth) || !SpansView(clip.y1, clip.y2, viewHeight))
        return "world clip box " + Describe(clip) + Format(" for %d x %d pixels at scale %g", client.Width(), client.Height(), scale);
    // The scroll model's extent is the view's size, as far as an int holds it.
    const CSize extent = wnd.GetWindowExtent();
    if (std::fabs(extent.cx - std::min(viewWidth, double(INT_MAX))) > 1.0 + 1e-9 * viewWidth ||
        std::fabs(extent.cy - std::min(viewHeight, double(INT_MAX))) > 1.0 + 1e-9 * viewHeight)
        return Format("window extent %ld x %ld for a view of %g x %g", extent.cx, extent.cy, viewWidth, viewHeight);
    // At the zero level the whole drawing is in view.
    if (level == 0.0) {
        const Tavo_GrWRect bounds = wnd.GetDrawing()->GetBounds();
        if (bounds.x1 < clip.x1 - 1LL || bounds.x2 > clip.x2 + 1LL || bounds.y1 < clip.y1 - 1LL ||
            bounds.y2 > clip.y2 + 1LL)
            return "at the zero level the view " + Describe(clip) + " leaves out part of the drawing";
    }
    // Zoomed in, the mapping follows the scroll position: the view's
    // top-left corner lies where the position puts it, as far as the error
    // terms (what the scrolled pixels are off) and a pixel more allow, and a
    // unit for the rounding of the corner.
    if (level > 0.0) {
        const Tavo_GrTransform& t = mapping->GetTransform();
        const auto nearPosition = [scale](int corner, long long scrolled, double error) {
            const double allowed = (std::fabs(error) + 1.0) / scale + 1.0;
            return std::fabs(static_cast<double>(corner) - static_cast<double>(scrolled)) <= allowed;
        };
        if (!nearPosition(clip.x1, position.x, t.GetXError()) || !nearPosition(clip.y2, position.y, t.GetYError()))
            return Format("scroll position (%ld, %ld) with error terms (%g, %g) but the view's top-left corner is "
                          "(%d, %d)",
                          position.x, position.y, t.GetXError(), t.GetYError(), clip.x1, clip.y2);
    }
    return "";
}

std::string Engine::CheckInteractionEnded()
{
    if (const HWND capture = ::GetCapture()) {
        char name[64] = {};
        ::GetClassNameA(capture, name, sizeof name);
        return Format("the capture stays with a %s window", name);
    }
    for (const auto& host : m_hosts) {
        if (!host->IsAlive())
            continue;
        if (host->Wnd().IsDragScrolling())
            return "still drag scrolling";
        if (m_ledger.HasTimer(host->Scrollee(), Tavo_WiScrollee::HoldTimerId))
            return "the scrollee's hold timer still runs";
        if (m_ledger.HasTimer(host->DrawWnd(), Tavo_WiDrawWnd::AutoScrollTimerId))
            return "the autoscroll timer still runs";
        const Tavo_WiDataTip* tip = host->Wnd().GetScrollee()->GetDataTip();
        if (m_ledger.HasTimer(tip->GetSafeHwnd(), Tavo_WiDataTip::TimerId) != (tip->IsVisible() != 0))
            return tip->IsVisible() ? "a data tip is shown without its timer" : "a hidden data tip's timer runs";
    }
    if (m_ledger.CountDeviceContexts() != m_baseline.deviceContexts)
        return Format("%d device contexts held, %d at the start", m_ledger.CountDeviceContexts(),
                      m_baseline.deviceContexts);
    if (m_ledger.CountThreadTimers() != 0)
        return Format("%d timers without a window", m_ledger.CountThreadTimers());
    // The data tips share one keyboard hook while any of them exists.
    const int hooks = m_hosts.empty() ? m_baseline.hooks : m_baseline.hooks + 1;
    if (m_ledger.CountHooks() != hooks)
        return Format("%d hooks installed, %d expected", m_ledger.CountHooks(), hooks);
    const int windows = m_baseline.windows + static_cast<int>(m_hosts.size()) * SoakHost::WindowCount;
    if (CountThreadWindows() != windows)
        return Format("%d windows, %d expected: ", CountThreadWindows(), windows) + NameThreadWindows();
    return "";
}

const Census& Engine::TakeBaseline()
{
    // The table is made first, so that it is part of what is counted.
    m_baselineGdiTable = GdiHandleTable();
    m_baseline = TakeCensus(&m_ledger);
    return m_baseline;
}

std::string Engine::CheckCensus()
{
    if (!m_hosts.empty())
        return "";
    ++m_idleCensuses;
    const Census now = TakeCensus(&m_ledger);
    if (now == m_baseline)
        return "";
    std::ostringstream text;
    text << "with no window left the process holds " << now << "; at the start " << m_baseline;
    if (now.gdiObjects != m_baseline.gdiObjects)
        text << "; new GDI objects: " << DescribeNewGdiObjects();
    return text.str();
}

std::uint64_t Engine::Digest(std::uint64_t digest, Action action) const
{
    // FNV-1a over the action and each window's view.
    const auto fold = [&digest](long long value) {
        for (int i = 0; i < 8; ++i) {
            digest ^= static_cast<std::uint64_t>(value >> (8 * i)) & 0xFF;
            digest *= 0x100000001B3ull;
        }
    };
    fold(action);
    for (const auto& host : m_hosts) {
        SoakDrawWnd& wnd = host->Wnd();
        const CPoint position = wnd.GetScrollPosition();
        const CSize extent = wnd.GetWindowExtent();
        const Tavo_GrWRect clip = wnd.GetWorldClipBox();
        const double level = wnd.GetZoomLevel();
        long long levelBits = 0;
        static_assert(sizeof level == sizeof levelBits);
        std::memcpy(&levelBits, &level, sizeof level);
        for (long long value : {static_cast<long long>(position.x), static_cast<long long>(position.y),
                                static_cast<long long>(extent.cx), static_cast<long long>(extent.cy),
                                static_cast<long long>(clip.x1), static_cast<long long>(clip.y1),
                                static_cast<long long>(clip.x2), static_cast<long long>(clip.y2), levelBits,
                                static_cast<long long>(wnd.counts.clicks),
                                static_cast<long long>(wnd.counts.doubleClicks),
                                static_cast<long long>(wnd.counts.rubberRectangles),
                                static_cast<long long>(wnd.counts.dragAndDrops),
                                static_cast<long long>(wnd.counts.dataTipQuestions)})
            fold(value);
    }
    return digest;
}

} // namespace Soak
