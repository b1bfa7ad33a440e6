#include "app/ktarvexapplication.h"

#include "alias/aliasfile.h"
#include "alias/mailalias.h"
#include "base/textfile.h"
#include "config/masterfile.h"
#include "config/productpaths.h"
#include "config/settings.h"
#include "fetch/mailfetch.h"
#include "fetch/pophosts.h"
#include "lists/maillist.h"
#include "lists/maillistfile.h"
#include "platform/process.h"
#include "server/maildebatch.h"
#include "server/mailimap.h"
#include "server/mailpop3.h"
#include "server/mailsmtp.h"
#include "server/smtprejectfile.h"

#include <new>

namespace {

void readFiles() {
    readMasterConfig();
    readAliasFile();
    readSmtpRejectFile();
    readMailListFile();
    parsePopHosts(settings().pop_hosts.value);
}

/// A signal that ends the program does so between two applies, not between two files.
void writeFiles(bool areSettingsStored) {
    const EndSignalsHeld held;
    writeAliasFile();
    writeSmtpRejectFile();
    writeMailListFile();
    if (areSettingsStored) {
        writeMasterConfig();
    }
}

} // namespace

KTarvexApplication::KTarvexApplication(int &argc, char **argv, const char *name)
    : KControlApplication{
          argc,
          argv,
          name,
          {"smtpserver", "pop3server", "imapserver", "fetch", "debatch", "alias", "list"}} {
    readFiles();
    if (isInitOnly()) {
        return;
    }
    createPage(smtp_, "smtpserver", "&SMTP", "tarvex-mail-smtp.html");
    createPage(pop3_, "pop3server", "&POP3", "tarvex-mail-pop3.html");
    createPage(imap_, "imapserver", "&IMAP", "tarvex-mail-imap.html");
    createPage(fetch_, "fetch", "Fetchers", "tarvex-mail-fetchers.html");
    createPage(delivery_, "debatch", "&Delivery", "tarvex-mail-delivery.html");
    createPage(alias_, "alias", "&Aliasing", "tarvex-mail-alias.html");
    createPage(lists_, "list", "&Mail List", "tarvex-mail-list.html");
    if (!mayRewrite(productPaths().master)) {
        setNote(getLocale()->translate(
            translatable("Changes cannot be saved: this user may not write the master file.")));
    }
    showDialog();
}

void KTarvexApplication::applyChanges() {
    // Delivery stores before the fetchers, unlike the order of the tabs.
    bool areSettingsStored = true;
    for (KConfigWidget *page : std::initializer_list<KConfigWidget *>{
             smtp_, pop3_, imap_, delivery_, fetch_, alias_, lists_}) {
        try {
            if (page != nullptr) {
                page->storeValues();
            }
        } catch (const std::bad_alloc &) { // What a page could not store is still in its fields.
            areSettingsStored = false;
        }
    }
    writeFiles(areSettingsStored);
    // What the command reports is its own business; the files are written whatever it says.
    runShellCommand(productPaths().reconfigureCommand);
}

template <class Page>
void KTarvexApplication::createPage(Page *&page, const char *name, const char *label,
                                    const char *helpFile) {
    if (isPageRequested(name)) {
        page = new Page(dialog(), name);
        addPage(page, label, helpFile);
    }
}
