#include "widgets/fieldtip.h"

#include <QEvent>
#include <QFontMetrics>
#include <QScreen>
#include <QToolTip>
#include <QWidget>

namespace {

/// How far below the point that it is shown for the toolkit puts a tip: the height of a pointer.
constexpr int mostBelowPoint = 32;
/// The tip's frame and margins on both sides together.
constexpr int tipBorders = 12;

QPoint pointBesideWindow(const QWidget *field, const QString &text) {
    const QRect window = field->window()->frameGeometry();
    const QRect screen = field->screen()->availableGeometry();
    const QSize tip = QFontMetrics{QToolTip::font()}.size(0, text) + QSize{tipBorders, tipBorders};
    const QPoint at = field->mapToGlobal(QPoint{0, 0});
    if (window.right() + tipBorders + tip.width() <= screen.right()) {
        return {window.right(), at.y() - mostBelowPoint / 2};
    }
    if (window.bottom() + mostBelowPoint + tip.height() <= screen.bottom()) {
        return {at.x(), window.bottom()};
    }
    return {at.x(), window.top() - mostBelowPoint - tip.height()};
}

class TipPlacer : public QObject {
public:
    using QObject::QObject;

    bool eventFilter(QObject *watched, QEvent *event) override {
        if (event->type() != QEvent::ToolTip) {
            return QObject::eventFilter(watched, event);
        }
        const auto *field = static_cast<QWidget *>(watched);
        showFieldTip(field, field->toolTip());
        return true;
    }
};

} // namespace

void setFieldTip(QWidget *field, const QString &text) {
    if (field->toolTip().isEmpty()) {
        field->installEventFilter(new TipPlacer(field));
    }
    field->setToolTip(text);
}

void showFieldTip(const QWidget *field, const QString &text) {
    QToolTip::showText(pointBesideWindow(field, text), text);
}
