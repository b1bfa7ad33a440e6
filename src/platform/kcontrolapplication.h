#pragma once

#include "platform/commandline.h"
#include "platform/kapplication.h"

class KConfigWidget;
class KControlDialog;

/// The application base of a control module: the command line, the tabbed dialog with its buttons,
/// help and the event loop. The command line is answered before a display is looked for; its
/// init-only mode needs none.
class KControlApplication : public KApplication {
public:
    /// `pageNames` are the names that the command line may ask for.
    KControlApplication(int &argc, char **argv, const char *name, const QStringList &pageNames);
    ~KControlApplication() override;

    [[nodiscard]] bool isInitOnly() const { return dialog_ == nullptr; }

    /// Runs until the dialog is closed, however that is done; returns the exit status.
    int exec();

    void setTitle(const QString &title);

    virtual void init() {}
    /// What OK and Apply do; nothing here.
    virtual void applyChanges() {}
    virtual void help();
    virtual void defaultValues() {}

protected:
    [[nodiscard]] bool isPageRequested(const char *name) const;
    /// The parent of every page; null in init-only mode.
    [[nodiscard]] KControlDialog *dialog() const { return dialog_.get(); }
    /// Adds the page behind the others. `helpFile` is the name of a file in the help folder.
    void addPage(KConfigWidget *page, const char *label, const char *helpFile);

    void showDialog();

private:
    KControlApplication(const char *program, const char *name, CommandLine commandLine);

    QStringList requestedPages_;
    std::unique_ptr<KControlDialog> dialog_;
};
