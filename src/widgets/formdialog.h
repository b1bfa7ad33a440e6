#pragma once

#include "widgets/captions.h"

#include <QDialog>

#include <string_view>

class QFrame;
class QHBoxLayout;
class QLineEdit;
class QPushButton;
class QVBoxLayout;

/// What all edit dialogs are made of: a raised panel with the rows on it and, below, "OK" and
/// "Cancel". A dialog collects input and applies nothing; who opened it reads it when it was
/// accepted.
class FormDialog : public QDialog {
public:
    static constexpr int fieldHeight = 25;

protected:
    FormDialog(QWidget *parent, const char *name, const char *caption);

    /// Fixes the dialog's size and the panel's. Where the panel would reach into the button row, it
    /// ends above it.
    void fixSize(QSize dialog, QSize panel);

    /// The rows on the panel, from top to bottom.
    [[nodiscard]] QVBoxLayout *rows() const { return rows_; }
    QHBoxLayout *addRow();

    /// A row of a label and a line edit showing `bytes`; the label is the edit's buddy. A caption
    /// that is wider than `label` keeps its width.
    QLineEdit *addField(const char *caption, QSize label, std::string_view bytes);
    /// The same in a row that is there already. The caption is translated.
    QLineEdit *addField(QHBoxLayout *row, const char *caption, QSize label, std::string_view bytes);

    /// To be called when all rows are there, so that the buttons come last with Tab as well.
    void addButtonRow();

private:
    QFrame *panel_;
    QVBoxLayout *rows_;
};

/// The push button "Browse..." at the end of a row.
QPushButton *addBrowseButton(QHBoxLayout *row, int width, QWidget *parent);

/// Whether a file dialog's answer names the file that was picked: there is none after "Cancel", and
/// the toolkit replaces bytes of the name that are not UTF-8.
bool isWholePath(const QString &path);

/// Lets the user pick a file, beginning with the one that the field names, and puts its path into
/// the field; a cancelled choice leaves the field as it is.
void browseForFile(QLineEdit *field, QWidget *parent);
