#include "app/applynote.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "lists/maillistfile.h"
#include "platform/bytetext.h"
#include "server/smtprejectfile.h"
#include "widgets/captions.h"

#include <QStringList>

#include <array>

namespace {

/// The keys, each in its place in the text; "..." stands for those beyond the maximum.
QStringList named(const KeyNames &keys, qsizetype maximum, const QString &text) {
    constexpr std::size_t longestKey = 60; // One can be as long as a file.
    QStringList names;
    for (const std::string &key : keys) {
        if (names.size() == maximum) {
            return names << QStringLiteral("...");
        }
        names << text.arg(textFromBytes(std::string_view{key}.substr(0, longestKey)));
    }
    return names;
}

struct FileTexts {
    const ProductFile &file;
    TranslatableText unsaved;
    TranslatableText lost;
};

constexpr std::array<FileTexts, 3> fileTexts{
    {{aliasFile, translatable("Aliases will not be saved: %1."),
      translatable("lines of the alias file (%1)")},
     {rejectFile, translatable("Blocked domains will not be saved: %1."),
      translatable("lines of the reject file (%1)")},
     {mailListFile, translatable("Mailing lists will not be saved: %1."),
      translatable("lines of the mailing-list file (%1)")}}};

} // namespace

QString applyNote(qsizetype maximumNames) {
    QStringList sentences;
    QStringList dropped;
    const auto addCount = [&](std::size_t count, TranslatableText what) {
        if (count > 0) {
            dropped << translated(what).arg(count);
        }
    };
    const auto addUnsaved = [&](TranslatableText unsaved, TranslatableText obstacle) {
        sentences << translated(unsaved).arg(translated(obstacle));
    };
    if (const auto obstacle = masterFileObstacle()) {
        addUnsaved(translatable("Settings will not be saved: %1."), *obstacle);
    } else {
        const auto &[keys, accessLists, fetchers] = lostSettings;
        if (!keys.empty()) {
            dropped << translated(translatable("settings that cannot be kept (%1)"))
                           .arg(named(keys, maximumNames, "%1").join(", "));
        }
        dropped << named(accessLists, maximumNames, translated(translatable("items of %1")));
        addCount(fetchers, translatable("fetchers that cannot be read (%1)"));
    }
    for (const auto &[file, unsaved, lost] : fileTexts) {
        if (const auto obstacle = file.obstacle()) {
            addUnsaved(unsaved, *obstacle);
        } else {
            addCount(file.lostLines, lost);
        }
    }
    if (!dropped.isEmpty()) {
        sentences << translated(translatable("An apply will drop: %1.")).arg(dropped.join(", "));
    }
    return sentences.join(' ');
}
