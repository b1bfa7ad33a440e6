#pragma once

#include "alias/aliasfile.h"
#include "widgets/formdialog.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

class EditAliasEntry;

/// Edits one alias: its address, and a working list of its targets. The alias itself stays as it is
/// until who opened the dialog takes both over.
class EditAlias : public FormDialog {
    Q_OBJECT

public:
    /// `alias` is what the dialog starts with; null for an empty one.
    EditAlias(QWidget *parent, const char *name, const alias_entry *alias);

    /// As a record takes it that holds `before`.
    [[nodiscard]] KeptText address(KeptText before) const;
    /// Gives the working list away; the dialog's is empty afterwards.
    [[nodiscard]] RecordChain<alias_list_entry> takeTargets();

public slots:
    void Add();
    void Remove();
    void Selected(const char *text);
    void Modify();
    void Read(alias_list_entry *target, EditAliasEntry *dialog);

private:
    TextField *address_;
    RecordChain<alias_list_entry> targets_; ///< The working list.
    ListGroup *group_;
    RecordRows<EditAlias, alias_list_entry, EditAliasEntry> targetRows_;
};
