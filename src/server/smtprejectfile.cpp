#include "server/smtprejectfile.h"

#include "config/datafile.h"

#include <algorithm>
#include <cctype>

RecordChain<smtpreject_entry> smtpreject_list;

namespace {

constexpr std::size_t longestPiece = 249;

bool beginsEntry(char first) {
    return std::isgraph(static_cast<unsigned char>(first)) != 0 && first != '#' && first != '|';
}

bool isSpace(char character) { return std::isspace(static_cast<unsigned char>(character)) != 0; }

} // namespace

void parseSmtpRejects(std::string_view bytes, RecordChain<smtpreject_entry> &list) {
    LinePieces pieces{bytes, longestPiece};
    while (const std::optional<std::string_view> piece = pieces.next()) {
        const std::string_view text = beforeNul(*piece);
        if (!text.empty() && beginsEntry(text.front())) {
            prependRecord(&list.head,
                          {std::string{text.begin(), std::ranges::find_if(text, isSpace)}});
        }
    }
}

std::string formatSmtpRejects(const RecordChain<smtpreject_entry> &list) {
    std::string bytes;
    for (const smtpreject_entry &entry : list) {
        bytes += entry.domain;
        bytes += '\n';
    }
    return bytes;
}

void readSmtpRejectFile() {
    smtpreject_list.clear();
    try {
        if (const auto bytes = readDataFile(settings().mail_file_smtpreject)) {
            parseSmtpRejects(*bytes, smtpreject_list);
        }
    } catch (const std::bad_alloc &) { // The records made until here stay.
    }
}

void writeSmtpRejectFile() {
    rewriteDataFile(settings().mail_file_smtpreject,
                    [] { return formatSmtpRejects(smtpreject_list); });
}
