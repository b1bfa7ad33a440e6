#pragma once

#include "base/translatable.h"

#include <QString>

#include <string>

/// The language of the user's messages.
class KLocale {
public:
    /// The text in the user's language, or the text itself where no translation is installed.
    [[nodiscard]] QString translate(TranslatableText text) const;

    /// Finds the messages of the text domain `name` in `directory`.
    void open(const QString &name, const QString &directory);

private:
    std::string domain_;
};
