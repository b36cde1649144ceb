#pragma once

#include <malloc.h>

#include <cstdlib>
#include <new>

/// Counts the memory that a program holds. For the one source file of a benchmark: it puts the allocator in the place of the usual
/// one.
namespace tessel::bench {

inline std::size_t liveBytes = 0;  // as the allocator hands them out

}  // namespace tessel::bench

// Not inlined: the compiler would take the parts of the pair for strangers.
[[gnu::noinline]] void* operator new(std::size_t size) {
    void* memory = std::malloc(size);
    if (!memory) throw std::bad_alloc();
    tessel::bench::liveBytes += malloc_usable_size(memory);
    return memory;
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
    tessel::bench::liveBytes -= malloc_usable_size(memory);
    std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }
