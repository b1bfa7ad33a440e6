#pragma once

#include "platform/qlistbox.h"
#include "widgets/pagelayout.h"

#include <QGroupBox>
#include <QPushButton>

/// A list box with a column of buttons to its right, in a group.
class ListGroup : public QGroupBox {
    Q_OBJECT

public:
    /// How the list box and the column share the width.
    struct Stretch {
        int box;
        int column;
    };

    ListGroup(const char *caption, Stretch stretch, QWidget *parent);

    [[nodiscard]] QListBox *box() const { return box_; }
    /// For what stands below the buttons.
    [[nodiscard]] QVBoxLayout *column() const { return column_; }

    QPushButton *addButton(const char *caption);

    /// Makes everything that the column holds by now `width` pixels wide, or as wide as the widest
    /// text in it needs.
    void fixColumnWidth(int width);

    /// Adds the three buttons that every list has and sends them, and a row that was chosen, to the
    /// slots of `receiver`.
    template <class Receiver>
    void addEditButtons(Receiver *receiver, void (Receiver::*add)(), void (Receiver::*modify)(),
                        void (Receiver::*remove)(), void (Receiver::*selected)(const char *)) {
        connect(addButton("Add..."), &QPushButton::clicked, receiver, add);
        connect(addButton("Modify..."), &QPushButton::clicked, receiver, modify);
        connect(addButton("Remove"), &QPushButton::clicked, receiver, remove);
        connect(box_, &QListBox::selected, receiver, selected);
    }

private:
    QListBox *box_;
    QVBoxLayout *column_;
};
