#pragma once

#include "lists/addressgroup.h"
#include "widgets/formdialog.h"
#include "widgets/recordrows.h"

#include <array>
#include <functional>
#include <vector>

class EditListAddr;
class EditListMember;
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
    void MemberAdd() { AddMember(box(members), chain(members)); }
    void MemberRemove() { Remove(box(members), chain(members)); }
    void MemberSelected(const char *text) { SelectedMember(box(members), chain(members), text); }
    void MemberModify() { chooseCurrent(members, &EditList::MemberSelected); }
    void MemberSearch() { Search(box(members), chain(members)); }
    void MemberLoad() { Load(box(members), chain(members)); }
    void AllowAdd() { Add(box(allowed), chain(allowed)); }
    void AllowRemove() { Remove(box(allowed), chain(allowed)); }
    void AllowSelected(const char *text) { Selected(box(allowed), chain(allowed), text); }
    void AllowModify() { chooseCurrent(allowed, &EditList::AllowSelected); }
    void AllowSearch() { Search(box(allowed), chain(allowed)); }
    void AllowLoad() { Load(box(allowed), chain(allowed)); }
    void BlockAdd() { Add(box(blocked), chain(blocked)); }
    void BlockRemove() { Remove(box(blocked), chain(blocked)); }
    void BlockSelected(const char *text) { Selected(box(blocked), chain(blocked), text); }
    void BlockModify() { chooseCurrent(blocked, &EditList::BlockSelected); }
    void BlockSearch() { Search(box(blocked), chain(blocked)); }
    void BlockLoad() { Load(box(blocked), chain(blocked)); }
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
    TextField *addText(QHBoxLayout *row, TranslatableText caption, CaptionColumn &captions,
                       KeptText maillist_fields::*field, const maillist_entry &list);

    enum Kind : std::uint8_t { members, allowed, blocked };
    [[nodiscard]] QListBox *box(Kind kind) const { return groups_.at(kind)->box(); }
    [[nodiscard]] maillist_addr_entry **chain(Kind kind) const { return groups_.at(kind)->chain(); }
    /// Does what choosing the current row does; nothing where there is none.
    void chooseCurrent(Kind kind, void (EditList::*selected)(const char *));
    void ReadMember(maillist_addr_entry *entry, EditListMember *dialog);

    std::vector<std::function<void(maillist_fields &)>> stores_; ///< One for each widget.
    std::array<TextField *, 3> files_{};                         ///< Info, header, footer.
    std::array<AddressGroup *, 3> groups_{};                     ///< By their kind.
};
