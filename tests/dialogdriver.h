#pragma once

#include "platform/bytetext.h"
#include "platform/qlistbox.h"

#include <QAbstractButton>
#include <QApplication>
#include <QClipboard>
#include <QLabel>
#include <QLineEdit>
#include <QTest>
#include <QTimer>

#include <algorithm>

/// What a user does to pages and dialogs. Everything is found by the caption that a user reads.

/// The first child with this caption; null when there is none.
template <class Child>
Child *captioned(const QWidget *window, QString (Child::*caption)() const, const QString &text) {
    const auto children = window->findChildren<Child *>();
    const auto found = std::ranges::find(children, text, caption);
    return found == children.end() ? nullptr : *found;
}

/// In whichever window it is; null when there is none.
template <class Widget>
Widget *anywhere() {
    for (const QWidget *window : QApplication::topLevelWidgets()) {
        if (auto *widget = window->findChild<Widget *>()) {
            return widget;
        }
    }
    return nullptr;
}

template <class Field = QLineEdit>
Field *fieldBeside(const QWidget *window, const QString &caption) {
    const QLabel *label = captioned(window, &QLabel::text, caption);
    return label == nullptr ? nullptr : qobject_cast<Field *>(label->buddy());
}

inline void press(const QWidget *window, const char *caption) {
    QAbstractButton *button = captioned(window, &QAbstractButton::text, caption);
    QVERIFY2(button != nullptr, caption);
    QTest::mouseClick(button, Qt::LeftButton, {}, QPoint{10, button->height() / 2});
}

/// Types over all that stands in the field.
inline void type(QWidget *field, const QString &text) {
    QVERIFY(field != nullptr);
    QTest::keyClick(field, Qt::Key_A, Qt::ControlModifier);
    QTest::keyClick(field, Qt::Key_Delete);
    QTest::keyClicks(field, text);
}

inline void paste(QWidget *field, const QString &text) {
    QApplication::clipboard()->setText(text);
    QTest::keyClick(field, Qt::Key_V, Qt::ControlModifier);
}

inline QPoint centreOfRow(const QListBox *box, int row) {
    return box->visualRect(box->model()->index(row, 0)).center();
}

inline void doubleClickRow(const QListBox *box, int row) {
    QTest::mouseDClick(box->viewport(), Qt::LeftButton, {}, centreOfRow(box, row));
}

/// The texts of the rows, with "|" between them.
inline QString rowsOf(const QListBox *box) {
    QStringList rows;
    for (int row = 0; row < box->count(); ++row) {
        rows << textFromBytes(box->text(row));
    }
    return rows.join('|');
}

/// Does `open` and hands the modal dialog of this kind that opens to `use`, which has to close it.
/// Whether one opened.
template <class Dialog = QWidget, class Open, class Use>
bool withDialog(Open open, Use use) {
    const QWidget *below = QApplication::activeModalWidget();
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&] {
        auto *dialog = qobject_cast<Dialog *>(QApplication::activeModalWidget());
        if (dialog != nullptr && dialog != below) {
            timer.stop();
            use(dialog);
            const bool isOpen = dialog->isVisible();
            dialog->close();
            QVERIFY2(!isOpen, "The dialog did not close.");
        }
    });
    timer.start(0);
    open();
    return !timer.isActive();
}
