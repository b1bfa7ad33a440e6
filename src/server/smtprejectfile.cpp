#include "server/smtprejectfile.h"

#include "config/datafile.h"

#include <cctype>

RecordChain<smtpreject_entry> smtpreject_list;

namespace {

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
            prependRecord(&list.head, {piece->substr(0, wordEnds.lengthBefore(*piece))});
        }
    }
}

void formatSmtpRejects(const RecordChain<smtpreject_entry> &list, ByteSink &sink) {
    for (const smtpreject_entry &entry : list) {
        sink.put(entry.domain);
        sink.put('\n');
    }
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
                    [](ByteSink &sink) { formatSmtpRejects(smtpreject_list, sink); });
}
