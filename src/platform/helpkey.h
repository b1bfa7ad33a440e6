#pragma once

class QDialog;

/// Makes F1 show the current page's help from within the dialog, be that the control module's own
/// or one that was opened from it.
void addHelpKey(QDialog *dialog);
