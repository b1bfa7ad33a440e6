#pragma once

#include "config/settings.h"
#include "widgets/captions.h"

#include <QVBoxLayout>

#include <functional>
#include <vector>

class QGroupBox;
class QHBoxLayout;
class QWidget;
class TextField;

/// The groups of captions and fields on a page that edit settings. Each row names its widget and
/// its setting once: it is filled when it is made, and `store` hands it back. A caption's "&" marks
/// the letter that moves the focus to its field.
class SettingsForm {
public:
    /// Lays out `page`. Captions are at least `labelWidth` pixels wide.
    SettingsForm(QWidget *page, int labelWidth);

    /// Begins a group; the rows after it stand in it.
    void group(const char *caption);
    void checkBox(const char *caption, BoolSetting &setting);
    /// `note`, where given, stands behind the field. A stored number outside the range stays as it
    /// is until the user changes it.
    void number(const char *caption, int minimum, int maximum, NumberSetting &setting,
                const char *note = nullptr);
    /// A field left empty keeps an absent text absent.
    void text(const char *caption, TextSetting &setting);
    void accessList(const char *caption, AccessListSetting &setting);

    /// The page's layout, for what stands below the groups.
    [[nodiscard]] QVBoxLayout *pageLayout() const { return pageLayout_; }

    void store() const;

private:
    QHBoxLayout *addField(const char *caption, QWidget *field);
    TextField *newTextField(const char *caption, std::string_view bytes);

    QVBoxLayout *pageLayout_;
    QVBoxLayout *groupRows_ = nullptr;
    QGroupBox *group_ = nullptr;
    CaptionColumn captions_;
    std::vector<std::function<void()>> stores_;
};
