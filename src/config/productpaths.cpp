#include "config/productpaths.h"

ProductPaths productPaths() {
    // The quotes are for a prefix with blanks; the build refuses one that holds a quote.
    return {.master = TARVEX_PREFIX "/config/master",
            .masterTemplate = TARVEX_PREFIX "/config/templates/master",
            .reconfigureCommand = "'" TARVEX_PREFIX "/bin/tvxreconf'"};
}
