#pragma once

#include "widgets/formdialog.h"

class QComboBox;
struct alias_list_entry;

/// Asks for one target of an alias and its type. The field takes only what is one word in the file.
class EditAliasEntry : public FormDialog {
    Q_OBJECT

public:
    /// `target` is what the dialog starts with; null for an empty field and "Address".
    EditAliasEntry(QWidget *parent, const char *name, const alias_list_entry *target);

    /// Copies text and type into the target; the "!" mark stays as it is, and so does the type when
    /// the file has no mark for the chosen entry.
    void store(alias_list_entry &target) const;

public slots:
    void browse();

private:
    TextField *alias_;
    QComboBox *type_;
};
