#include "viewer_test_support.h"

#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiParkedCursorMonitor.h"

#include <fstream>

namespace ViewerTest {

namespace {

constexpr char Red = 4;
constexpr char Blue = 1;
constexpr char Black = 0;

// The application object (printer defaults) and the library, once for the
// whole test program, as the viewer sets them up at start.
struct Application {
    Application() { Tavo_WiLibrary::Initialize(); }
    CWinApp app{"viewer test"};
};

} // namespace

std::unique_ptr<ViewerDocument> MakeTestDocument()
{
    auto document = std::make_unique<ViewerDocument>("test drawing");
    Tavo_GrDrawingBuilder build(document->GetDrawing());
    build.BeginLayer("walls");
    build.SetAttr(Tavo_GrAttr(Red, 1));
    build.AddRect(100, 100, 300, 300);
    build.BeginLayer("pipes");
    build.SetAttr(Tavo_GrAttr(Blue, 0));
    build.AddLine(400, 150, 900, 150);
    build.AddCircle(650, 500, 100);
    build.BeginLayer("labels");
    build.SetAttr(Tavo_GrAttr(Black, 0, 40));
    build.AddText(700, 700, "valve");
    build.BeginLayer("frame");
    build.SetAttr(Tavo_GrAttr(Black, 0));
    build.AddRect(0, 0, 1000, 800);
    return document;
}

TempFile::TempFile(const std::string& name, const std::string& content)
{
    char folder[MAX_PATH] = {};
    ::GetTempPathA(sizeof folder, folder);
    m_path = std::string(folder) + name;
    std::ofstream(m_path, std::ios::binary) << content;
}

TempFile::~TempFile()
{
    ::DeleteFileA(m_path.c_str());
}

void ViewerFixture::SetUp()
{
    static Application application;
    ASSERT_TRUE(frame.CreateFrame(MakeTestDocument(), FrameX, FrameY, FrameWidth, FrameHeight));
    frame.ShowWindow(SW_SHOWNORMAL);
    ::SetForegroundWindow(frame.GetSafeHwnd());
    ::SetActiveWindow(frame.GetSafeHwnd());
    frame.UpdateWindow();
    ScrollTest::PumpPending();
    base = ScrollTest::FreshTime();
}

void ViewerFixture::TearDown()
{
    // Nothing a failed case left pressed reaches the next one.
    const struct {
        int key;
        DWORD up;
    } buttons[] = {{VK_LBUTTON, MOUSEEVENTF_LEFTUP}, {VK_RBUTTON, MOUSEEVENTF_RIGHTUP}};
    for (const auto& button : buttons)
        if (::GetAsyncKeyState(button.key) & 0x8000)
            Mouse(button.up, {FrameX + 5, FrameY + 5}, 1990);
    if (::GetAsyncKeyState(VK_SHIFT) & 0x8000)
        KeyUp(VK_SHIFT);
    ::ReleaseCapture();
    frame.DestroyWindow();
    ScrollTest::PumpPending();
}

CPoint ViewerFixture::ClientOf(int x, int y)
{
    const Tavo_GrMapping* mapping = View().GetMapping();
    const Tavo_GrDPoint device = mapping->GetTransform().Point({x, y});
    return CPoint(device.x, mapping->GetDeviceWindowHeight() - device.y);
}

POINT ViewerFixture::ScreenOf(int x, int y)
{
    POINT point = ClientOf(x, y);
    ::ClientToScreen(Scrollee(), &point);
    return point;
}

Tavo_GrWPoint ViewerFixture::WorldAt(const CPoint& client)
{
    const Tavo_GrMapping* mapping = View().GetMapping();
    return mapping->GetTransform().InvertPoint({client.x, mapping->GetDeviceWindowHeight() - client.y});
}

void ViewerFixture::Mouse(DWORD flags, POINT screen, DWORD offset, DWORD data, bool handle)
{
    INPUT input = ScrollTest::MouseInput(flags, screen, base + offset, data);
    ::SendInput(1, &input, sizeof input);
    if (handle)
        ScrollTest::PumpInput();
}

void ViewerFixture::Click(POINT screen, DWORD offset)
{
    Mouse(MOUSEEVENTF_LEFTDOWN, screen, offset);
    Mouse(MOUSEEVENTF_LEFTUP, screen, offset + 50);
}

namespace {

INPUT KeyInput(WORD virtualKey, DWORD flags)
{
    INPUT input = {};
    input.type = INPUT_KEYBOARD;
    input.ki.wVk = virtualKey;
    input.ki.dwFlags = flags;
    return input;
}

} // namespace

void ViewerFixture::KeyDown(WORD virtualKey)
{
    INPUT input = KeyInput(virtualKey, 0);
    ::SendInput(1, &input, sizeof input);
    ScrollTest::PumpInput();
}

void ViewerFixture::KeyUp(WORD virtualKey)
{
    INPUT input = KeyInput(virtualKey, KEYEVENTF_KEYUP);
    ::SendInput(1, &input, sizeof input);
    ScrollTest::PumpInput();
}

void ViewerFixture::Key(WORD virtualKey, WORD modifier)
{
    // One call: Wine brings its modifier keys in line with the X server's
    // whenever a window gains the pointer or the focus, and must find no
    // gap between the modifier and the key to do that in.
    INPUT inputs[4] = {KeyInput(modifier, 0), KeyInput(virtualKey, 0), KeyInput(virtualKey, KEYEVENTF_KEYUP),
                       KeyInput(modifier, KEYEVENTF_KEYUP)};
    if (modifier)
        ::SendInput(4, inputs, sizeof(INPUT));
    else
        ::SendInput(2, inputs + 1, sizeof(INPUT));
    ScrollTest::PumpInput();
}

void ViewerFixture::ShiftPress(POINT screen, DWORD offset)
{
    // The press and the Shift key go in one call, for the reason Key gives:
    // the press's key flags then carry MK_SHIFT.
    INPUT inputs[3] = {KeyInput(VK_SHIFT, 0), {}, KeyInput(VK_SHIFT, KEYEVENTF_KEYUP)};
    inputs[1] = ScrollTest::MouseInput(MOUSEEVENTF_LEFTDOWN, screen, base + offset);
    ::SendInput(3, inputs, sizeof(INPUT));
    ScrollTest::PumpInput();
}

void ViewerFixture::FireHoldTimer()
{
    ::SendMessageA(Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0);
    ScrollTest::PumpPending();
}

void ViewerFixture::FireParkTimer()
{
    const HWND monitor = View().GetScrollee()->GetParkedCursorMonitor()->GetSafeHwnd();
    ::SendMessageA(monitor, WM_TIMER, Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
    ScrollTest::PumpPending();
}

} // namespace ViewerTest
