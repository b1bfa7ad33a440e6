#include "app/applynote.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "lists/maillistfile.h"
#include "platform/bytetext.h"
#include "server/smtprejectfile.h"
#include "widgets/captions.h"

#include <QStringList>

#include <algorithm>

namespace {

/// The keys, each in its place in the text; "..." stands for those beyond the maximum.
QStringList named(const std::vector<std::string> &keys, std::size_t maximum,
                  const QString &text = QStringLiteral("%1")) {
    constexpr std::size_t longestKey = 60; // One can be as long as a file.
    QStringList names;
    for (std::size_t index = 0; index < std::min(keys.size(), maximum); ++index) {
        names << text.arg(textFromBytes(std::string_view{keys[index]}.substr(0, longestKey)));
    }
    return keys.size() > maximum ? names << QStringLiteral("...") : names;
}

struct Note {
    QStringList sentences;
    QStringList dropped;
};

/// Whether the file will be saved; otherwise the note says why not.
bool isSaved(Note &note, const std::optional<TranslatableText> &obstacle,
             TranslatableText unsaved) {
    if (obstacle) {
        note.sentences << translated(unsaved).arg(translated(*obstacle));
    }
    return !obstacle;
}

void addCount(Note &note, std::size_t count, TranslatableText what) {
    if (count > 0) {
        note.dropped << translated(what).arg(count);
    }
}

void addFile(Note &note, const ProductFile &file, TranslatableText unsaved,
             TranslatableText dropped) {
    if (isSaved(note, file.obstacle(), unsaved)) {
        addCount(note, file.lostLines, dropped);
    }
}

} // namespace

QString applyNote(std::size_t maximumNames) {
    Note note;
    if (isSaved(note, masterFileObstacle(), translatable("Settings will not be saved: %1."))) {
        const auto &[keys, accessLists, fetchers] = lostSettings;
        if (!keys.empty()) {
            note.dropped << translated(translatable("settings that cannot be kept (%1)"))
                                .arg(named(keys, maximumNames).join(", "));
        }
        note.dropped << named(accessLists, maximumNames, translated(translatable("items of %1")));
        addCount(note, fetchers, translatable("fetchers that cannot be read (%1)"));
    }
    addFile(note, aliasFile, translatable("Aliases will not be saved: %1."),
            translatable("lines of the alias file (%1)"));
    addFile(note, rejectFile, translatable("Blocked domains will not be saved: %1."),
            translatable("lines of the reject file (%1)"));
    addFile(note, mailListFile, translatable("Mailing lists will not be saved: %1."),
            translatable("lines of the mailing-list file (%1)"));
    if (!note.dropped.isEmpty()) {
        note.sentences
            << translated(translatable("An apply will drop: %1.")).arg(note.dropped.join(", "));
    }
    return note.sentences.join(' ');
}
