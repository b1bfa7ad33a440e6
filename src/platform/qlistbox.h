#pragma once

#include "base/kepttext.h"

#include <QListView>

#include <optional>
#include <vector>

/// A list of one kept text a row. The current row is always the highlighted one, and there is none
/// until the user or the program chooses one: getting the focus does not choose. A row that is
/// wider than the list ends in dots, and a tool tip shows more of it. Filling, changing and
/// scrolling stay linear with a million rows.
class QListBox : public QListView {
    Q_OBJECT

public:
    explicit QListBox(QWidget *parent = nullptr);

    [[nodiscard]] int count() const;
    /// `row` is 0 to count() - 1; so in all that follows.
    [[nodiscard]] KeptText text(int row) const;

    /// Adds a row and scrolls it into sight, without choosing it.
    void append(KeptText text);
    /// Adds many rows with one repaint; does not scroll. Throws std::bad_alloc; the rows stay.
    void append(const std::vector<KeptText> &texts);
    void changeText(int row, KeptText text);
    /// When the current row goes, the one that takes its place, or else the last, becomes current.
    void remove(int row);

    [[nodiscard]] std::optional<int> currentRow() const;
    void setCurrentRow(int row);
    /// Scrolls as little as brings the row into sight.
    void showRow(int row);
    /// Scrolls so that the row is the first one shown, as far as there are rows below it.
    void setTopRow(int row);

    void selectAll() override {}

signals:
    /// A row was double-clicked, or Return or Enter pressed on it. The key goes no further: no
    /// dialog around the list closes. The desktop's single-click setting plays no part.
    void selected(const char *text);

protected:
    void dataChanged(const QModelIndex &first, const QModelIndex &last,
                     const QList<int> &roles) override;
    void currentChanged(const QModelIndex &current, const QModelIndex &previous) override;
    void focusInEvent(QFocusEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void paintEvent(QPaintEvent *event) override;
    bool viewportEvent(QEvent *event) override;
    QItemSelectionModel::SelectionFlags selectionCommand(const QModelIndex &index,
                                                         const QEvent *event) const override;

private:
    void emitSelected(int row);

    class Rows;
    class RowDelegate;
    Rows *rows_;
};
