#pragma once

#include "platform/klocale.h"

#include <memory>

class QCoreApplication;

/// The process's toolkit application. Its construction takes the process's locale from the
/// environment, so character classes follow that from then on; only the keys' letters are compared
/// alike in every locale.
///
/// What runs out of memory (std::bad_alloc) while an event is answered ends with that event.
class KApplication {
public:
    /// Without a display (`hasDisplay` false) there are no widgets, but the locale and the paths
    /// are the same. `name` is the application's name and its text domain. A display that cannot be
    /// opened ends the process.
    KApplication(const char *program, const char *name, bool hasDisplay);
    virtual ~KApplication();

    static KLocale *getLocale();

    /// The folder or file `name` among what is installed beside the program (share/...). It is
    /// found from the program's own place, so that a build tree works like an installation.
    static QString shared(const QString &name);

    [[nodiscard]] QString name() const;

private:
    // The toolkit keeps references to both. No argument reaches it: all are the application's own.
    int toolkitArgumentCount_ = 1;
    char *toolkitArguments_[2]{};
    std::unique_ptr<QCoreApplication> toolkit_;
};
