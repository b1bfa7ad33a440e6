#include "widgets/fieldrule.h"

#include "platform/bytetext.h"
#include "widgets/fieldtext.h"
#include "widgets/fieldtip.h"

#include <QLineEdit>
#include <QValidator>

#include <algorithm>

namespace {

class RuleValidator : public QValidator {
public:
    RuleValidator(QLineEdit *field, const FieldRule &rule)
        : QValidator(field),
          rule_{rule},
          textSet_{field->text()},
          mostBytes_{
              std::max(rule.mostBytes, static_cast<qsizetype>(bytesFromText(textSet_).size()))} {}

    State validate(QString &input, int &position) const override {
        refusal_ = rule_.toolTip;
        const QString first = input.left(1);
        if ((!first.isEmpty() && first != textSet_.left(1) && rule_.refusedFirst.contains(first)) ||
            std::ranges::any_of(input, [this](QChar character) {
                return rule_.refused.contains(character) && !textSet_.contains(character);
            })) {
            return Invalid;
        }
        if (rule_.mostBytes > 0) {
            cutToFit(input, position);
        }
        if (isTooLong(input)) {
            refusal_ = QStringLiteral("At most %1 bytes").arg(mostFieldBytes);
            return Invalid;
        }
        return Acceptable;
    }

    /// Why the last text was refused that was.
    [[nodiscard]] const QString &refusal() const { return refusal_; }

private:
    /// The bytes are counted only where there may be too many: no character has more than four,
    /// and those of four count as two.
    static bool isTooLong(const QString &input) {
        return 3 * static_cast<std::size_t>(input.size()) > mostFieldBytes &&
               bytesFromText(input).size() > mostFieldBytes;
    }

    /// What was put in ends at `position`: there it is cut, so that nothing that stood in the field
    /// before is pushed out.
    void cutToFit(QString &input, int &position) const {
        auto excess = static_cast<qsizetype>(bytesFromText(input).size()) - mostBytes_;
        int kept = position;
        while (excess > 0 && kept > 0) {
            const bool isPair = kept > 1 && input.at(kept - 1).isLowSurrogate() &&
                                input.at(kept - 2).isHighSurrogate();
            const int length = isPair ? 2 : 1;
            kept -= length;
            excess -=
                static_cast<qsizetype>(bytesFromText(QStringView{input}.mid(kept, length)).size());
        }
        input.remove(kept, position - kept);
        position = kept;
    }

    FieldRule rule_;
    QString textSet_;
    qsizetype mostBytes_; ///< What was stored longer may be edited, but not grow.
    mutable QString refusal_;
};

void showRefusal(const QLineEdit *field) {
    showFieldTip(field, static_cast<const RuleValidator *>(field->validator())->refusal());
}

} // namespace

FieldRule lengthRule(std::size_t mostBytes) {
    return {{},
            {},
            static_cast<qsizetype>(mostBytes),
            QStringLiteral("At most %1 bytes").arg(mostBytes)};
}

void applyRule(QLineEdit *field, const FieldRule &rule) {
    if (field->isReadOnly()) {
        return;
    }
    if (!rule.toolTip.isEmpty()) {
        setFieldTip(field, rule.toolTip);
    }
    const bool isFirstRule = field->validator() == nullptr;
    delete field->validator();
    field->setValidator(new RuleValidator(field, rule));
    if (isFirstRule) {
        QObject::connect(field, &QLineEdit::inputRejected, field, [field] { showRefusal(field); });
    }
}

bool holdsRefusedText(const QLineEdit *field) {
    QString accepted = field->text();
    int position = static_cast<int>(accepted.size());
    if (field->isReadOnly() || field->validator() == nullptr ||
        (field->validator()->validate(accepted, position) == QValidator::Acceptable &&
         accepted == field->text())) {
        return false;
    }
    showRefusal(field);
    return true;
}

void replaceByRule(QLineEdit *field, const QString &text) {
    if (field->isReadOnly()) {
        return;
    }
    const QString before = field->text();
    field->setText(text);
    if (field->text() != text) { // It was cut, and would lead elsewhere.
        showRefusal(field);
    } else if (!holdsRefusedText(field)) {
        return;
    }
    field->setText(before);
}
