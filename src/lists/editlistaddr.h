#pragma once

#include "base/kepttext.h"
#include "widgets/formdialog.h"

struct maillist_addr_entry;

/// Asks for one allowed or blocked poster.
class EditListAddr : public FormDialog {
    Q_OBJECT

public:
    /// `entry` is what the field starts with; null for an empty field.
    EditListAddr(QWidget *parent, const char *name, const maillist_addr_entry *entry);

    /// As a record takes it that holds `before`.
    [[nodiscard]] KeptText email(KeptText before) const;

private:
    TextField *email_;
};
