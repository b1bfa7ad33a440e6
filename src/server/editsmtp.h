#pragma once

#include "widgets/formdialog.h"

#include <string>

struct smtpreject_entry;

/// Asks for one entry of the SMTP block list.
class EditSMTP : public FormDialog {
    Q_OBJECT

public:
    /// `entry` is what the field starts with; null for an empty field.
    EditSMTP(QWidget *parent, const char *name, const smtpreject_entry *entry);

    [[nodiscard]] std::string address() const;

private:
    QLineEdit *address_;
};
