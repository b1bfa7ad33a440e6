#include "widgets/fieldrule.h"

#include "platform/bytetext.h"
#include "widgets/fieldtip.h"

#include <QLineEdit>
#include <QValidator>

#include <algorithm>

namespace {

class RuleValidator : public QValidator {
public:
    RuleValidator(QLineEdit *field, const FieldRule &rule)
        : QValidator(field), rule_{rule}, textSet_{field->text()} {}

    State validate(QString &input, int &position) const override {
        const QString first = input.left(1);
        if ((!first.isEmpty() && first != textSet_.left(1) && rule_.refusedFirst.contains(first)) ||
            std::ranges::any_of(input, [this](QChar character) {
                return rule_.refused.contains(character) && !textSet_.contains(character);
            })) {
            return Invalid;
        }
        cutToFit(input, position);
        return Acceptable;
    }

private:
    /// What was put in ends at `position`: there it is cut, so that nothing that stood in the field
    /// before is pushed out.
    void cutToFit(QString &input, int &position) const {
        auto excess = static_cast<qsizetype>(bytesFromText(input).size()) - rule_.mostBytes;
        int kept = position;
        while (rule_.mostBytes > 0 && excess > 0 && kept > 0) {
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
};

} // namespace

void applyRule(QLineEdit *field, const FieldRule &rule) {
    if (field->isReadOnly()) {
        return;
    }
    setFieldTip(field, rule.toolTip);
    field->setValidator(new RuleValidator(field, rule));
    QObject::connect(field, &QLineEdit::inputRejected, field, [field] { showFieldTip(field); });
}

void replaceByRule(QLineEdit *field, const QString &text) {
    if (field->isReadOnly()) {
        return;
    }
    QString accepted = text;
    int position = static_cast<int>(text.size());
    if (field->validator() != nullptr &&
        field->validator()->validate(accepted, position) != QValidator::Acceptable) {
        showFieldTip(field);
        return;
    }
    field->setText(accepted);
}
