#pragma once

#include <QString>

class QWidget;

/// Tool tips of fields. They appear beside the field's window rather than below the field, where
/// they would cover the next one and take its click.

/// Gives the field a tool tip of its own.
void setFieldTip(QWidget *field, const QString &text);

/// Shows a tip for the field now.
void showFieldTip(const QWidget *field, const QString &text);
