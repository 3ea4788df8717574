// Gui_Msg and Gui_Locale: string-table lookup through registered modules and
// the replacement of %1 ... %n.
#include "Gui_Locale.h"
#include "Gui_Msg.h"

#include <gtest/gtest.h>

#include <string>

namespace {

const HINSTANCE kThisProgram = GetModuleHandleA(nullptr);

std::string Text(const CString& value)
{
    return std::string(value.GetString(), value.GetLength());
}

TEST(MessageText, ArgumentsReplaceTheirNumbersInDecimalOnceAndOtherPercentSignsStay)
{
    EXPECT_EQ(Text((Gui_Msg(100, kThisProgram) << 3 << -12).GetValue()), "Value 3 of -12");
    EXPECT_EQ(Text((Gui_Msg(101, kThisProgram) << 7).GetValue()), "100% sure, %3 stays, 77");
    Gui_Msg twoDigits(102, kThisProgram);
    for (int i = 1; i <= 12; ++i)
        twoDigits << i * 10;
    EXPECT_EQ(Text(twoDigits.GetValue()), "120 and 10");
    // Argument text is never formatted again: it never reaches a printf-style formatter.
    EXPECT_EQ(Gui_Msg::Substitute("%1%2", {"%2", "%s%n"}), "%2%s%n");
    EXPECT_EQ(Gui_Msg::Substitute("50%", {}), "50%");
    EXPECT_EQ(Gui_Msg::Substitute("%0 %a %%1", {"x"}), "%0 %a %1");
}

TEST(MessageLookup, RegisteredModulesAreSearchedWhenNoModuleIsGiven)
{
    AFX_EXTENSION_MODULE record = {};
    const int before = Gui_Locale::GetResourceModuleCount();
    Gui_Locale::SetDllResourceHandle(record, kThisProgram, nullptr);
    Gui_Locale::SetDllResourceHandle(record, kThisProgram, nullptr);
    EXPECT_EQ(Gui_Locale::GetResourceModuleCount(), before + 1) << "a module is listed once";
    EXPECT_TRUE(Gui_Locale::GetResourceModule(before) == kThisProgram && record.hResource == kThisProgram);
    EXPECT_EQ(Text((Gui_Msg(100) << 1 << 2).GetValue()), "Value 1 of 2");
    EXPECT_EQ(Gui_Locale::GetResourceModule(-1), nullptr);

    AFX_EXTENSION_MODULE other = {};
    Gui_Locale::SetDllResourceHandle(other, kThisProgram, "no-such-library.dll");
    EXPECT_EQ(other.hResource, kThisProgram) << "a resource library that cannot be loaded falls back to the instance";
}

} // namespace
