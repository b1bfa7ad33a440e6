#pragma once

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
