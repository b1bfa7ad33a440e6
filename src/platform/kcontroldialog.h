#pragma once

#include <QDialog>
#include <QStringList>

class HelpWindow;
class KConfigWidget;
class QTabWidget;

/// The tabbed dialog of a control module. OK applies and closes; Apply applies and stays; Cancel,
/// Esc and closing the window only close.
class KControlDialog : public QDialog {
    Q_OBJECT

public:
    KControlDialog();

    /// Takes the page over and puts it behind the others.
    void addPage(KConfigWidget *page, const QString &label, const QString &helpFile);

    /// To be called when all pages are there: the Tab key then reaches the buttons behind them.
    void addButtons();

    /// Shows the current page's help file from the language's folder below `folder`.
    void showHelp(const QString &folder);

signals:
    void applied();
    void helpWanted();

private:
    void apply();

    QTabWidget *tabs_;
    QStringList helpFiles_; ///< One for each tab.
    HelpWindow *helpWindow_ = nullptr;
};
