#pragma once

#include <QDialog>
#include <QStringList>

#include <memory>

class HelpWindow;
class KConfigWidget;
class QLabel;
class QTabWidget;
class QVBoxLayout;

/// The tabbed dialog of a control module. OK applies and closes; Apply applies and stays; Cancel,
/// Esc and closing the window only close.
///
/// A letter with Alt always means the caption of the page in front that has it, and a tab only
/// where no such caption is.
class KControlDialog : public QDialog {
    Q_OBJECT

public:
    KControlDialog();
    ~KControlDialog() override;

    /// Takes the page over and puts it behind the others.
    void addPage(KConfigWidget *page, const QString &label, const QString &helpFile);

    /// A line above the buttons, with a tool tip where that says more; none where `text` is empty.
    void setNote(const QString &text, const QString &tip);

    /// To be called when all pages are there: the Tab key then reaches the buttons behind them, and
    /// only now it is known whether the screen is high enough.
    void addButtons();

    /// Shows the current page's help file from the language's folder below `folder`.
    void showHelp(const QString &folder);

signals:
    void applied();
    void helpWanted();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void apply();
    void fitToScreen();
    /// The field on the page in front whose caption has this shortcut; null when there is none.
    [[nodiscard]] QWidget *fieldOf(const QKeySequence &shortcut) const;

    QTabWidget *tabs_;
    QVBoxLayout *layout_;
    QLabel *note_;
    QStringList helpFiles_; ///< One for each tab.
    std::unique_ptr<HelpWindow> helpWindow_;
};

/// Makes F1 show the current page's help from within the dialog, be that the control module's own
/// or one that was opened from it.
void addHelpKey(QDialog *dialog);
