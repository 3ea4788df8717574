// The support libraries: UT_DARRAY, UT_STR, Port_Env and bryform.
#include "Port_Env.h"
#include "UT_DARRAY.h"
#include "UT_STR.h"
#include "bryform.h"

#include <gtest/gtest.h>

#include <windows.h>

#include <climits>
#include <cstdlib>
#include <memory>
#include <string>

namespace {

// ---- UT_DARRAY --------------------------------------------------------------------

TEST(DynamicArray, GettingTheAddressAtTheCountAppendsAZeroedElementAndNothingElse)
{
    void** elements = nullptr;
    UT_DARRAY array(&elements, sizeof(void*), 20, 1);
    EXPECT_TRUE(array.getaddr(-1) == nullptr && array.getaddr(1) == nullptr);
    void* slot = array.getaddr(0);
    ASSERT_NE(slot, nullptr);
    EXPECT_EQ(array.getnum(), 1);
    EXPECT_TRUE(slot == &elements[0] && elements[0] == nullptr) << "zeroed, and the owner's pointer follows the storage";
}

TEST(DynamicArray, ElementsKeepTheirValuesWhenTheStorageGrowsOrTheCountIsReset)
{
    int* elements = nullptr;
    {
        UT_DARRAY array(&elements, sizeof(int), 4, 1);
        for (int i = 0; i < 1000; ++i)
            *static_cast<int*>(array.getaddr(i)) = i * 3 + 1;
        ASSERT_EQ(array.getnum(), 1000);
        for (int i = 0; i < 1000; ++i)
            ASSERT_EQ(elements[i], i * 3 + 1);
        EXPECT_TRUE(array.a_resetnum(1) && array.getnum() == 1);
        EXPECT_TRUE(array.a_resetnum(5));
        EXPECT_TRUE(elements[0] == 1 && elements[1] == 0 && elements[4] == 0) << "new elements start zeroed";
        EXPECT_TRUE(array.a_resetnum(-3) && array.getnum() == 0);
    }
    EXPECT_EQ(elements, nullptr) << "destruction clears the owner's pointer";
}

// ---- UT_STR ------------------------------------------------------------------------

TEST(Strings, DupMakesAnIndependentCopy)
{
    const char original[] = "gray";
    const std::unique_ptr<char[]> copy(UT_STR::Dup(original));
    EXPECT_NE(copy.get(), original);
    EXPECT_STREQ(copy.get(), "gray");
    EXPECT_EQ(UT_STR::Dup(nullptr), nullptr);
}

TEST(Strings, CompareIsCaseSensitiveICompareIsNotAndNullIsEqualOnlyToNull)
{
    EXPECT_EQ(UT_STR::Compare("Tavo_WiPalette", "Tavo_WiPalette"), 0);
    EXPECT_NE(UT_STR::Compare("Tavo_WiPalette", "tavo_wipalette"), 0);
    EXPECT_EQ(UT_STR::ICompare("GREY", "grey"), 0);
    EXPECT_LT(UT_STR::Compare("abc", "abd"), 0);
    EXPECT_GT(UT_STR::ICompare("abd", "ABC"), 0);
    EXPECT_LT(UT_STR::Compare("ab", "abc"), 0);
    EXPECT_EQ(UT_STR::Compare(nullptr, nullptr), 0);
    EXPECT_LT(UT_STR::Compare(nullptr, ""), 0);
    EXPECT_GT(UT_STR::ICompare("", nullptr), 0);
}

TEST(Strings, AToIReadsDecimalTextAndSaturates)
{
    const struct {
        const char* text;
        int value;
    } rows[] = {
        {"12", 12},
        {"  -7px", -7},
        {"+3", 3},
        {"abc", 0},
        {"", 0},
        {nullptr, 0},
        {"99999999999999999999", INT_MAX},
        {"-2147483648", INT_MIN},
        {"-99999999999", INT_MIN},
    };
    for (const auto& row : rows)
        EXPECT_EQ(UT_STR::AToI(row.text), row.value) << (row.text ? row.text : "(null)");
}

// ---- Port_Env ------------------------------------------------------------------------

TEST(Environment, ReadsVariablesSetThroughThePlatformOrTheRuntimeWholeAndUnsetOnesAsNull)
{
    const std::string longValue(5000, 'x');
    SetEnvironmentVariableA("TAVO_CORE_TEST_A", "12");
    SetEnvironmentVariableA("TAVO_CORE_TEST_LONG", longValue.c_str());
    _putenv("TAVO_CORE_TEST_B=abc");
    const char* a = Port_Env::GetEnv("TAVO_CORE_TEST_A");
    const char* b = Port_Env::GetEnv("TAVO_CORE_TEST_B");
    const char* read = Port_Env::GetEnv("TAVO_CORE_TEST_LONG");
    EXPECT_STREQ(a, "12") << "still valid after other names were read";
    EXPECT_STREQ(b, "abc");
    EXPECT_STREQ(read, longValue.c_str());
    SetEnvironmentVariableA("TAVO_CORE_TEST_UNSET", nullptr);
    EXPECT_FALSE(Port_Env::GetEnv("TAVO_CORE_TEST_UNSET") || Port_Env::GetEnv(nullptr) || Port_Env::GetEnv("")) << "unset";
}

// ---- bryform ---------------------------------------------------------------------------

TEST(Formatter, FormatsLikePrintfWholeAndResultsStayValidForTheFollowingCalls)
{
    const char* kept = bryform("%s-%03d", "page", 7);
    for (int i = 0; i < kBryformSlots - 1; ++i)
        bryform("%d", i);
    EXPECT_STREQ(kept, "page-007");
    const std::string word(300, 'w');
    EXPECT_EQ(std::string(bryform("<%s>", word.c_str())), "<" + word + ">");
}

} // namespace
