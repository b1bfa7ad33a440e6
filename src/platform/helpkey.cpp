#include "platform/helpkey.h"

#include "platform/kcontroldialog.h"

#include <QShortcut>

void addHelpKey(QDialog *dialog) {
    QWidget *ancestor = dialog;
    while (ancestor != nullptr && qobject_cast<KControlDialog *>(ancestor) == nullptr) {
        ancestor = ancestor->parentWidget();
    }
    if (auto *module = qobject_cast<KControlDialog *>(ancestor)) {
        QObject::connect(new QShortcut(QKeySequence(Qt::Key_F1), dialog), &QShortcut::activated,
                         module, &KControlDialog::helpWanted);
    }
}
