#pragma once

#include "base/recordlist.h"
#include "platform/qlistbox.h"

#include <QDialog>

#include <new>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Keeps a list of records and the rows that show them in step, as the buttons beside a list do. A
/// row leads to its record by its text alone: to the first record, from the head, that shows the
/// same bytes. Where texts are equal, rows and records are the same only as counted texts.
///
/// `Owner` is the page or dialog that the rows stand on. Its slot `read` takes what was typed into
/// a `Dialog` over into a record; it must change nothing, and give nothing away that the dialog
/// cannot give twice, before all that can fail is done.
template <class Owner, class Record, class Dialog, class Text = KeptText>
class RecordRows {
public:
    /// `textOf` gives what a row shows of its record: a kept text, or a view of what the record may
    /// change, of which the row keeps a copy.
    RecordRows(Owner *owner, QListBox *box, Record **head, Text (*textOf)(const Record &),
               void (Owner::*read)(Record *, Dialog *))
        : owner_{owner}, box_{box}, head_{head}, textOf_{textOf}, read_{read} {}

    /// Appends a row for each record. When memory runs out there are none.
    void fill() {
        tryRows([this] {
            std::vector<KeptText> texts;
            for (const Record *record = *head_; record != nullptr; record = record->next) {
                texts.push_back(rowOf(*record));
            }
            box_->append(texts);
        });
    }

    /// Asks in a dialog named "Edit" for a new record and adds it, unless that is cancelled: at the
    /// head of its list, with a row at the bottom of the box.
    void add() {
        Dialog dialog{owner_, "Edit", nullptr};
        askUntilTaken(dialog, [&] {
            Record &record = prependRecord(head_, Record{});
            try {
                (owner_->*read_)(&record, &dialog);
            } catch (const std::bad_alloc &) {
                removeRecord(head_);
                throw;
            }
            tryRows([&] { box_->append(rowOf(record)); });
        });
    }

    /// Changes the record that shows `text` in a dialog named "edit", and the current row with it.
    /// Nothing happens when there is no text or no such record, or the dialog is cancelled.
    void change(const char *text) {
        Record *record = text == nullptr ? nullptr : *linkToShown(text);
        if (record == nullptr) {
            return;
        }
        Dialog dialog{owner_, "edit", record};
        askUntilTaken(dialog, [&] {
            (owner_->*read_)(record, &dialog);
            if (const std::optional<int> row = box_->currentRow()) {
                tryRows([&] { box_->changeText(*row, rowOf(*record)); });
            }
        });
    }

    /// The same for the record that the current row leads to, if there is one.
    void changeCurrent() {
        if (const std::optional<int> row = box_->currentRow()) {
            change(std::string{box_->text(*row)}.c_str());
        }
    }

    /// Removes the current row and the record that it leads to, if there are both.
    void removeCurrent() {
        const std::optional<int> row = box_->currentRow();
        Record **link = row ? linkToShown(box_->text(*row)) : nullptr;
        if (link != nullptr && *link != nullptr) {
            box_->remove(*row);
            removeRecord(link);
        }
    }

private:
    static KeptText keptRow(KeptText text) { return text; }
    static KeptText keptRow(std::string_view text) { return keep(text); }
    KeptText rowOf(const Record &record) const { return keptRow(textOf_(record)); }

    Record **linkToShown(std::string_view text) const {
        return findRecord(head_, [&](const Record &record) { return textOf_(record) == text; });
    }

    /// When memory runs out, rows stay as they are. The records come first: they are in the file.
    template <class Change>
    static void tryRows(Change change) {
        try {
            change();
        } catch (const std::bad_alloc &) {
        }
    }

    /// Shows the dialog until it is cancelled or `take()` has taken its input over. When memory
    /// runs out in that, the dialog is there again, with all that was typed.
    template <class Take>
    static void askUntilTaken(Dialog &dialog, Take take) {
        while (dialog.exec() == QDialog::Accepted) {
            try {
                take();
                return;
            } catch (const std::bad_alloc &) {
            }
        }
    }

    Owner *owner_;
    QListBox *box_;
    Record **head_;
    Text (*textOf_)(const Record &);
    void (Owner::*read_)(Record *, Dialog *);
};
