#pragma once

#include <QWidget>

/// A page of the tabbed dialog. The dialog owns it.
class KConfigWidget : public QWidget {
    Q_OBJECT

public:
    KConfigWidget(QWidget *parent, const char *name) : QWidget(parent) { setObjectName(name); }

    /// Does nothing: a page's constructor fills its widgets.
    virtual void loadValues() {}
    /// Hands what the widgets hold to the program's memory; the application calls it at apply.
    virtual void storeValues() {}
    virtual void defaultSettings() {}
};
