#include "platform/qlistbox.h"

#include "platform/bytetext.h"

#include <QAbstractListModel>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QStyleOption>
#include <QStyledItemDelegate>
#include <QTextDocument>
#include <QToolTip>

#include <algorithm>

namespace {

/// More than any window shows of a row; a file can give a row of any length.
constexpr std::size_t maximumBytesShown = 1024;

} // namespace

class QListBox::Rows : public QAbstractListModel {
public:
    using QAbstractListModel::QAbstractListModel;

    [[nodiscard]] int rowCount(const QModelIndex &parent = {}) const override {
        return parent.isValid() ? 0 : static_cast<int>(texts_.size());
    }

    /// The view asks for every row's index whenever it lays the list out; the inherited way takes
    /// several calls more.
    [[nodiscard]] QModelIndex index(int row, int column = 0,
                                    const QModelIndex &parent = {}) const override {
        const bool exists = row >= 0 && static_cast<std::size_t>(row) < texts_.size();
        return exists && column == 0 && !parent.isValid() ? createIndex(row, 0) : QModelIndex{};
    }

    [[nodiscard]] QVariant data(const QModelIndex &index, int role) const override {
        if (!index.isValid() || (role != Qt::DisplayRole && role != Qt::ToolTipRole)) {
            return {};
        }
        const QString text = textFromBytes(at(index.row()).substr(0, maximumBytesShown));
        return role == Qt::ToolTipRole && Qt::mightBeRichText(text) ? text.toHtmlEscaped() : text;
    }

    [[nodiscard]] KeptText at(int row) const { return texts_.at(static_cast<std::size_t>(row)); }

    void append(const std::vector<KeptText> &texts) {
        if (texts.empty()) {
            return;
        }
        const std::size_t count = texts_.size() + texts.size();
        if (count > texts_.capacity()) { // What can fail comes before the views hear of new rows.
            texts_.reserve(count + count / 8);
        }
        const int first = rowCount();
        beginInsertRows({}, first, first + static_cast<int>(texts.size()) - 1);
        texts_.insert(texts_.end(), texts.begin(), texts.end());
        endInsertRows();
    }

    void change(int row, KeptText text) {
        texts_.at(static_cast<std::size_t>(row)) = text;
        emit dataChanged(index(row), index(row));
    }

    void remove(int row) {
        beginRemoveRows({}, row, row);
        texts_.erase(texts_.begin() + row);
        endRemoveRows();
    }

private:
    std::vector<KeptText> texts_;
};

/// Rows ask for no width: the list has that of its window, and a longer text ends in dots. Their
/// height is the font's, whatever they hold: a changed text lays nothing out anew.
class QListBox::RowDelegate : public QStyledItemDelegate {
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    [[nodiscard]] QSize sizeHint(const QStyleOptionViewItem &option,
                                 const QModelIndex & /*index*/) const override {
        QStyleOptionViewItem row = option;
        row.features |= QStyleOptionViewItem::HasDisplay;
        row.text = QStringLiteral("x");
        const QWidget *list = option.widget;
        return {0,
                list->style()->sizeFromContents(QStyle::CT_ItemViewItem, &row, {}, list).height()};
    }

    [[nodiscard]] int textWidth(const QStyleOptionViewItem &option,
                                const QModelIndex &index) const {
        return QStyledItemDelegate::sizeHint(option, index).width();
    }
};

QListBox::QListBox(QWidget *parent) : QListView(parent), rows_{new Rows(this)} {
    setModel(rows_);
    setItemDelegate(new RowDelegate(this));
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setUniformItemSizes(true);
    setSelectionMode(SingleSelection);
    setEditTriggers(NoEditTriggers);
}

int QListBox::count() const { return rows_->rowCount(); }

KeptText QListBox::text(int row) const { return rows_->at(row); }

void QListBox::append(KeptText text) {
    append(std::vector{text});
    showRow(count() - 1);
}

