#pragma once

#include <cstddef>
#include <new>

namespace base
{

// Every block the in-house library hands out is 16-byte aligned and zero-filled.
inline constexpr std::size_t kBlockAlignment = 16;

// Null when the block cannot be had; never throws.
void* AllocateZeroed(std::size_t size) noexcept;
void FreeBlock(void* block) noexcept;

// Makes the allocations after the next `successes` ones fail, so that callers'
// recovery paths can be tested. Ends with the object.
class ScopedAllocationFailure
{
public:
    explicit ScopedAllocationFailure(int successes);
    ~ScopedAllocationFailure();
    ScopedAllocationFailure(const ScopedAllocationFailure&) = delete;
    ScopedAllocationFailure& operator=(const ScopedAllocationFailure&) = delete;
};

// Base of the classes whose objects live in the in-house allocator's blocks,
// so that `new` and `delete` of them go through it.
struct CAllocated
{
    static void* operator new(std::size_t size);
    static void* operator new(std::size_t size, const std::nothrow_t&) noexcept;
    static void* operator new(std::size_t, void* memory) noexcept { return memory; }
    static void operator delete(void* block) noexcept;
    static void operator delete(void*, void*) noexcept {}
};

} // namespace base
