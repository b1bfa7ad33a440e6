#pragma once

#include "platform/kconfigwidget.h"
#include "widgets/settingsform.h"

/// The IMAP server's page.
class MailIMAP : public KConfigWidget {
    Q_OBJECT

public:
    MailIMAP(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override { form_.store(); }

private:
    SettingsForm form_;
};
