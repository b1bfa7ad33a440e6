#pragma once

#include <cstddef>
#include <cstdint>
#include <sys/mman.h>

/// From this size on memory is worth large pages.
constexpr std::size_t largePageSize = std::size_t{2} << 20;

/// Asks the kernel for large pages in the `size` bytes at `begin`, before they are first touched.
/// Where a million entries are read, handing out small pages takes as long as the reading. Only
/// advice: a kernel without such pages gives small ones.
inline void adviseLargePages(void *begin, std::size_t size) {
    if (size < 2 * largePageSize) {
        return;
    }
    const std::size_t past = reinterpret_cast<std::uintptr_t>(begin) % largePageSize;
    const std::size_t toFirst = (largePageSize - past) % largePageSize;
    const std::size_t whole = (size - toFirst) / largePageSize * largePageSize;
    ::madvise(static_cast<char *>(begin) + toFirst, whole, MADV_HUGEPAGE);
}
