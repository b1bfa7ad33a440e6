#pragma once

#include "widgets/settingsform.h"

/// The settings that every mail server has.
struct ServerSettings {
    BoolSetting &enabled;
    NumberSetting &port;
    NumberSetting &timeout; ///< Seconds.
    NumberSetting &maximum;
    AccessListSetting &allow;
    AccessListSetting *auth; ///< Null for a server without one.
    AccessListSetting &block;
};

SettingsForm serverForm(QWidget *page, const char *caption, const ServerSettings &server);
