#include "platform/screensize.h"

#include <QApplication>
#include <QScreen>
#include <QScrollArea>

namespace {

/// What window managers commonly add to a window.
constexpr QSize usualFrame{8, 30};

} // namespace

QSize availableSize(const QWidget *window) {
    return window->screen()->availableGeometry().size() - usualFrame;
}

QScrollArea *scrolling(QWidget *content) {
    auto *area = new QScrollArea(content->parentWidget());
    area->setFrameShape(QFrame::NoFrame);
    area->setWidgetResizable(true);
    area->setFocusPolicy(Qt::NoFocus);
    area->setWidget(content);
    // What lies behind shows through, as it does without the area.
    content->setAutoFillBackground(false);
    area->viewport()->setAutoFillBackground(false);
    // The area follows the Tab key by itself, but not a caption's letter.
    QObject::connect(qApp, &QApplication::focusChanged, area, [area](QWidget *, QWidget *now) {
        if (now != nullptr && area->isAncestorOf(now)) {
            area->ensureWidgetVisible(now);
        }
    });
    return area;
}
