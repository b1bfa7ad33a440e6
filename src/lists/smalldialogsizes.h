#pragma once

#include <QSize>

/// The measures, in pixels, that the list editor's small dialogs share.
constexpr QSize listDialogSize{350, 80};
constexpr int listDialogBorder = 5;
constexpr QSize listDialogLabel{40, 20};
