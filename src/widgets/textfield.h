#pragma once

#include "base/kepttext.h"

#include <QLineEdit>

#include <cstddef>
#include <string>
#include <string_view>

/// What a field takes from the user, because the file could not carry more. The text that the
/// program shows stays as it is, whatever the rule, and what it holds against the rule may stay in
/// what is typed.
struct FieldRule {
    /// Beyond this a line edit takes too long for a keystroke.
    static constexpr std::size_t longestEditable = 100'000;

    QString refused{};      ///< Characters that the text must not hold.
    QString refusedFirst{}; ///< Characters that it must not begin with.
    QString toolTip{};      ///< Says so; it appears at the field when they are typed.
    std::size_t maximumBytes = longestEditable; ///< Or as many as the text had that was shown.
};

/// A rule for a text of at most `maximumBytes`, and nothing else.
FieldRule lengthRule(std::size_t maximumBytes);

/// A line edit for bytes: the only way of a text into a record or a setting. What the user types or
/// pastes against its rule it refuses whole, and says why beside its window: a tool tip below the
/// field would cover the next one and take its click. It cuts nothing.
class TextField : public QLineEdit {
    Q_OBJECT

public:
    explicit TextField(QWidget *parent);

    /// Of a text that is too long to be edited only the beginning is shown: the field looks so, and
    /// says why when a key is pressed in it.
    void showBytes(std::string_view bytes);
    /// Whether the field was given a text that it does not show whole; then that text still holds.
    [[nodiscard]] bool showsPartOnly() const { return isReadOnly(); }

    void setRule(const FieldRule &rule);

    /// The text without what no record and no setting may hold: a line edit keeps pasted line
    /// breaks (and NUL), which become blanks here. Not to be called when the field shows a part
    /// only.
    [[nodiscard]] std::string bytes() const;
    /// The text as a record takes it, which held `before` when the field was filled. A text that
    /// was not changed is that one again, however long.
    [[nodiscard]] KeptText keptText(KeptText before) const;

    /// Whether the text is one that the rule refuses, which it can be when neither keys nor
    /// clipboard put it there; says why then.
    [[nodiscard]] bool holdsRefusedText() const { return !takes(text()); }
    /// Puts in what the user chose elsewhere; when the rule refuses it, the field stays as it is
    /// and says why.
    void replaceText(const QString &text);

    void showTip(const QString &tip) const;

protected:
    bool event(QEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    [[nodiscard]] bool takes(QString text) const;

    class Validator;
    Validator *validator_;
};
