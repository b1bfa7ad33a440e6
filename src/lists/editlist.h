#pragma once

#include "lists/addressgroup.h"
#include "widgets/formdialog.h"
#include "widgets/recordrows.h"

#include <array>
#include <functional>
#include <vector>

class EditListAddr;
class QGroupBox;

/// Edits one mailing list. Everything, the three address lists included, is a copy: the record
/// changes only when `store` is called, after the dialog was accepted.
class EditList : public FormDialog {
    Q_OBJECT

public:
    /// `list` is what the dialog starts with; null for a new list.
    EditList(QWidget *parent, const char *name, const maillist_entry *list);

    /// Hands everything over to the record, the address lists by giving them away; what the editor
    /// does not edit stays as it is. When memory runs out (std::bad_alloc), all of it does.
    void store(maillist_entry &list);

public slots:
    void MemberAdd() { AddMember(members_->box(), members_->chain()); }
    void MemberRemove() { Remove(members_->box(), members_->chain()); }
    void MemberSelected(const char *text) {
        SelectedMember(members_->box(), members_->chain(), text);
    }
    void MemberModify() { MemberSelected(currentText(members_->box())); }
    void MemberSearch() { Search(members_->box(), members_->chain()); }
    void MemberLoad() { Load(members_->box(), members_->chain()); }
    void AllowAdd() { Add(allowed_->box(), allowed_->chain()); }
    void AllowRemove() { Remove(allowed_->box(), allowed_->chain()); }
    void AllowSelected(const char *text) { Selected(allowed_->box(), allowed_->chain(), text); }
    void AllowModify() { AllowSelected(currentText(allowed_->box())); }
    void AllowSearch() { Search(allowed_->box(), allowed_->chain()); }
    void AllowLoad() { Load(allowed_->box(), allowed_->chain()); }
    void BlockAdd() { Add(blocked_->box(), blocked_->chain()); }
    void BlockRemove() { Remove(blocked_->box(), blocked_->chain()); }
    void BlockSelected(const char *text) { Selected(blocked_->box(), blocked_->chain(), text); }
    void BlockModify() { BlockSelected(currentText(blocked_->box())); }
    void BlockSearch() { Search(blocked_->box(), blocked_->chain()); }
    void BlockLoad() { Load(blocked_->box(), blocked_->chain()); }
    void Add(QListBox *box, maillist_addr_entry **chain);
    void AddMember(QListBox *box, maillist_addr_entry **chain);
    void Remove(QListBox *box, maillist_addr_entry **chain);
    void Selected(QListBox *box, maillist_addr_entry **chain, const char *text);
    void SelectedMember(QListBox *box, maillist_addr_entry **chain, const char *text);
    void Search(QListBox *box, maillist_addr_entry **chain);
    void Load(QListBox *box, maillist_addr_entry **chain);
    void Read(maillist_addr_entry *entry, EditListAddr *dialog);
    void browseInfo() { browseForFile(files_[0], this); }
    void browseHeader() { browseForFile(files_[1], this); }
    void browseFooter() { browseForFile(files_[2], this); }

private:
    QGroupBox *newTexts(const maillist_entry &list);
    QGroupBox *newOptions(const maillist_entry &list);
    QLineEdit *addText(QHBoxLayout *row, TranslatableText caption, CaptionColumn &captions,
                       KeptText maillist_entry::*field, const maillist_entry &list);

    std::vector<std::function<void(maillist_entry &)>> stores_; ///< One for each widget.
    std::array<QLineEdit *, 3> files_{};                        ///< Info, header, footer.
    AddressGroup *members_ = nullptr;
    AddressGroup *allowed_ = nullptr;
    AddressGroup *blocked_ = nullptr;
};
