#pragma once

#include <QDialog>

class QTextBrowser;
class QUrl;

/// Shows help files in a window of the program's own: it may run as a user for whom no web browser
/// starts. The window has no parent and is nobody's child on the screen, so that it stays usable
/// while a dialog is open.
class HelpWindow : public QDialog {
    Q_OBJECT

public:
    /// The help files are in folders below `folder`, one for each language.
    explicit HelpWindow(QString folder);

    /// Shows `file` in the first of the user's languages that has it, English last, and says so
    /// where it is not installed.
    void showFile(const QString &file);

private:
    /// Links that lead to anything but a help file do nothing.
    void follow(const QUrl &link);

    QString folder_;
    QTextBrowser *browser_;
};
