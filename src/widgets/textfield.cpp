#include "widgets/textfield.h"

#include "platform/bytetext.h"
#include "widgets/captions.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QScreen>
#include <QToolTip>
#include <QValidator>
#include <QWindow>

#include <algorithm>

namespace {

constexpr std::size_t bytesShownOfLonger = 1'000;

/// How far below the point that it is shown for the toolkit puts a tip: the height of a pointer.
constexpr int maximumBelowPoint = 32;
/// The tip's frame and margins on both sides together.
constexpr int tipPadding = 12;

std::size_t byteCount(QStringView text) { return bytesFromText(text).size(); }

} // namespace

class TextField::Validator : public QValidator {
public:
    using QValidator::QValidator;

    void setShown(const QString &text) { shown_ = text; }
    void setRule(const FieldRule &rule) { rule_ = rule; }

    State validate(QString &input, int & /*position*/) const override {
        const QString first = input.left(1);
        if ((!first.isEmpty() && first != shown_.left(1) && rule_.refusedFirst.contains(first)) ||
            std::ranges::any_of(input, [this](QChar character) {
                return rule_.refused.contains(character) && !shown_.contains(character);
            })) {
            refusal_ = rule_.toolTip;
            return Invalid;
        }
        const std::size_t maximum = std::max(rule_.maximumBytes, byteCount(shown_));
        refusal_ = lengthRule(maximum).toolTip;
        return byteCount(input) > maximum ? Invalid : Acceptable;
    }

    /// Why the last text was refused that was.
    [[nodiscard]] const QString &refusal() const { return refusal_; }

private:
    FieldRule rule_;
    QString shown_; ///< By the program; what it holds may stay.
    mutable QString refusal_;
};

FieldRule lengthRule(std::size_t maximumBytes) {
    return {.toolTip = translated(translatable("At most %1 bytes")).arg(maximumBytes),
            .maximumBytes = maximumBytes};
}

TextField::TextField(QWidget *parent) : QLineEdit(parent), validator_{new Validator(this)} {
    // The edit cuts beyond this, which the rule then refuses: every character is a byte or more.
    setMaxLength(static_cast<int>(FieldRule::longestEditable) + 1);
    setValidator(validator_);
    connect(this, &QLineEdit::inputRejected, this, [this] { showTip(validator_->refusal()); });
}

void TextField::showBytes(std::string_view bytes) {
    const bool isTooLong = bytes.size() > FieldRule::longestEditable;
    const QString shown =
        textFromBytes(bytes.substr(0, isTooLong ? bytesShownOfLonger : bytes.size()));
    validator_->setShown(shown);
    setText(shown);
    setCursorPosition(0);
    setReadOnly(isTooLong);
    if (isTooLong) {
        setToolTip(translated(translatable("Too long to be edited here: this is its beginning")));
        QPalette unchangeable;
        unchangeable.setColor(QPalette::Base, palette().color(QPalette::Window));
        setPalette(unchangeable);
    }
}

void TextField::setRule(const FieldRule &rule) {
    validator_->setRule(rule);
    if (!rule.toolTip.isEmpty() && !showsPartOnly()) {
        setToolTip(rule.toolTip);
    }
}

std::string TextField::bytes() const {
    std::string bytes = bytesFromText(text());
    std::ranges::replace_if(
        bytes, [](char byte) { return byte == '\r' || byte == '\n' || byte == '\0'; }, ' ');
    return bytes;
}

KeptText TextField::keptText(KeptText before) const {
    if (showsPartOnly()) {
        return before;
    }
    const std::string typed = bytes();
    return typed == std::string_view{before} ? before : keep(typed);
}

void TextField::replaceText(const QString &text) {
    if (takes(text) && !showsPartOnly()) {
        setText(text);
    }
}

bool TextField::takes(QString text) const {
    int position = 0;
    if (showsPartOnly() || validator_->validate(text, position) == QValidator::Acceptable) {
        return true;
    }
    showTip(validator_->refusal());
    return false;
}

void TextField::showTip(const QString &tip) const {
    const QRect frame = window()->frameGeometry();
    const QRect available = screen()->availableGeometry();
    const QSize size = QFontMetrics{QToolTip::font()}.size(0, tip) + QSize{tipPadding, tipPadding};
    const QPoint field = mapToGlobal(QPoint{0, 0});
    QPoint at{field.x(), frame.top() - maximumBelowPoint - size.height()};
    if (frame.right() + tipPadding + size.width() <= available.right()) {
        at = {frame.right(), field.y() - maximumBelowPoint / 2};
    } else if (frame.bottom() + maximumBelowPoint + size.height() <= available.bottom()) {
        at = {field.x(), frame.bottom()};
    }
    QToolTip::showText(at, tip);
    if (!isActiveWindow()) {
        // As after a chooser: the tip goes when the window becomes active again.
        connect(
            qGuiApp, &QGuiApplication::focusWindowChanged, this, [this, tip] { showTip(tip); },
            static_cast<Qt::ConnectionType>(Qt::QueuedConnection | Qt::SingleShotConnection));
    }
}

bool TextField::event(QEvent *event) {
    if (event->type() == QEvent::ToolTip && !toolTip().isEmpty()) {
        showTip(toolTip());
        return true;
    }
    return QLineEdit::event(event);
}

void TextField::keyPressEvent(QKeyEvent *event) {
    const bool isForDialog = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter ||
                             event->key() == Qt::Key_Escape;
    if (showsPartOnly() && !event->text().isEmpty() && !isForDialog) {
        showTip(toolTip()); // Copying, too, takes the beginning only.
    }
    QLineEdit::keyPressEvent(event);
}
