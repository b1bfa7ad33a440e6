#include "config/productpaths.h"

ProductPaths productPaths() {
    // The quotes are for a prefix with blanks; the build refuses one that holds a quote.
    return {TARVEX_PREFIX "/config/master", TARVEX_PREFIX "/config/templates/master",
            "'" TARVEX_PREFIX "/bin/tvxreconf'"};
}
