#include "alias/editalias.h"
#include "fetch/editfetch.h"
#include "fetch/pophosts.h"
#include "lists/editlistmember.h"
#include "lists/maillistfile.h"
#include "platform/knumericspinbox.h"
#include "widgets/textfield.h"

#include "datafiles.h"
#include "dialogdriver.h"

#include <QCheckBox>
#include <QToolTip>
#include <QWheelEvent>

#include <limits>

namespace {

/// What a field holds when, at the place of the "<" in `row`, what stands behind that is pasted
/// into the rest.
template <class NewField>
std::string pasted(const std::string &row, NewField newField) {
    const QStringList parts = textFromBytes(row).replace('>', '<').split('<');
    const KeptText stored = keep(bytesFromText(parts.at(0) + parts.at(2)));
    TextField *field = newField(stored);
    if (field->keptText(stored).data() != stored.data()) {
        return "not the stored text again";
    }
    field->setCursorPosition(static_cast<int>(parts.at(0).size()));
    paste(field, parts.at(1));
    return (field->isReadOnly() ? QToolTip::text().toStdString() + ": " : "") +
           field->keptText(stored);
}

/// Whether the dialog closes on a text that came neither from keys nor from the clipboard.
bool isTakenBy(QDialog *dialog, QLineEdit *field, const QString &text) {
    dialog->show();
    field->setText(text);
    press(dialog, "OK");
    return dialog->result() == QDialog::Accepted && !dialog->isVisible();
}

} // namespace

class TestFields : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() {
        number_.setRange(0, 999);
        number_.show();
        QVERIFY(QTest::qWaitForWindowActive(&number_));
    }

    void textOfBytes() {
        checkRows(
            [](const std::string &bytes) {
                QStringList units;
                const QString text = textFromBytes(bytes);
                for (const QChar unit : text) {
                    units << QString::number(unit.unicode(), 16);
                }
                return units.join(' ').toStdString() +
                       (bytesFromText(text) == bytes ? "" : " lost");
            },
            "[bytes as text]");
        const std::u16string foreign{'a', 0xd83d, '|', 0xdc7f, 0xdd00, 0xd83d, 0xdc80};
        QCOMPARE(bytesFromText(foreign), "a\xef\xbf\xbd|\xef\xbf\xbd\xef\xbf\xbd\xf0\x9f\x92\x80");
    }

    void pasting() {
        checkRows(
            [](const std::string &row) {
                TextField field{nullptr};
                return pasted(row, [&](KeptText stored) {
                    field.showBytes(stored);
                    return &field;
                });
            },
            "[pasting into a field]");
        QCOMPARE(QToolTip::text(), "At most 100000 bytes");
        for (const char *caption : {"&Server:", "&Username:", "&Password:"}) {
            std::optional<EditFetch> dialog;
            const auto inDialog = [&](KeptText stored) {
                pop_host host;
                setPopHostText(host.server, stored);
                setPopHostText(host.user, stored);
                setPopHostText(host.password, stored);
                dialog.emplace(nullptr, "edit", &host);
                return fieldBeside<TextField>(&*dialog, caption);
            };
            checkRows([&](const std::string &row) { return pasted(row, inDialog); },
                      ('[' + std::string{caption} + ']').c_str());
        }
        std::optional<EditListMember> member;
        const auto asMember = [&member](KeptText stored) {
            const maillist_addr_entry entry{stored};
            member.emplace(nullptr, "edit", &entry);
            return fieldBeside<TextField>(&*member, "&Email:");
        };
        checkRows([&](const std::string &row) { return pasted(row, asMember); }, "[&Email:]");
    }

    void aliasField() {
        EditAlias dialog{nullptr, "edit", nullptr};
        QLineEdit *field = fieldBeside(&dialog, "&Address:");
        type(field, "#|!n e,w@#");
        for (const char *refused : {"a b", "a,b", "a\tb", "a\nb"}) {
            paste(field, refused);
            QCOMPARE(field->text(), "!new@#");
        }
        for (const auto &[text, isTaken] : {std::pair{"a b", false}, {"#a", false}, {"a#", true}}) {
            QCOMPARE(isTakenBy(&dialog, field, text), isTaken);
        }
    }

    void memberTakesALineOfTheFile() {
        using Case = std::tuple<std::size_t, std::size_t, bool, std::size_t>;
        for (const auto &[stored, text, isOnDigest, taken] :
             {Case{0, 248, false, 248}, Case{0, 247, true, 248}, Case{0, 248, true, 0},
              Case{249, 248, true, 249}}) {
            const maillist_addr_entry entry{keep(std::string(stored, ':'))};
            EditListMember dialog{nullptr, "edit", &entry};
            dialog.findChild<QCheckBox *>()->setChecked(isOnDigest);
            QLineEdit *field = fieldBeside(&dialog, "&Email:");
            const bool isTaken = isTakenBy(&dialog, field, QString{static_cast<int>(text), 'x'});
            QCOMPARE(isTaken ? dialog.addr(entry).size() : 0, taken);
            QVERIFY(isTaken || QToolTip::text() == "At most 247 bytes");
        }
    }

    void storedNumberIsKept() {
        for (const int stored : {3600, 999, -1, 0, 7000, std::numeric_limits<int>::min(), 5}) {
            number_.setValue(stored);
            number_.setFocus();
            QTest::keyClick(&number_, Qt::Key_Return);
            number_.clearFocus();
            QWheelEvent wheel{{}, {}, {}, {0, 120}, {}, {}, Qt::NoScrollPhase, false};
            QApplication::sendEvent(&number_, &wheel);
            QCOMPARE(number_.text(), QString::number(stored));
            QCOMPARE(number_.getValue(), stored);
            QCOMPARE(number_.toolTip().isEmpty(), stored >= 0 && stored <= 999);
        }
    }

    void userEndsInRange() {
        using Case = std::tuple<int, Qt::Key, const char *, int>;
        for (const auto &[stored, key, pasted, expected] : {Case{999, Qt::Key_Up, "", 999},
                                                            {3600, Qt::Key_Down, "", 999},
                                                            {-5, Qt::Key_Up, "", 0},
                                                            {3600, Qt::Key_Backspace, "", 360},
                                                            {3600, Qt::Key_Delete, "42", 42},
                                                            {3600, Qt::Key_Delete, "1500", 999},
                                                            {-500, Qt::Key_Delete, "-20", 0}}) {
            number_.setValue(stored);
            QTest::keyClick(&number_, Qt::Key_End);
            QTest::keyClick(&number_, key);
            if (*pasted != '\0') {
                number_.selectAll();
                paste(&number_, pasted);
            }
            QCOMPARE(number_.getValue(), expected);
            type(&number_, "1000");
            QCOMPARE(number_.getValue(), 100);
        }
    }

private:
    KNumericSpinBox number_;
};

QTEST_MAIN(TestFields)
#include "test_fields.moc"
