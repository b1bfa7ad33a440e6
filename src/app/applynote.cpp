#include "app/applynote.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "config/settings.h"
#include "lists/maillistfile.h"
#include "platform/bytetext.h"
#include "platform/kapplication.h"
#include "server/smtprejectfile.h"

#include <QStringList>

#include <algorithm>
#include <array>

namespace {

QString shown(TranslatableText text) { return KApplication::getLocale()->translate(text); }

/// In the order of Obstacle, behind the one that is none.
constexpr std::array reasons{
    translatable("no file is set"),          translatable("the file could not be read"),
    translatable("there is no such folder"), translatable("the file may not be written"),
    translatable("there is no template"),    translatable("the file appeared meanwhile")};

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

class Note {
public:
    /// Whether the file will be saved; otherwise the note says why not.
    bool isSaved(Obstacle obstacle, TranslatableText unsaved) {
        if (obstacle != Obstacle::None) {
            const auto reason = static_cast<std::size_t>(obstacle) - 1;
            sentences_ << shown(unsaved).arg(shown(reasons.at(reason)));
        }
        return obstacle == Obstacle::None;
    }

    void drop(const QStringList &what) { dropped_ << what; }
    void drop(std::size_t count, TranslatableText what) {
        if (count > 0) {
            dropped_ << shown(what).arg(count);
        }
    }

    [[nodiscard]] QString text() const {
        const QString all = shown(translatable("An apply will drop: %1.")).arg(dropped_.join(", "));
        return (sentences_ + QStringList(dropped_.isEmpty() ? 0 : 1, all)).join(' ');
    }

private:
    QStringList sentences_;
    QStringList dropped_;
};

} // namespace

QString applyNote(std::size_t unreadFetchers, std::size_t maximumNames) {
    Note note;
    if (note.isSaved(masterFileObstacle(), translatable("Settings will not be saved: %1."))) {
        const auto &[keys, accessLists] = lostSettings();
        const QString unkept = shown(translatable("settings that cannot be kept (%1)"));
        note.drop(
            QStringList(keys.empty() ? 0 : 1, unkept.arg(named(keys, maximumNames).join(", "))));
        note.drop(named(accessLists, maximumNames, shown(translatable("items of %1"))));
        note.drop(unreadFetchers, translatable("fetchers that cannot be read (%1)"));
    }
    if (note.isSaved(aliasFile.obstacle(settings().mail_file_alias.value),
                     translatable("Aliases will not be saved: %1."))) {
        note.drop(aliasFile.lostLines, translatable("lines of the alias file (%1)"));
    }
    if (note.isSaved(rejectFile.obstacle(settings().mail_file_smtpreject.value),
                     translatable("Blocked domains will not be saved: %1."))) {
        note.drop(rejectFile.lostLines, translatable("lines of the reject file (%1)"));
    }
    if (note.isSaved(mailListFile.obstacle(settings().mail_file_maillist.value),
                     translatable("Mailing lists will not be saved: %1."))) {
        note.drop(mailListFile.lostLines, translatable("lines of the mailing-list file (%1)"));
    }
    return note.text();
}
