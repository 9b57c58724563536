#include "base/memory.h"

#include <cstdint>
#include <gtest/gtest.h>

TEST(Memory, BlocksAreAlignedAndZeroed)
{
    for (std::size_t size : {1u, 15u, 16u, 17u, 4096u})
    {
        auto* block = static_cast<std::uint8_t*>(base::AllocateZeroed(size));
        ASSERT_NE(block, nullptr);
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % base::kBlockAlignment, 0u);
        for (std::size_t i = 0; i < size; ++i)
            ASSERT_EQ(block[i], 0) << i;
        base::FreeBlock(block);
    }
}

TEST(Memory, PlannedFailureComesAfterTheGivenSuccessesAndEndsWithTheScope)
{
    {
        base::ScopedAllocationFailure failure(1);
        void* first = base::AllocateZeroed(8);
        EXPECT_NE(first, nullptr);
        EXPECT_EQ(base::AllocateZeroed(8), nullptr);
        base::FreeBlock(first);
    }
    void* after = base::AllocateZeroed(8);
    EXPECT_NE(after, nullptr);
    base::FreeBlock(after);
}
