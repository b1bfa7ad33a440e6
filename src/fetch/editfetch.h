#pragma once

#include "widgets/formdialog.h"

struct pop_host;

/// Asks for one fetcher. The fields take only what the fetcher list can carry.
class EditFetch : public FormDialog {
    Q_OBJECT

public:
    /// `host` is what the fields start with; null for empty fields.
    EditFetch(QWidget *parent, const char *name, const pop_host *host);

    void store(pop_host &host) const;

private:
    TextField *server_;
    TextField *user_;
    TextField *password_;
};
