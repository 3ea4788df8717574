// Temporary home of the scrolling windows' library-lifetime objects until the
// library entry defines them in its ordered list.
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiScrollStatics.h"

CFont Tavo_WiScrollStatics::dataTipFont;
std::unique_ptr<CBrush> Tavo_WiScrollStatics::dataTipBrush;
UINT Tavo_WiScrollStatics::parkedCursorNotifyMsg = Tavo_WiParkedCursorMonitor::GetNotifyMsg();
