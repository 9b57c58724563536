// The shared text string: heap bytes with a terminating zero and a length.
#include "base/memory.h"
#include "tension/text_string.h"

#include <gtest/gtest.h>

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
