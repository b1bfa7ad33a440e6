#pragma once

#include "widgets/captions.h"
#include "widgets/pagelayout.h"

#include <QDialog>

#include <string_view>
#include <vector>

class QFrame;
class QHBoxLayout;
class QPushButton;
class QVBoxLayout;
class TextField;

/// What all edit dialogs are made of: a raised panel with the rows on it and, below, "OK" and
/// "Cancel". A dialog collects input and applies nothing; who opened it reads it when it was
/// accepted. It is modal to the windows that it was opened from; the help window stays usable.
class FormDialog : public QDialog {
public:
    static constexpr int fieldHeight = 25;

protected:
    FormDialog(QWidget *parent, const char *name, const char *caption);

    /// The rows on the panel, from top to bottom.
    [[nodiscard]] QVBoxLayout *rows() const { return rows_; }
    QHBoxLayout *addRow() { return newRow(rows_); }

    /// A row of a label and a line edit showing `bytes`; the label is the edit's buddy. `label` is
    /// the label's minimum size.
    TextField *addField(TranslatableText caption, QSize label, std::string_view bytes);
    /// The same in a row that is there already, and in a column of captions.
    TextField *addField(QHBoxLayout *row, TranslatableText caption, CaptionColumn &captions,
                        std::string_view bytes);
    /// The push button "Browse..." behind the field with that caption, and as high as it is.
    QPushButton *addBrowseButton(QHBoxLayout *row, int width, TranslatableText caption,
                                 const TextField *field);
    /// As high as the fields.
    void addAsField(QHBoxLayout *row, QWidget *widget);

    /// To be called when all rows are there, so that the buttons come last with Tab as well. The
    /// numbers are pixels; `aboveButtons` is what lies between rows and buttons.
    void addButtons(int aboveRows, int aboveButtons, int belowButtons = 0);

    /// Fixes the dialog's size and with it the panel's; both grow by what a larger font needs
    /// more. Where the panel would reach into the button row, it ends above it.
    void fixSize(QSize dialog, QSize panel);

    /// Does not close on a text that its field's rule refuses.
    void accept() override;
    void resizeEvent(QResizeEvent *event) override;

private:
    std::vector<TextField *> fields_;
    QFrame *panel_;
    QVBoxLayout *layout_;
    QVBoxLayout *rows_;
    QHBoxLayout *buttons_;
    QSize besidePanel_{0, 0}; ///< What the dialog has more than the panel.
};

/// Lets the user pick a file, beginning with the one that the field names, and puts its path into
/// the field; a cancelled choice leaves the field as it is.
void browseForFile(TextField *field, QWidget *parent);

/// The same for a directory; the chooser is named "browse".
void browseForDirectory(TextField *field, QWidget *parent);
