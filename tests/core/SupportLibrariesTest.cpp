// The support libraries: UT_DARRAY, UT_STR, Port_Env, bryform and the
// initialisers.
#include "Port_Env.h"
#include "Port_Init.h"
#include "UT_DARRAY.h"
#include "UT_STR.h"
#include "bryform.h"

#include <gtest/gtest.h>

#include <windows.h>

#include <climits>
#include <cstdlib>
#include <cstring>
#include <string>

namespace {

// ---- UT_DARRAY --------------------------------------------------------------------

TEST(DynamicArray, GettingTheAddressAtTheCountAppendsAZeroedElement)
{
    void** elements = nullptr;
    UT_DARRAY array(&elements, sizeof(void*), 20, 1);
    EXPECT_EQ(array.getnum(), 0);
    void* slot = array.getaddr(0);
    ASSERT_NE(slot, nullptr);
    EXPECT_EQ(array.getnum(), 1);
    EXPECT_EQ(*static_cast<void**>(slot), nullptr);
    EXPECT_EQ(slot, &elements[0]) << "the owner's pointer follows the storage";
}

TEST(DynamicArray, IndicesOutsideTheArrayGiveNull)
{
    void** elements = nullptr;
    UT_DARRAY array(&elements, sizeof(void*), 20, 1);
    EXPECT_EQ(array.getaddr(-1), nullptr);
    EXPECT_EQ(array.getaddr(1), nullptr);
    EXPECT_EQ(array.getnum(), 0);
}

TEST(DynamicArray, ElementsKeepTheirValuesWhenTheStorageGrows)
{
    int* elements = nullptr;
    UT_DARRAY array(&elements, sizeof(int), 20, 1);
    for (int i = 0; i < 1000; ++i)
        *static_cast<int*>(array.getaddr(i)) = i * 3;
    ASSERT_EQ(array.getnum(), 1000);
    for (int i = 0; i < 1000; ++i)
        ASSERT_EQ(elements[i], i * 3);
}

TEST(DynamicArray, ResettingTheCountShrinksAndGrows)
{
    int* elements = nullptr;
    UT_DARRAY array(&elements, sizeof(int), 4, 1);
    for (int i = 0; i < 3; ++i)
        *static_cast<int*>(array.getaddr(i)) = 7;
    EXPECT_TRUE(array.a_resetnum(1));
    EXPECT_EQ(array.getnum(), 1);
    EXPECT_TRUE(array.a_resetnum(5));
    EXPECT_EQ(elements[0], 7);
    EXPECT_EQ(elements[1], 0) << "new elements start zeroed";
    EXPECT_EQ(elements[4], 0);
    EXPECT_TRUE(array.a_resetnum(-3));
    EXPECT_EQ(array.getnum(), 0);
}

TEST(DynamicArray, DestructionClearsTheOwnersPointer)
{
    int* elements = nullptr;
    {
        UT_DARRAY array(&elements, sizeof(int), 4, 1);
        array.getaddr(0);
        EXPECT_NE(elements, nullptr);
    }
    EXPECT_EQ(elements, nullptr);
}

// ---- UT_STR ------------------------------------------------------------------------

TEST(Strings, DupMakesAnIndependentCopy)
{
    const char original[] = "gray";
    char* copy = UT_STR::Dup(original);
    ASSERT_NE(copy, nullptr);
    EXPECT_NE(copy, original);
    EXPECT_STREQ(copy, "gray");
    delete[] copy;
    EXPECT_EQ(UT_STR::Dup(nullptr), nullptr);
}

TEST(Strings, CompareIsCaseSensitiveAndICompareIsNot)
{
    EXPECT_EQ(UT_STR::Compare("Tavo_WiPalette", "Tavo_WiPalette"), 0);
    EXPECT_NE(UT_STR::Compare("Tavo_WiPalette", "tavo_wipalette"), 0);
    EXPECT_EQ(UT_STR::ICompare("GREY", "grey"), 0);
    EXPECT_LT(UT_STR::Compare("abc", "abd"), 0);
    EXPECT_GT(UT_STR::ICompare("abd", "ABC"), 0);
    EXPECT_LT(UT_STR::Compare("ab", "abc"), 0);
}

TEST(Strings, NullStringsAreEqualOnlyToNull)
{
    EXPECT_EQ(UT_STR::Compare(nullptr, nullptr), 0);
    EXPECT_LT(UT_STR::Compare(nullptr, ""), 0);
    EXPECT_GT(UT_STR::ICompare("", nullptr), 0);
}

TEST(Strings, AToIReadsDecimalTextAndSaturates)
{
    EXPECT_EQ(UT_STR::AToI("12"), 12);
    EXPECT_EQ(UT_STR::AToI("  -7px"), -7);
    EXPECT_EQ(UT_STR::AToI("+3"), 3);
    EXPECT_EQ(UT_STR::AToI("abc"), 0);
    EXPECT_EQ(UT_STR::AToI(""), 0);
    EXPECT_EQ(UT_STR::AToI(nullptr), 0);
    EXPECT_EQ(UT_STR::AToI("99999999999999999999"), INT_MAX);
    EXPECT_EQ(UT_STR::AToI("-2147483648"), INT_MIN);
    EXPECT_EQ(UT_STR::AToI("-99999999999"), INT_MIN);
}

// ---- Port_Env ------------------------------------------------------------------------

TEST(Environment, ReadsVariablesSetThroughThePlatformOrTheRuntime)
{
    SetEnvironmentVariableA("TAVO_CORE_TEST_A", "12");
    _putenv("TAVO_CORE_TEST_B=abc");
    const char* a = Port_Env::GetEnv("TAVO_CORE_TEST_A");
    const char* b = Port_Env::GetEnv("TAVO_CORE_TEST_B");
    ASSERT_NE(a, nullptr);
    ASSERT_NE(b, nullptr);
    EXPECT_STREQ(a, "12") << "still valid after another name was read";
    EXPECT_STREQ(b, "abc");
}

TEST(Environment, UnsetVariablesGiveNull)
{
    SetEnvironmentVariableA("TAVO_CORE_TEST_UNSET", nullptr);
    EXPECT_EQ(Port_Env::GetEnv("TAVO_CORE_TEST_UNSET"), nullptr);
    EXPECT_EQ(Port_Env::GetEnv(nullptr), nullptr);
    EXPECT_EQ(Port_Env::GetEnv(""), nullptr);
}

TEST(Environment, LongValuesAreReadWhole)
{
    const std::string value(5000, 'x');
    SetEnvironmentVariableA("TAVO_CORE_TEST_LONG", value.c_str());
    const char* read = Port_Env::GetEnv("TAVO_CORE_TEST_LONG");
    ASSERT_NE(read, nullptr);
    EXPECT_EQ(std::string(read), value);
}

// ---- bryform ---------------------------------------------------------------------------

TEST(Formatter, FormatsLikePrintf)
{
    EXPECT_STREQ(bryform("%d", 30), "30");
    EXPECT_STREQ(bryform("%s-%03d", "page", 7), "page-007");
}

TEST(Formatter, ResultsStayValidForTheFollowingCalls)
{
    const char* kept = bryform("%d", 11);
    for (int i = 0; i < kBryformSlots - 1; ++i)
        bryform("%d", i);
    EXPECT_STREQ(kept, "11");
}

TEST(Formatter, LongResultsAreNotCut)
{
    const std::string word(300, 'w');
    EXPECT_EQ(std::string(bryform("<%s>", word.c_str())), "<" + word + ">");
}

// ---- Initialisers ---------------------------------------------------------------------

TEST(Initialisers, EachObjectHoldsItsServiceWhileItLives)
{
    const int before = Port_GetServiceUsers(Port_Service::Factory);
    {
        FactoryInit hold;
        EXPECT_EQ(Port_GetServiceUsers(Port_Service::Factory), before + 1);
        Port::FileInit file;
        Port::PathListInit paths;
        InstanceTableInit instances;
        Port_MsgManInit messages;
        EXPECT_GE(Port_GetServiceUsers(Port_Service::MsgMan), 1);
    }
    EXPECT_EQ(Port_GetServiceUsers(Port_Service::Factory), before);
}

} // namespace
