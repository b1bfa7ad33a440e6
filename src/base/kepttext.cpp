#include "base/kepttext.h"

#include "base/bulkmemory.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace {

constexpr std::size_t blockSize = bulkSize; // Rarely more than one; only what is used is touched.

/// All that was ever kept; never destroyed, for texts are in use until the last moment.
std::vector<std::unique_ptr<char[]>> &kept() {
    static auto *const blocks = new std::vector<std::unique_ptr<char[]>>;
    return *blocks;
}

/// What the last block of small texts has left.
char *room = nullptr;
std::size_t roomLeft = 0;

char *newBlock(std::size_t size) {
    // Without make_unique, which would fill it with zeros first.
    std::unique_ptr<char[]> block{newBulk<char>(size)};
    return kept().emplace_back(std::move(block)).get();
}

} // namespace

KeptText keep(std::string_view text) {
    if (text.size() > blockSize / 4) {
        char *own = newBlock(text.size());
        std::ranges::copy(text, own);
        return KeptText{{own, text.size()}};
    }
    if (text.size() > roomLeft) {
        room = newBlock(blockSize);
        roomLeft = blockSize;
    }
    char *place = room;
    std::ranges::copy(text, place);
    room += text.size();
    roomLeft -= text.size();
    return KeptText{{place, text.size()}};
}

KeptText keep(FileBytes file) {
    return KeptText{{kept().emplace_back(std::move(file.bytes)).get(), file.length}};
}
