#include "server/smtprejectfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "base/productfile.h"
#include "config/settings.h"

#include <cctype>

RecordChain<smtpreject_entry> smtpreject_list;

namespace {

ProductFile rejectFile;

constexpr std::size_t longestPiece = 249;

bool beginsEntry(unsigned char first) {
    return std::isgraph(first) != 0 && first != '#' && first != '|';
}

bool endsWord(unsigned char character) { return character == '\0' || std::isspace(character) != 0; }

} // namespace

void parseSmtpRejects(KeptText bytes, RecordChain<smtpreject_entry> &list) {
    const ByteSet beginnings = ByteSet::of(beginsEntry);
    const ByteSet wordEnds = ByteSet::of(endsWord);
    LinePieces pieces{bytes, longestPiece};
    while (const std::optional<KeptText> piece = pieces.next()) {
        if (beginnings.holds(piece->front())) {
            prependRecord(&list.head, {piece->substr(0, wordEnds.spanBefore(*piece))});
        }
    }
}

void formatSmtpRejects(const RecordChain<smtpreject_entry> &list, std::string &bytes) {
    for (const smtpreject_entry &entry : list) {
        bytes += entry.domain;
        bytes += '\n';
    }
}

void readSmtpRejectFile() {
    smtpreject_list.clear();
    rejectFile.read(settings().mail_file_smtpreject.value, [](std::string bytes) {
        parseSmtpRejects(keep(std::move(bytes)), smtpreject_list);
    });
}

void writeSmtpRejectFile() {
    rejectFile.rewrite(settings().mail_file_smtpreject.value,
                       [](std::string &bytes) { formatSmtpRejects(smtpreject_list, bytes); });
}
