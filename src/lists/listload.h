#pragma once

#include "widgets/formdialog.h"

#include <string>

/// Asks for the name of a file to load addresses from.
class ListLoad : public FormDialog {
    Q_OBJECT

public:
    ListLoad(QWidget *parent, const char *name);

    [[nodiscard]] std::string fileName() const;

public slots:
    void browse();

private:
    TextField *fileName_;
};
