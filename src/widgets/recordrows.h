#pragma once

#include "base/recordlist.h"
#include "platform/qlistbox.h"

#include <QDialog>

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

/// Keeps a list of records and the rows that show them in step, as the buttons beside a list do. A
/// row leads to its record by its text alone: to the first record, from the head, that shows the
/// same bytes. Where texts are equal, rows and records are the same only as counted texts.
///
/// `Owner` is the page or dialog that the rows stand on. Its slot `read` takes what was typed into
/// a `Dialog` over into a record.
template <class Owner, class Record, class Dialog, class Text = KeptText>
class RecordRows {
public:
    /// `textOf` gives what a row shows of its record: a kept text, or a view of what the record may
    /// change, of which the row keeps a copy.
    RecordRows(Owner *owner, QListBox *box, Record **head, Text (*textOf)(const Record &),
               void (Owner::*read)(Record *, Dialog *))
        : owner_{owner}, box_{box}, head_{head}, textOf_{textOf}, read_{read} {}

    void fill() {
        std::vector<KeptText> texts;
        for (const Record *record = *head_; record != nullptr; record = record->next) {
            texts.push_back(rowOf(*record));
        }
        box_->append(texts);
    }

    /// Asks in a dialog named "Edit" for a new record and adds it, unless that is cancelled: at the
    /// head of its list, with a row at the bottom of the box.
    void add() {
        Dialog dialog{owner_, "Edit", nullptr};
        if (dialog.exec() == QDialog::Accepted) {
            Record record{};
            (owner_->*read_)(&record, &dialog);
            box_->append(rowOf(prependRecord(head_, std::move(record))));
        }
    }

    /// Changes the record that shows `text` in a dialog named "edit", and the current row with it.
    /// Nothing happens when there is no text or no such record, or the dialog is cancelled.
    void change(const char *text) {
        Record *record = text == nullptr ? nullptr : *linkToShown(text);
        if (record == nullptr) {
            return;
        }
        Dialog dialog{owner_, "edit", record};
        if (dialog.exec() != QDialog::Accepted) {
            return;
        }
        (owner_->*read_)(record, &dialog);
        if (const std::optional<int> row = box_->currentRow()) {
            box_->changeText(*row, rowOf(*record));
        }
    }

    /// The same for the record that the current row leads to, if there is one.
    void changeCurrent() {
        if (const std::optional<int> row = box_->currentRow()) {
            change(std::string{box_->text(*row)}.c_str());
        }
    }

    /// Removes the current row and the record that it leads to, if there are both.
    void removeCurrent() {
        if (const std::optional<int> row = box_->currentRow()) {
            Record **link = linkToShown(box_->text(*row));
            if (*link != nullptr) {
                box_->remove(*row);
                removeRecord(link);
            }
        }
    }

private:
    static KeptText keptRow(KeptText text) { return text; }
    static KeptText keptRow(std::string_view text) { return keep(std::string{text}); }
    [[nodiscard]] KeptText rowOf(const Record &record) const { return keptRow(textOf_(record)); }

    [[nodiscard]] Record **linkToShown(std::string_view text) const {
        return findRecord(head_, [&](const Record &record) { return textOf_(record) == text; });
    }

    Owner *owner_;
    QListBox *box_;
    Record **head_;
    Text (*textOf_)(const Record &);
    void (Owner::*read_)(Record *, Dialog *);
};
