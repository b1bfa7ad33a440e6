#include "fetch/pophosts.h"

#include "base/byteset.h"
#include "base/lines.h"

#include <algorithm>
#include <new>

RecordChain<pop_host> pop_host_list;

namespace {

bool areWhole = true;

constexpr ByteSet separators{":@,\r\n"};
constexpr ByteSet betweenEntries{",\r\n"};

std::uint32_t takeFlags(std::string_view &text) {
    std::uint32_t flags = POP_HOST_STAR;
    for (; text.starts_with('-') || text.starts_with('*'); text.remove_prefix(1)) {
        flags |= text.front() == '-' ? POP_HOST_MINUS : POP_HOST_STAR;
    }
    return flags;
}

template <std::size_t size>
void takeField(std::string_view &text, std::array<char, size> &field) {
    const std::string_view longest = text.substr(0, size - 1);
    const std::string_view taken = longest.substr(0, separators.spanBefore(longest));
    setPopHostText(field, taken);
    text.remove_prefix(taken.size());
}

/// Steps past the character at which a field ended; whether it is the one that should stand there.
bool takeSeparator(std::string_view &text, char expected) {
    const bool matches = text.starts_with(expected);
    text.remove_prefix(std::min<std::size_t>(text.size(), 1));
    return matches;
}

/// Takes one entry, or as much of it as shows that it is none.
bool takeEntry(std::string_view &text, pop_host &host) {
    host.flags = takeFlags(text);
    takeField(text, host.user);
    if (!takeSeparator(text, ':')) {
        return false;
    }
    takeField(text, host.password);
    if (!takeSeparator(text, '@')) {
        return false;
    }
    takeField(text, host.server);
    return true;
}

} // namespace

std::size_t parsePopHosts(TextOrNone text) {
    pop_host_list.clear();
    areWhole = true;
    std::string_view rest = text.value_or(std::string_view{});
    std::size_t unread = 0;
    std::size_t leftToCount = rest.size(); // Behind the entry that was counted last.
    RecordAppender<pop_host> end{&pop_host_list.head};
    try {
        for (;;) {
            rest.remove_prefix(betweenEntries.span(rest));
            if (rest.empty()) {
                return unread;
            }
            const std::string_view entry = rest;
            pop_host host;
            const bool isRead = takeEntry(rest, host);
            if (isRead) {
                end.append(host);
            }
            const bool isWhole = isRead && (rest.empty() || betweenEntries.holds(rest.front()));
            if (!isWhole && entry.size() <= leftToCount) {
                const std::size_t size = betweenEntries.spanBefore(entry);
                unread += holdsWord(entry.substr(0, size)) ? 1 : 0;
                leftToCount = entry.size() - size;
            }
        }
    } catch (const std::bad_alloc &) {
        areWhole = false;
        return 0; // They will not take the text's place.
    }
}

bool popHostsAreWhole() { return areWhole; }

std::string formatPopHosts() {
    std::string text;
    for (const pop_host &host : pop_host_list) {
        text += (host.flags & POP_HOST_MINUS) != 0 ? "-" : "";
        text += (host.flags & POP_HOST_STAR) != 0 ? "*" : "";
        text += popHostText(host.user);
        text += ':';
        text += popHostText(host.password);
        text += '@';
        text += popHostText(host.server);
        text += '\n';
    }
    return text;
}
