#include "server/serverform.h"

namespace {

constexpr int labelWidth = 130;

} // namespace

SettingsForm serverForm(QWidget *page, const char *caption, const ServerSettings &server) {
    SettingsForm form{page, labelWidth};
    form.group(caption);
    form.checkBox("Enable server", server.enabled);
    form.number("&Port:", 0, 65535, server.port);
    form.number("&Timeout (secs):", 0, 999, server.timeout);
    form.number("&Max Connections:", 0, 1024, server.maximum);
    form.accessList("&Allow Access:", server.allow);
    if (server.auth != nullptr) {
        form.accessList("A&uth Access:", *server.auth);
    }
    form.accessList("&Block Access:", server.block);
    return form;
}
