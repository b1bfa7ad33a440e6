#pragma once

/// Where the product keeps what this program reads, writes and runs. Built in, so that nothing at
/// run time turns an administrator's apply towards other files.
struct ProductPaths {
    const char *master;
    const char *masterTemplate;
    const char *reconfigureCommand; ///< A shell command.
};

ProductPaths productPaths();
