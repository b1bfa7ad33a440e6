#pragma once

#include "platform/kconfigwidget.h"

class EditFetch;
class KNumericSpinBox;
class QListBox;
struct pop_host;

/// The page of the mailboxes that mail is collected from. Its list is edited in place; the setting
/// that holds it is written when the page stores its values.
class MailFetch : public KConfigWidget {
    Q_OBJECT

public:
    MailFetch(QWidget *parent, const char *name);

    void loadValues() override;
    void storeValues() override;

public slots:
    void MailFetchAdd();
    void MailFetchRemove();
    void MailFetchSelected(const char *user);
    void MailFetchModify();
    void MailFetchRead(pop_host *host, EditFetch *dialog);

private:
    QListBox *fetchers_;
    KNumericSpinBox *pollTime_;
};
