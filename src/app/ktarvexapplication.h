#pragma once

#include "platform/kcontrolapplication.h"

#include <array>

class KConfigWidget;

/// Reads the product's files, shows the seven pages on them, and writes the files on apply.
class KTarvexApplication : public KControlApplication {
public:
    KTarvexApplication(int &argc, char **argv, const char *name);

    /// Every page that exists stores its values; then the four files are written, the master file
    /// last, and the product's services told to read them.
    void applyChanges() override;

private:
    void showNote();

    // In the order of the tabs. Null until created, and for good when the command line names other
    // pages. The dialog owns them.
    std::array<KConfigWidget *, 7> pages_{};
};
