// string_test.cpp - CString, the framework's 8-bit string: the operations
// the system and the framework build on, and harmless results for bad input.
#include <afx.h>

#include <cstring>
#include <string>

#include <gtest/gtest.h>

namespace {
std::string Text(const CString& value) { return static_cast<LPCSTR>(value); }
} // namespace

TEST(CStringBuilding, ConstructionAndConcatenationGiveTextAndLength)
{
    CString grown;
    grown += 'q';
    grown += static_cast<LPCSTR>(NULL);
    CString original("Tavo");
    const CString copy(original);
    original += "def"; // the copy keeps its own text
    const CString ab("ab");
    const struct {
        CString value;
        const char* expected;
    } rows[] = {
        {CString(static_cast<LPCSTR>(NULL)), ""},
        {CString("abcdef", 2), "ab"},
        {CString("abc", -1), ""},
        {CString('x', 3), "xxx"},
        {ab + "cd", "abcd"},
        {"xy" + ab, "xyab"},
        {ab + ab, "abab"},
        {ab + '!', "ab!"},
        {grown, "q"},
        {copy, "Tavo"},
        {original, "Tavodef"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.expected);
        EXPECT_EQ(row.expected, Text(row.value));
        EXPECT_EQ(static_cast<int>(std::strlen(row.expected)), row.value.GetLength());
        EXPECT_EQ(row.expected[0] == '\0', row.value.IsEmpty() != FALSE);
    }
}

TEST(CStringBuilding, ComparisonIsByContents)
{
    const CString text("Tavo");
    EXPECT_TRUE(text == "Tavo" && "Tavo" == text && text != "tavo");
    EXPECT_TRUE(CString() == static_cast<LPCSTR>(NULL));
}

TEST(CStringFormat, FormatsLikePrintfReplacingContentsWithoutTruncation)
{
    CString text("old");
    text.Format("%d of %s at %.1f", 3, "five", 2.25);
    EXPECT_EQ("3 of five at 2.2", Text(text));
    text.AppendFormat("[%04x]", 0xAB);
    EXPECT_EQ("3 of five at 2.2[00ab]", Text(text));
    text.Format("%s%s", std::string(3000, 'a').c_str(), std::string(3000, 'b').c_str());
    EXPECT_EQ(6000, text.GetLength());
}

TEST(CStringBadInput, OutOfRangePositionsClampOrAreIgnored)
{
    CString text("0123456789");
    EXPECT_EQ("0123456789", Text(text.Left(50)));
    EXPECT_EQ("", Text(text.Mid(20)));
    EXPECT_EQ("01", Text(text.Mid(-4, 2)));
    EXPECT_EQ("", Text(text.Right(-1)));
    EXPECT_EQ(-1, text.Find("1", 10));
    EXPECT_EQ('\0', text.GetAt(50));
    text.SetAt(50, 'z');
    EXPECT_EQ("0123456789", Text(text));
    EXPECT_FALSE(text.LoadString(60123)); // no such string: the text stays
    EXPECT_EQ("0123456789", Text(text));
}