void QListBox::append(const std::vector<KeptText> &texts) { rows_->append(texts); }

void QListBox::changeText(int row, KeptText text) { rows_->change(row, text); }

void QListBox::remove(int row) { rows_->remove(row); }

std::optional<int> QListBox::currentRow() const {
    const QModelIndex current = currentIndex();
    if (!current.isValid() || !selectionModel()->isSelected(current)) {
        return std::nullopt;
    }
    return current.row();
}

void QListBox::setCurrentRow(int row) { setCurrentIndex(rows_->index(row)); }

void QListBox::showRow(int row) { scrollTo(rows_->index(row)); }

void QListBox::setTopRow(int row) { scrollTo(rows_->index(row), PositionAtTop); }

void QListBox::dataChanged(const QModelIndex &first, const QModelIndex &last,
                           const QList<int> &roles) {
    // The inherited way lays all rows out anew.
    QAbstractItemView::dataChanged(first, last, roles);
}

void QListBox::focusInEvent(QFocusEvent *event) {
    if (currentIndex().isValid()) {
        QListView::focusInEvent(event);
    } else {
        // The view would make the first row current here, without highlighting it.
        QAbstractScrollArea::focusInEvent(event);
        viewport()->update();
    }
}

void QListBox::keyPressEvent(QKeyEvent *event) {
    if (event->key() != Qt::Key_Return && event->key() != Qt::Key_Enter) {
        QListView::keyPressEvent(event);
        return;
    }
    event->accept();
    if (const std::optional<int> row = currentRow()) {
        emitSelected(*row);
    }
}

QModelIndex QListBox::moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) {
    if (action == MoveEnd && !currentIndex().isValid()) {
        return rows_->index(count() - 1); // The view would go to the first.
    }
    return QListView::moveCursor(action, modifiers);
}

void QListBox::mouseDoubleClickEvent(QMouseEvent *event) {
    const QModelIndex index = indexAt(event->position().toPoint());
    event->accept();
    if (event->button() == Qt::LeftButton && index.isValid()) {
        setCurrentRow(index.row());
        emitSelected(index.row());
    }
}

void QListBox::paintEvent(QPaintEvent *event) {
    // The view shows the focus at the current row alone.
    if (hasFocus() && !currentRow()) {
        QStyleOptionFocusRect frame;
        frame.initFrom(viewport());
        frame.state |= QStyle::State_HasFocus | QStyle::State_KeyboardFocusChange;
        frame.backgroundColor = palette().color(QPalette::Base);
        QPainter painter{viewport()};
        style()->drawPrimitive(QStyle::PE_FrameFocusRect, &frame, &painter, this);
    }
    QListView::paintEvent(event);
}

void QListBox::currentChanged(const QModelIndex &current, const QModelIndex &previous) {
    QListView::currentChanged(current, previous);
    if (current.isValid() != previous.isValid()) {
        viewport()->update(); // The frame around all rows comes or goes.
    }
}

bool QListBox::viewportEvent(QEvent *event) {
    if (event->type() == QEvent::ToolTip) {
        const QModelIndex index = indexAt(static_cast<QHelpEvent *>(event)->pos());
        QStyleOptionViewItem option;
        initViewItemOption(&option);
        const auto *delegate = static_cast<RowDelegate *>(itemDelegate());
        if (!index.isValid() || delegate->textWidth(option, index) <= visualRect(index).width()) {
            QToolTip::hideText();
            return true;
        }
    }
    return QListView::viewportEvent(event);
}

QItemSelectionModel::SelectionFlags QListBox::selectionCommand(const QModelIndex &index,
                                                               const QEvent *) const {
    // Neither Ctrl nor a click below the rows takes the highlight off the current row.
    return index.isValid() ? QItemSelectionModel::ClearAndSelect : QItemSelectionModel::NoUpdate;
}

void QListBox::emitSelected(int row) {
    const std::string chosen{text(row)}; // With a NUL behind it.
    emit selected(chosen.c_str());
}
