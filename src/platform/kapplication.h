#pragma once

#include <QString>

#include <memory>
#include <string>

class QCoreApplication;
class QTranslator;

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

/// The process's toolkit application. Its construction takes the process's locale from the
/// environment, so character classes follow that from then on; only the keys' letters are compared
/// alike in every locale.
///
/// A key that is held down presses a button once. What runs out of memory (std::bad_alloc) while an
/// event is answered ends with that event.
class KApplication {
public:
    /// Without a display (`hasDisplay` false) there are no widgets, but the locale and the paths
    /// are the same. `name` is the application's name and its text domain. A display that cannot be
    /// opened ends the process with 1 and one line on standard error.
    KApplication(const char *program, const char *name, bool hasDisplay);
    KApplication(const KApplication &) = delete;
    KApplication &operator=(const KApplication &) = delete;
    virtual ~KApplication();

    static KLocale *getLocale();

    /// Drops the keys and clicks that have arrived and were not answered yet.
    static void dropPendingInput();

    /// The folder or file `name` among what is installed beside the program (share/...). It is
    /// found from the program's own place, so that a build tree works like an installation.
    static QString shared(const QString &name);

    /// The name that the application was made with.
    [[nodiscard]] QString name() const;

private:
    // The toolkit keeps references to both. No argument reaches it: all are the application's own.
    int toolkitArgumentCount_ = 1;
    char *toolkitArguments_[2]{};
    std::unique_ptr<QCoreApplication> toolkit_;
    std::unique_ptr<QTranslator> toolkitTexts_; ///< Null in the toolkit's own language.
};
