#include "base/memory.h"

#include <cstring>

namespace base
{
namespace
{
// Below zero: no failure planned.
int allocationsBeforeFailure = -1;
} // namespace

void* AllocateZeroed(std::size_t size) noexcept
{
    if (allocationsBeforeFailure == 0)
        return nullptr;
    if (allocationsBeforeFailure > 0)
        --allocationsBeforeFailure;
    void* block =
        ::operator new(size == 0 ? 1 : size, std::align_val_t(kBlockAlignment), std::nothrow);
    if (block != nullptr)
        std::memset(block, 0, size);
    return block;
}

void FreeBlock(void* block) noexcept
{
    if (block != nullptr)
        ::operator delete(block, std::align_val_t(kBlockAlignment));
}

ScopedAllocationFailure::ScopedAllocationFailure(int successes)
{
    allocationsBeforeFailure = successes;
}

ScopedAllocationFailure::~ScopedAllocationFailure()
{
    allocationsBeforeFailure = -1;
}

void* CAllocated::operator new(std::size_t size)
{
    void* block = AllocateZeroed(size);
    if (block == nullptr)
        throw std::bad_alloc();
    return block;
}

void* CAllocated::operator new(std::size_t size, const std::nothrow_t&) noexcept
{
    return AllocateZeroed(size);
}

void CAllocated::operator delete(void* block) noexcept
{
    FreeBlock(block);
}

} // namespace base
