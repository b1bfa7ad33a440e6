#include "server/mailpop3.h"

#include "server/serverform.h"

MailPOP3::MailPOP3(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "POP3 Server Settings",
                       {.enabled = settings().pop_sock_enabled,
                        .port = settings().pop_sock_port,
                        .timeout = settings().pop_sock_timeout,
                        .maximum = settings().pop_sock_max,
                        .allow = settings().pop_allow,
                        .auth = nullptr,
                        .block = settings().pop_block})} {
    form_.pageLayout()->addStretch();
}
