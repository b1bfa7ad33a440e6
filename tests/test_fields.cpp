#include "alias/editalias.h"
#include "fetch/editfetch.h"
#include "fetch/pophosts.h"
#include "widgets/fieldtext.h"

#include "dialogdriver.h"

class TestFields : public QObject {
    Q_OBJECT

private slots:
    void bytesOfField() {
        struct Case {
            QByteArray shown;
            QString pasted;
            QByteArray bytes;
        };
        const QByteArray longText(40000, 'x');
        for (const Case &test :
             std::initializer_list<Case>{{" a ", "b ", " a b "},
                                         {"", "a\r\nb\nc", "a  b c"},
                                         {"", QString::fromLatin1("a\0b", 3), "a b"},
                                         {"\xff\xc3", "a", "\xff\xc3" + QByteArray{"a"}},
                                         {longText, longText, longText + longText}}) {
            const std::unique_ptr<QLineEdit> field{newField(nullptr)};
            showBytes(field.get(), test.shown.toStdString());
            field->end(false);
            paste(field.get(), test.pasted);
            QCOMPARE(QByteArray::fromStdString(fieldBytes(field.get())), test.bytes);
        }
    }

    void fetcherField() {
        struct Case {
            const char *caption;
            QByteArray stored;
            int position;
            QString pasted;
            QByteArray bytes;
        };
        const auto x = [](int count) { return QByteArray(count, 'x'); };
        const QByteArray accented{"\xc3\xa9"};
        const QByteArray smile{"\xf0\x9f\x98\x80"};
        const char *user = "&Username:";
        const char *password = "&Password:";
        for (const Case &test : std::initializer_list<Case>{
                 {"&Server:", "", 0, QString(200000, 'x'), x(63)},
                 {user, "", 0, accented.repeated(20), accented.repeated(15)},
                 {password, "", 0, smile.repeated(20), smile.repeated(7)},
                 {user, x(30), 10, "bbb", x(10) + "b" + x(20)},
                 {user, x(30), 9, accented, x(30)},
                 {user, QByteArray(31, '\xff'), 31, "b", QByteArray(31, '\xff')},
                 {"&Server:", "x", 1, "a:b", "x"},
                 {user, "x", 1, "a@b", "x"},
                 {password, "x", 1, "a,b", "x"},
                 {user, "x", 0, "*", "x"},
                 {user, "x", 0, QString(QChar(0)), "x"},
                 {user, "xx", 1, "-*%", "x-*%x"},
                 {user, "%x", 2, "y", "%xy"},
                 {password, "xx", 0, "-", "-xx"}}) {
            pop_host host;
            setPopHostText(host.server, test.stored.toStdString());
            setPopHostText(host.user, test.stored.toStdString());
            setPopHostText(host.password, test.stored.toStdString());
            const EditFetch dialog{nullptr, "edit", &host};
            QLineEdit *field = fieldBeside(&dialog, test.caption);
            field->setCursorPosition(test.position);
            paste(field, test.pasted);
            QCOMPARE(QByteArray::fromStdString(fieldBytes(field)), test.bytes);
        }
    }

    void aliasField() {
        const EditAlias dialog{nullptr, "edit", nullptr};
        QLineEdit *field = fieldBeside(&dialog, "&Address:");
        type(field, "!n e,w@#");
        for (const char *refused : {"a b", "a,b", "a\tb", "a\nb"}) {
            paste(field, refused);
            QCOMPARE(field->text(), "!new@#");
        }
    }
};

QTEST_MAIN(TestFields)
#include "test_fields.moc"
