#pragma once

#include <cstddef>
#include <cstdint>
#include <new>
#include <sys/mman.h>

/// Memory for many entries at once.

constexpr std::size_t bulkSize = std::size_t{1} << 20; ///< Less is no concern of what follows.
constexpr std::size_t largePageSize = std::size_t{2} << 20;

/// Throws std::bad_alloc unless there are `left` bytes of memory beside `size`. Takes none.
inline void leaveMemoryBeside(std::size_t size, std::size_t left) {
    void *room =
        ::mmap(nullptr, size + left, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (room == MAP_FAILED) {
        throw std::bad_alloc{};
    }
    ::munmap(room, size + left);
}

/// Throws std::bad_alloc unless, besides `size` bytes, there is what the toolkit needs for a
/// window: entries may run out of memory, and that is answered where they are read. The toolkit and
/// its libraries do not survive it.
inline void leaveMemoryForToolkit(std::size_t size) {
    if (size >= bulkSize) {
        leaveMemoryBeside(size, std::size_t{64} << 20);
    }
}

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

/// An array that is not set to anything, to be freed by delete[]. Throws std::bad_alloc.
template <class Item>
Item *newBulk(std::size_t count) {
    leaveMemoryForToolkit(count * sizeof(Item));
    auto *items = new Item[count];
    adviseLargePages(items, count * sizeof(Item));
    return items;
}
