#pragma once

#include "base/kepttext.h"
#include "widgets/formdialog.h"

struct smtpreject_entry;

/// Asks for one entry of the SMTP block list.
class EditSMTP : public FormDialog {
    Q_OBJECT

public:
    /// `entry` is what the field starts with; null for an empty field.
    EditSMTP(QWidget *parent, const char *name, const smtpreject_entry *entry);

    /// As a record takes it that holds `before`.
    [[nodiscard]] KeptText address(KeptText before) const;

private:
    TextField *address_;
};
