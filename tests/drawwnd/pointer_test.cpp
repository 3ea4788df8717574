// Tavo_WiDrawWnd: the pointer on real windows under Wine.
#include "drawwnd_test_support.h"

#include <gtest/gtest.h>
