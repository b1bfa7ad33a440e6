#include "platform/localeletters.h"

#include <algorithm>
#include <cctype>
#include <clocale>
#include <string_view>

void usePlainLettersForKeys() {
    const auto isLowered = [](char letter) { return std::tolower(letter) == letter - 'A' + 'a'; };
    const std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZ";
    if (std::ranges::all_of(letters, isLowered)) {
        return;
    }
    // Messages and typing go by the rest of the locale, and by that of the process. In use until
    // the end, hence never freed.
    const locale_t own = newlocale(LC_CTYPE_MASK, "C", duplocale(LC_GLOBAL_LOCALE));
    if (own != nullptr) {
        uselocale(own);
    }
}
