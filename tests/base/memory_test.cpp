#include "base/memory.h"

#include <algorithm>
#include <cstdint>
#include <gtest/gtest.h>

TEST(Memory, BlocksAreAlignedAndZeroedUntilAPlannedFailure)
{
    delete new base::CAllocated();
    base::ScopedAllocationFailure failure(3);
    for (std::size_t size : {1u, 17u, 4096u})
    {
        auto* block = static_cast<std::uint8_t*>(base::AllocateZeroed(size));
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % 16, 0u);
        EXPECT_EQ(std::count(block, block + size, 0), static_cast<long>(size));
        base::FreeBlock(block);
    }
    EXPECT_EQ(base::AllocateZeroed(8), nullptr);
    EXPECT_THROW(new base::CAllocated(), std::bad_alloc);
}
