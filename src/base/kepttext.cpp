#include "base/kepttext.h"

#include <deque>
#include <utility>

KeptText keep(std::string text) {
    // A deque moves nothing that it holds. It is never destroyed: texts are in use until the last
    // moment.
    static auto *const kept = new std::deque<std::string>;
    return KeptText{kept->emplace_back(std::move(text))};
}
