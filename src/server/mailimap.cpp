#include "server/mailimap.h"

#include "server/serverform.h"

MailIMAP::MailIMAP(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "IMAP Server Settings",
                       {.enabled = settings().imap_sock_enabled,
                        .port = settings().imap_sock_port,
                        .timeout = settings().imap_sock_timeout,
                        .maximum = settings().imap_sock_max,
                        .allow = settings().imap_allow,
                        .auth = nullptr,
                        .block = settings().imap_block})} {
    form_.pageLayout()->addStretch();
}
