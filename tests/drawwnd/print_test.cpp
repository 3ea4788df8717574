// Tavo_WiDrawWnd: printing and the print dialog, on the real default printer under Wine.
#include "drawwnd_test_support.h"

#include <gtest/gtest.h>
