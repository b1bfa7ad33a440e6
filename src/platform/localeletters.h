#pragma once

/// Where the locale lower-cases a letter of the settings' keys in a way of its own, as the Turkish
/// ones do with I, this thread compares and classifies characters by the C locale's table from here
/// on. To be called when the process's locale is set.
void usePlainLettersForKeys();
