#pragma once

#include <QSize>

class QScrollArea;
class QWidget;

/// The largest size, in pixels, that the window can have on its screen beside panels and inside the
/// window manager's frame, as far as that is known before the window is shown.
QSize availableSize(const QWidget *window);

/// A frameless area of the content's own size in which it scrolls where it is given less.
QScrollArea *scrolling(QWidget *content);
