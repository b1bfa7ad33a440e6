#pragma once

#include "fetch/pophosts.h"
#include "platform/kconfigwidget.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

class EditFetch;
class KNumericSpinBox;

/// The page of the mailboxes that mail is collected from. Its list is edited in place; the setting
/// that holds it is written when the page stores its values.
class MailFetch : public KConfigWidget {
    Q_OBJECT

public:
    MailFetch(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override;

public slots:
    void MailFetchAdd();
    void MailFetchRemove();
    void MailFetchSelected(const char *user);
    void MailFetchModify();
    void MailFetchRead(pop_host *host, EditFetch *dialog);

private:
    ListGroup *group_;
    RecordRows<MailFetch, pop_host, EditFetch, std::string_view> fetchers_;
    KNumericSpinBox *pollTime_;
};
