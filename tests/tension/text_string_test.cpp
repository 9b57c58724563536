// The shared text string: heap bytes with a terminating zero and a length.
#include "base/memory.h"
#include "tension/text_string.h"

#include <gtest/gtest.h>
#include <string>

using tension::CTextString;

TEST(TextString, StartsEmptyAndAnswersAnEmptyText)
{
    CTextString text;
    EXPECT_EQ(text.Length(), 0u);
    EXPECT_STREQ(text.CStr(), "");
}

TEST(TextString, AssignsAndAppendsBytesWithTheirLength)
{
    CTextString text("ロー");
    EXPECT_EQ(text.Length(), 4u) << "two double-byte characters";
    ASSERT_TRUE(text.Append("LOW"));
    EXPECT_STREQ(text.CStr(), "ローLOW");
    EXPECT_EQ(text.Length(), 7u);
    ASSERT_TRUE(text.Assign("abc", 2));
    EXPECT_STREQ(text.CStr(), "ab");
    ASSERT_TRUE(text.Append(nullptr));
    ASSERT_TRUE(text.Assign(nullptr));
    EXPECT_EQ(text.Length(), 0u);
}

TEST(TextString, CopiesAreDeep)
{
    CTextString original("one");
    CTextString copy(original);
    original.Append("two");
    EXPECT_STREQ(copy.CStr(), "one");
    copy = original;
    original.Assign("three");
    EXPECT_STREQ(copy.CStr(), "onetwo");
    copy = copy;
    EXPECT_STREQ(copy.CStr(), "onetwo");
}

TEST(TextString, AFailedAllocationKeepsTheOldText)
{
    CTextString text("kept");
    base::ScopedAllocationFailure failure(0);
    EXPECT_FALSE(text.Append("lost"));
    EXPECT_FALSE(text.Assign("lost"));
    EXPECT_STREQ(text.CStr(), "kept");
    EXPECT_EQ(text.Length(), 4u);
}

// A log gains a message per entry: its block must grow by doubling, or a
// long text costs time in the square of its length.
TEST(TextString, AppendingPieceByPieceNeedsFewAllocations)
{
    constexpr int kPieces = 100000;
    const char piece[] = "Time Data Not Tension!!\n";
    CTextString text;
    base::ScopedAllocationFailure failure(40);
    for (int i = 0; i < kPieces; ++i)
        ASSERT_TRUE(text.Append(piece)) << "piece " << i;
    ASSERT_EQ(text.Length(), kPieces * (sizeof piece - 1));
    EXPECT_EQ(std::string(text.CStr() + text.Length() - (sizeof piece - 1)), piece);
    EXPECT_EQ(text.CStr()[text.Length()], '\0');
}

TEST(TextString, AppendsItsOwnBytesAndAssignsAfterGrowing)
{
    CTextString text("abc");
    ASSERT_TRUE(text.Append("defgh"));
    ASSERT_TRUE(text.Append(text.CStr() + 1, 2)) << "from its own block, grown or not";
    ASSERT_TRUE(text.Append(text.CStr(), 3));
    EXPECT_STREQ(text.CStr(), "abcdefghbcabc");
    ASSERT_TRUE(text.Assign("x"));
    ASSERT_TRUE(text.Append("y"));
    EXPECT_STREQ(text.CStr(), "xy");
    EXPECT_EQ(text.Length(), 2u);
}
