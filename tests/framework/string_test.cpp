// string_test.cpp - CString, the framework's 8-bit string.
#include <afx.h>

#include <cstring>

#include <gtest/gtest.h>

TEST(CStringConstruction, NullPointerGivesEmptyString)
{
  const CString text(static_cast<LPCSTR>(NULL));
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_STREQ("", static_cast<LPCSTR>(text));
}

TEST(CStringConstruction, CopiesAreIndependent)
{
  CString original("abc");
  const CString copy(original);
  original += "def";
  EXPECT_STREQ("abc", static_cast<LPCSTR>(copy));
  EXPECT_STREQ("abcdef", static_cast<LPCSTR>(original));
}

TEST(CStringConstruction, RepeatedCharacterAndCountedText)
{
  EXPECT_STREQ("xxx", static_cast<LPCSTR>(CString('x', 3)));
  EXPECT_STREQ("ab", static_cast<LPCSTR>(CString("abcdef", 2)));
  EXPECT_TRUE(CString("abc", -1).IsEmpty());
}

TEST(CStringConcatenation, OperatorsJoinInOrder)
{
  const CString a("ab");
  EXPECT_STREQ("abcd", static_cast<LPCSTR>(a + "cd"));
  EXPECT_STREQ("xyab", static_cast<LPCSTR>("xy" + a));
  EXPECT_STREQ("abab", static_cast<LPCSTR>(a + a));
  EXPECT_STREQ("ab!", static_cast<LPCSTR>(a + '!'));
  CString grown;
  grown += 'q';
  grown += static_cast<LPCSTR>(NULL);
  EXPECT_STREQ("q", static_cast<LPCSTR>(grown));
}

TEST(CStringComparison, EqualityAgainstStringsAndPointers)
{
  const CString text("Tavo");
  EXPECT_TRUE(text == "Tavo");
  EXPECT_TRUE("Tavo" == text);
  EXPECT_TRUE(text != "tavo");
  EXPECT_EQ(0, text.CompareNoCase("TAVO"));
  EXPECT_LT(text.Compare("Tavz"), 0);
  EXPECT_TRUE(CString() == static_cast<LPCSTR>(NULL));
}

TEST(CStringExtraction, LeftMidRightClampToTheString)
{
  const CString text("0123456789");
  EXPECT_STREQ("012", static_cast<LPCSTR>(text.Left(3)));
  EXPECT_STREQ("789", static_cast<LPCSTR>(text.Right(3)));
  EXPECT_STREQ("345", static_cast<LPCSTR>(text.Mid(3, 3)));
  EXPECT_STREQ("89", static_cast<LPCSTR>(text.Mid(8)));
  EXPECT_STREQ("0123456789", static_cast<LPCSTR>(text.Left(50)));
  EXPECT_TRUE(text.Mid(20).IsEmpty());
  EXPECT_STREQ("01", static_cast<LPCSTR>(text.Mid(-4, 2)));
  EXPECT_TRUE(text.Right(-1).IsEmpty());
}

TEST(CStringSearch, FindReportsPositionOrMinusOne)
{
  const CString text("a,b,c");
  EXPECT_EQ(1, text.Find(','));
  EXPECT_EQ(3, text.Find(',', 2));
  EXPECT_EQ(-1, text.Find(';'));
  EXPECT_EQ(2, text.Find("b,"));
  EXPECT_EQ(-1, text.Find("b", 10));
  EXPECT_EQ(3, text.ReverseFind(','));
}

TEST(CStringFormat, FormatsLikePrintfAndReplacesContents)
{
  CString text("old");
  text.Format("%d of %s at %.1f", 3, "five", 2.25);
  EXPECT_STREQ("3 of five at 2.2", static_cast<LPCSTR>(text));
  text.AppendFormat("[%04x]", 0xAB);
  EXPECT_STREQ("3 of five at 2.2[00ab]", static_cast<LPCSTR>(text));
}

TEST(CStringFormat, LongResultIsNotTruncated)
{
  CString text;
  text.Format("%s%s", std::string(3000, 'a').c_str(), std::string(3000, 'b').c_str());
  EXPECT_EQ(6000, text.GetLength());
}

TEST(CStringBuffer, ReleaseBufferTakesLengthFromTerminator)
{
  CString text("abc");
  char* buffer = text.GetBuffer(10);
  std::strcpy(buffer, "longer");
  text.ReleaseBuffer();
  EXPECT_STREQ("longer", static_cast<LPCSTR>(text));
  EXPECT_EQ(6, text.GetLength());
}

TEST(CStringBuffer, ReleaseBufferWithLengthCutsThere)
{
  CString text;
  char* buffer = text.GetBuffer(8);
  std::memcpy(buffer, "12345678", 8);
  text.ReleaseBuffer(4);
  EXPECT_STREQ("1234", static_cast<LPCSTR>(text));
}

TEST(CStringChanges, EmptyAndCaseAndReplace)
{
  CString text("Mixed Case");
  text.MakeUpper();
  EXPECT_STREQ("MIXED CASE", static_cast<LPCSTR>(text));
  EXPECT_EQ(1, text.Replace("CASE", "case"));
  EXPECT_STREQ("MIXED case", static_cast<LPCSTR>(text));
  text.Empty();
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_EQ(0, text.GetLength());
}

TEST(CStringAccess, OutOfRangeIndexIsHarmless)
{
  CString text("ab");
  EXPECT_EQ('b', text[1]);
  EXPECT_EQ('\0', text.GetAt(5));
  text.SetAt(7, 'z');
  EXPECT_STREQ("ab", static_cast<LPCSTR>(text));
}

TEST(CStringLoad, MissingStringLeavesTextAndReportsFalse)
{
  CString text("kept");
  EXPECT_FALSE(text.LoadString(60123));
  EXPECT_STREQ("kept", static_cast<LPCSTR>(text));
}
