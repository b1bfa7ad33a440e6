#pragma once

#include "widgets/formdialog.h"

#include <optional>
#include <string>

class QListBox;

/// Asks for a text to search an address list for.
class ListSearch : public FormDialog {
    Q_OBJECT

public:
    ListSearch(QWidget *parent, const char *name);

    [[nodiscard]] std::string text() const;

private:
    TextField *text_;
};

/// The row after the current one, from the top again behind the last, that holds the needle. The
/// current row itself is not looked at.
std::optional<int> nextRowHolding(const QListBox *box, const std::string &needle);
