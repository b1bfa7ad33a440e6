#pragma once

#include <QString>

#include <string>

/// A text that is shown in the user's language: the literal is marked where it stands, so that the
/// tool that collects the messages finds it.
class TranslatableText {
public:
    [[nodiscard]] const char *literal() const { return literal_; }

private:
    explicit constexpr TranslatableText(const char *literal) : literal_{literal} {}
    friend constexpr TranslatableText translatable(const char *literal);

    const char *literal_;
};

/// The mark. `literal` must be a string literal.
constexpr TranslatableText translatable(const char *literal) { return TranslatableText{literal}; }

/// The language of the user's messages.
class KLocale {
public:
    /// The text in the user's language, or the text itself where no translation is installed.
    [[nodiscard]] QString translate(const char *text) const;
    [[nodiscard]] QString translate(TranslatableText text) const {
        return translate(text.literal());
    }

    /// Finds the messages of the text domain `name` in `directory`.
    void open(const QString &name, const QString &directory);

private:
    std::string domain_;
};
