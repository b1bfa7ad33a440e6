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
constexpr std::size_t mostBytesShown = 1024;

} // namespace

/// The texts stand in one buffer, each with a NUL behind it, and the rows say where. A text that
/// was replaced or removed keeps its bytes there until the list goes.
class QListBox::Rows : public QAbstractListModel {
public:
    using QAbstractListModel::QAbstractListModel;

    [[nodiscard]] int rowCount(const QModelIndex &parent = {}) const override {
        return parent.isValid() ? 0 : static_cast<int>(rows_.size());
    }

    /// The view asks for every row's index whenever it lays the list out; the inherited way takes
    /// several calls more.
    [[nodiscard]] QModelIndex index(int row, int column = 0,
                                    const QModelIndex &parent = {}) const override {
        const bool exists = row >= 0 && static_cast<std::size_t>(row) < rows_.size();
        return exists && column == 0 && !parent.isValid() ? createIndex(row, 0) : QModelIndex{};
    }

    [[nodiscard]] QVariant data(const QModelIndex &index, int role) const override {
        if (!index.isValid() || (role != Qt::DisplayRole && role != Qt::ToolTipRole)) {
            return {};
        }
        const QString text = textFromBytes(at(index.row()).substr(0, mostBytesShown));
        return role == Qt::ToolTipRole && Qt::mightBeRichText(text) ? text.toHtmlEscaped() : text;
    }

    [[nodiscard]] std::string_view at(int row) const {
        const Row &place = rows_.at(static_cast<std::size_t>(row));
        return {texts_.data() + place.begin, place.length};
    }

    void reserve(const std::vector<std::string_view> &texts) {
        std::size_t length = texts_.size() + texts.size(); // Each with its NUL.
        for (const std::string_view text : texts) {
            length += text.size();
        }
        makeRoom(texts_, length);
        makeRoom(rows_, rows_.size() + texts.size());
    }

    void append(const std::vector<std::string_view> &texts) {
        if (texts.empty()) {
            return;
        }
        reserve(texts); // What can fail comes before the views hear of new rows.
        const int first = rowCount();
        beginInsertRows({}, first, first + static_cast<int>(texts.size()) - 1);
        for (const std::string_view text : texts) {
            rows_.push_back(placed(text));
        }
        endInsertRows();
    }

    void change(int row, std::string_view text) {
        rows_.at(static_cast<std::size_t>(row)) = placed(text);
        emit dataChanged(index(row), index(row));
    }

    void remove(int row) {
        beginRemoveRows({}, row, row);
        rows_.erase(rows_.begin() + row);
        endRemoveRows();
    }

private:
    struct Row {
        std::size_t begin; ///< In `texts_`.
        std::size_t length;
    };

    /// With an eighth to spare: doubling the room of a long list for one row more would be seen.
    template <class Container>
    static void makeRoom(Container &container, std::size_t size) {
        if (size > container.capacity()) {
            container.reserve(size + size / 8);
        }
    }

    Row placed(std::string_view text) {
        makeRoom(texts_, texts_.size() + text.size() + 1);
        const Row row{texts_.size(), text.size()};
        texts_.insert(texts_.end(), text.begin(), text.end());
        texts_.push_back('\0');
        return row;
    }

    std::vector<char> texts_;
    std::vector<Row> rows_;
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

std::string_view QListBox::text(int row) const { return rows_->at(row); }

void QListBox::append(std::string_view text) {
    append(std::vector{text});
    showRow(count() - 1);
}

void QListBox::append(const std::vector<std::string_view> &texts) { rows_->append(texts); }

void QListBox::reserve(const std::vector<std::string_view> &texts) { rows_->reserve(texts); }

void QListBox::changeText(int row, std::string_view text) { rows_->change(row, text); }

void QListBox::remove(int row) {
    const bool wasCurrent = currentRow() == row;
    rows_->remove(row);
    if (wasCurrent && count() > 0) {
        setCurrentRow(std::min(row, count() - 1));
    }
}

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
    const std::string chosen{text(row)}; // The row may change while the signal is answered.
    emit selected(chosen.c_str());
}
