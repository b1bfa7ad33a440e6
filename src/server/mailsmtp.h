#pragma once

#include "platform/kconfigwidget.h"
#include "server/smtprejectfile.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"
#include "widgets/settingsform.h"

class EditSMTP;

/// The SMTP server's page: its settings, and its block list, which is edited in place.
class MailSMTP : public KConfigWidget {
    Q_OBJECT

public:
    MailSMTP(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override { form_.store(); }

public slots:
    void Add();
    void Remove();
    void Selected(const char *text);
    void Modify();
    void Read(smtpreject_entry *entry, EditSMTP *dialog);

private:
    SettingsForm form_;
    ListGroup *group_;
    RecordRows<MailSMTP, smtpreject_entry, EditSMTP> rejects_;
};
