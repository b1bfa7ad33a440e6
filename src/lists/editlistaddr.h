#pragma once

#include "widgets/formdialog.h"

#include <string>

struct maillist_addr_entry;

/// Asks for one allowed or blocked poster.
class EditListAddr : public FormDialog {
    Q_OBJECT

public:
    /// `entry` is what the field starts with; null for an empty field.
    EditListAddr(QWidget *parent, const char *name, const maillist_addr_entry *entry);

    [[nodiscard]] std::string email() const;

private:
    QLineEdit *email_;
};
