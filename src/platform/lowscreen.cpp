#include "platform/lowscreen.h"

#include <QScreen>
#include <QScrollArea>

namespace {

/// What window managers commonly put around a window.
constexpr QSize usualFrame{8, 30};

} // namespace

QSize roomFor(const QWidget *window) {
    return window->screen()->availableGeometry().size() - usualFrame;
}

QScrollArea *scrolling(QWidget *content) {
    auto *area = new QScrollArea(content->parentWidget());
    area->setFrameShape(QFrame::NoFrame);
    area->setWidgetResizable(true);
    area->setWidget(content);
    return area;
}
