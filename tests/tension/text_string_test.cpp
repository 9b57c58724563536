// The shared text string under allocation failure and under a long log.
#include "base/memory.h"
#include "tension/text_string.h"

#include <gtest/gtest.h>
#include <string>

TEST(TextString, KeepsItsTextWhenNoBlockCanBeHadAndGrowsByDoubling)
{
    tension::CTextString text("kept");
    {
        base::ScopedAllocationFailure failure(0);
        EXPECT_FALSE(text.Append("lost"));
        EXPECT_FALSE(text.Assign("lost"));
    }
    EXPECT_STREQ(text.CStr(), "kept");
    // A log gains a message per entry: growing by less than doubling would
    // cost a long text time in the square of its length.
    const std::string piece = "Time Data Not Tension!!\n";
    base::ScopedAllocationFailure failure(40);
    for (int i = 0; i < 100000; ++i)
        ASSERT_TRUE(text.Append(piece.c_str())) << "piece " << i;
    ASSERT_EQ(text.Length(), 4 + 100000 * piece.size());
    EXPECT_EQ(text.CStr() + text.Length() - piece.size(), piece);
}
