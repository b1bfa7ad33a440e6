#pragma once

#include "platform/kconfigwidget.h"
#include "widgets/settingsform.h"

/// The POP3 server's page.
class MailPOP3 : public KConfigWidget {
    Q_OBJECT

public:
    MailPOP3(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override { form_.store(); }

private:
    SettingsForm form_;
};
