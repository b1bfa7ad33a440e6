#pragma once

#include "platform/kconfigwidget.h"
#include "widgets/settingsform.h"

/// The page of what happens to mail between collecting and sending it.
class MailDebatch : public KConfigWidget {
    Q_OBJECT

public:
    MailDebatch(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override { form_.store(); }

private:
    SettingsForm form_;
};
