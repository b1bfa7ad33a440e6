#include "fuzz.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>

namespace targets {
void FUZZ_TARGET(std::string_view bytes); // Each program is built with one.
}

void require(bool holds, const char *claim) {
    if (!holds) {
        std::fprintf(stderr, "does not hold: %s\n", claim);
        std::abort();
    }
}

void requireParts(const std::vector<std::string_view> &texts, std::string_view bytes) {
    for (const std::string_view text : texts) {
        const std::size_t at = bytes.find(text);
        require(at != std::string_view::npos, "a text that is kept is a part of the input");
        bytes.remove_prefix(at + text.size());
    }
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size) {
    targets::FUZZ_TARGET({reinterpret_cast<const char *>(data), size});
    return 0;
}
