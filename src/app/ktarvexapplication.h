#pragma once

#include "platform/kcontrolapplication.h"

class MailAlias;
class MailDebatch;
class MailFetch;
class MailIMAP;
class MailList;
class MailPOP3;
class MailSMTP;

/// Reads the product's files, shows the seven pages on them, and writes the files on apply.
class KTarvexApplication : public KControlApplication {
public:
    KTarvexApplication(int &argc, char **argv, const char *name);

    /// Every page that exists stores its values; then the four files are written, the master file
    /// last, and the product's services told to read them.
    void applyChanges() override;

private:
    template <class Page>
    void createPage(Page *&page, const char *name, const char *label, const char *helpFile);

    // Null until created, and for good when the command line names other pages. The dialog owns
    // them.
    MailSMTP *smtp_ = nullptr;
    MailPOP3 *pop3_ = nullptr;
    MailIMAP *imap_ = nullptr;
    MailFetch *fetch_ = nullptr;
    MailDebatch *delivery_ = nullptr;
    MailAlias *alias_ = nullptr;
    MailList *lists_ = nullptr;
};
