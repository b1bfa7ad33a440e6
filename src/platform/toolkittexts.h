#pragma once

/// Gives the application the toolkit's own texts (buttons, choosers, menus of fields) in the user's
/// language, where they are installed and that is another than the toolkit's.
void installToolkitTexts();
