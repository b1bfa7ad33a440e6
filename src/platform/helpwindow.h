#pragma once

#include <QDialog>

class QTextBrowser;

/// Shows help files in a window of the program's own: it may run as a user for whom no web browser
/// starts.
class HelpWindow : public QDialog {
    Q_OBJECT

public:
    explicit HelpWindow(QWidget *parent);

    /// Shows `folder`/LANGUAGE/`file` for the first of the user's languages that has it, English
    /// last, and says so where no such file is installed.
    void showFile(const QString &folder, const QString &file);

private:
    QTextBrowser *browser_;
};
