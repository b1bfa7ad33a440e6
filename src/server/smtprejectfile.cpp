#include "server/smtprejectfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "config/settings.h"

#include <cctype>

RecordChain<smtpreject_entry> smtpreject_list;
ProductFile rejectFile;

namespace {

constexpr std::size_t longestPiece = 249;

bool beginsEntry(unsigned char first) {
    return std::isgraph(first) != 0 && first != '#' && first != '|';
}

bool endsWord(unsigned char character) { return character == '\0' || std::isspace(character) != 0; }

} // namespace

std::size_t parseSmtpRejects(KeptText bytes, RecordChain<smtpreject_entry> &list) {
    const ByteSet beginnings = ByteSet::of(beginsEntry);
    const ByteSet wordEnds = ByteSet::of(endsWord);
    LinePieces pieces{bytes, longestPiece};
    LostLines lost;
    while (const std::optional<KeptText> piece = pieces.next()) {
        const bool isEntry = beginnings.holds(piece->front());
        const std::size_t end = isEntry ? wordEnds.spanBefore(*piece) : 0;
        if (isEntry) {
            prependRecord(&list.head, {piece->substr(0, end)});
        }
        lost.add(*piece, piece->substr(end));
    }
    return lost.count();
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
        rejectFile.lostLines = parseSmtpRejects(keep(std::move(bytes)), smtpreject_list);
    });
}

void writeSmtpRejectFile() {
    rejectFile.rewrite([](std::string &bytes) { formatSmtpRejects(smtpreject_list, bytes); });
}
