#pragma once

#include "base/recordlist.h"
#include "platform/qlistbox.h"

#include <QDialog>

#include <functional>
#include <new>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

/// What keeps a list of records and the rows that show them in step. `shown` is a function that
/// gives the text of a record's row. A row leads to its record by that text alone: to the first
/// record, from the head, that shows the same bytes. Where texts are equal, rows and records are
/// the same only as counted texts.

/// When memory runs out, rows stay as they are. The records come first: they are in the file.
template <class Change>
void tryRows(Change change) {
    try {
        change();
    } catch (const std::bad_alloc &) {
    }
}

template <class Record, class Shown>
void appendRows(QListBox *box, const RecordChain<Record> &records, Shown shown) {
    static_assert(!std::is_same_v<std::invoke_result_t<Shown, const Record &>, std::string>,
                  "the views would outlive their texts");
    tryRows([&] {
        std::vector<std::string_view> texts;
        for (const Record &record : records) {
            texts.push_back(shown(record));
        }
        box->append(texts);
    });
}

/// The link to the record that shows `text`; null when there is no text or no such record.
template <class Record, class Shown>
Record **linkToShown(Record **head, const char *text, Shown shown) {
    if (text == nullptr) {
        return nullptr;
    }
    const std::string_view wanted{text};
    Record **link = findRecord(head, [&](const Record &record) { return shown(record) == wanted; });
    return *link == nullptr ? nullptr : link;
}

/// The record that shows `text`; null when there is no text or no such record.
template <class Record, class Shown>
Record *recordShown(Record *head, const char *text, Shown shown) {
    Record **link = linkToShown(&head, text, shown);
    return link == nullptr ? nullptr : *link;
}

/// The text of the current row; null when there is none. Valid until the list changes.
inline const char *currentText(const QListBox *box) {
    const std::optional<int> row = box->currentRow();
    return row ? box->text(*row).data() : nullptr;
}

inline void changeCurrentRow(QListBox *box, std::string_view text) {
    if (const std::optional<int> row = box->currentRow()) {
        box->changeText(*row, text);
    }
}

/// Removes the current row and the record that it leads to, if there are both.
template <class Record, class Shown>
void removeCurrent(QListBox *box, Record **head, Shown shown) {
    const std::optional<int> row = box->currentRow();
    Record **link = linkToShown(head, currentText(box), shown);
    if (row && link != nullptr) {
        box->remove(*row);
        removeRecord(link);
    }
}

/// Shows the dialog until it is cancelled or `take()` has taken its input over. When memory runs
/// out in that (std::bad_alloc), the dialog is there again, with all that was typed.
template <class Take>
void askUntilTaken(QDialog &dialog, Take take) {
    while (dialog.exec() == QDialog::Accepted) {
        try {
            take();
            return;
        } catch (const std::bad_alloc &) {
        }
    }
}

/// Asks in a `Dialog` named "Edit" for a new record and adds it, unless that is cancelled: at the
/// head of its list, with a row at the bottom of the box. `read(owner, &record, &dialog)` takes the
/// input over; a slot of the owner will do. It must change nothing, and give nothing away that the
/// dialog cannot give twice, before all that can fail is done.
template <class Dialog, class Owner, class Record, class Read, class Shown>
void addByDialog(Owner *owner, QListBox *box, Record **head, Read read, Shown shown) {
    Dialog dialog{owner, "Edit", nullptr};
    askUntilTaken(dialog, [&] {
        Record &record = prependRecord(head, Record{});
        try {
            std::invoke(read, owner, &record, &dialog);
        } catch (const std::bad_alloc &) {
            removeRecord(head);
            throw;
        }
        tryRows([&] { box->append(shown(record)); });
    });
}

/// Changes the record that shows `text` in a `Dialog` named "edit", and the current row with it.
/// Nothing happens when there is no such record, or the dialog is cancelled.
template <class Dialog, class Owner, class Record, class Read, class Shown>
void changeByDialog(Owner *owner, QListBox *box, Record **head, const char *text, Read read,
                    Shown shown) {
    Record *record = recordShown(*head, text, shown);
    if (record == nullptr) {
        return;
    }
    Dialog dialog{owner, "edit", record};
    askUntilTaken(dialog, [&] {
        std::invoke(read, owner, record, &dialog);
        tryRows([&] { changeCurrentRow(box, shown(*record)); });
    });
}
