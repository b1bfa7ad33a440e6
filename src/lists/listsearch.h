#pragma once

#include "widgets/formdialog.h"

#include <string>

/// Asks for a text to search an address list for.
class ListSearch : public FormDialog {
    Q_OBJECT

public:
    ListSearch(QWidget *parent, const char *name);

    [[nodiscard]] std::string text() const;

private:
    QLineEdit *text_;
};
