#include "app/ktarvexapplication.h"

#include "alias/aliasfile.h"
#include "alias/mailalias.h"
#include "app/applynote.h"
#include "base/textfile.h"
#include "config/masterfile.h"
#include "config/productpaths.h"
#include "config/settings.h"
#include "fetch/mailfetch.h"
#include "fetch/pophosts.h"
#include "lists/maillist.h"
#include "lists/maillistfile.h"
#include "platform/kconfigwidget.h"
#include "platform/kcontroldialog.h"
#include "platform/process.h"
#include "server/maildebatch.h"
#include "server/mailimap.h"
#include "server/mailpop3.h"
#include "server/mailsmtp.h"
#include "server/smtprejectfile.h"

namespace {

/// A signal that ends the program does so between two applies, not between two files, and when the
/// services were told to read them. Two programs' applies do not mix.
pid_t writeFilesAndStartCommand() {
    const std::shared_ptr<void> lock = lockFolderOf(productPaths().master);
    const EndSignalsHeld held;
    writeAliasFile();
    writeSmtpRejectFile();
    writeMailListFile();
    writeMasterConfig();
    return EndSignalsHeld::startShellCommand(productPaths().reconfigureCommand);
}

struct PageRow {
    KConfigWidget *(*newPage)(QWidget *parent, const char *name);
    const char *name;
    const char *label;
    const char *helpFile;
};

template <class Page>
constexpr PageRow pageRow(const char *name, const char *label, const char *helpFile) {
    const auto newPage = [](QWidget *parent, const char *ownName) -> KConfigWidget * {
        return new Page(parent, ownName);
    };
    return {.newPage = newPage, .name = name, .label = label, .helpFile = helpFile};
}

/// In the order of the tabs.
constexpr std::array pageRows{
    pageRow<MailSMTP>("smtpserver", "&SMTP", "tarvex-mail-smtp.html"),
    pageRow<MailPOP3>("pop3server", "&POP3", "tarvex-mail-pop3.html"),
    pageRow<MailIMAP>("imapserver", "&IMAP", "tarvex-mail-imap.html"),
    pageRow<MailFetch>("fetch", "Fetchers", "tarvex-mail-fetchers.html"),
    pageRow<MailDebatch>("debatch", "&Delivery", "tarvex-mail-delivery.html"),
    pageRow<MailAlias>("alias", "&Aliasing", "tarvex-mail-alias.html"),
    pageRow<MailList>("list", "&Mail List", "tarvex-mail-list.html")};

/// Delivery stores before the fetchers, unlike the order of the tabs.
constexpr std::array<std::size_t, pageRows.size()> storeOrder{0, 1, 2, 4, 3, 5, 6};

QStringList pageNames() {
    QStringList names;
    for (const PageRow &row : pageRows) {
        names << row.name;
    }
    return names;
}

} // namespace

KTarvexApplication::KTarvexApplication(int &argc, char **argv, const char *name)
    : KControlApplication{argc, argv, name, pageNames()} {
    readMasterConfig();
    readAliasFile();
    readSmtpRejectFile();
    readMailListFile();
    const std::size_t unread = parsePopHosts(settings().pop_hosts.value);
    // Without their page an apply leaves the fetchers' text as it is.
    lostSettings.fetchers = isPageRequested("fetch") ? unread : 0;
    if (isInitOnly()) {
        return;
    }
    for (std::size_t index = 0; index < pageRows.size(); ++index) {
        const PageRow &row = pageRows.at(index);
        if (isPageRequested(row.name)) {
            pages_.at(index) = row.newPage(dialog(), row.name);
            addPage(pages_.at(index), row.label, row.helpFile);
        }
    }
    showNote();
    showDialog();
}

void KTarvexApplication::showNote() {
    constexpr int namesInLine = 3;
    constexpr int namesInTip = 20;
    dialog()->setNote(applyNote(namesInLine), applyNote(namesInTip));
}

void KTarvexApplication::applyChanges() {
    for (const std::size_t index : storeOrder) {
        if (KConfigWidget *page = pages_.at(index)) {
            page->storeValues();
        }
    }
    // What the command reports is its own business; the files are written whatever it says.
    waitForCommand(writeFilesAndStartCommand());
    showNote();
}
