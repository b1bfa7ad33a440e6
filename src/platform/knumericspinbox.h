#pragma once

#include <QSpinBox>

/// A field for a whole number. A stored value outside the range is shown as it is and given back
/// unchanged until the user changes it; whatever the user enters is inside the range. The wheel
/// changes it only when it has the focus.
class KNumericSpinBox : public QSpinBox {
    Q_OBJECT

public:
    explicit KNumericSpinBox(QWidget *parent = nullptr);

    /// To be called before setValue; both ends belong to the range.
    void setRange(int minimum, int maximum);
    void setStep(int step) { setSingleStep(step); }
    void setValue(int value);
    [[nodiscard]] int getValue() const { return value(); }
    /// Whether the number can be typed, rather than only stepped.
    void setEditable(bool editable);

protected:
    void wheelEvent(QWheelEvent *event) override;

private:
    void confine(int value);

    int minimum_ = 0;
    int maximum_ = 0;
    int stored_ = 0;
};
