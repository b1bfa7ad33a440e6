#include "platform/bytetext.h"

#include <QTest>

class TestByteText : public QObject {
    Q_OBJECT

private slots:
    void textOfBytes() {
        using Case = std::pair<const char *, std::u16string>;
        for (const auto &[bytes, text] :
             std::initializer_list<Case>{{"\xc3\xa9\xe2\x82\xac", u"\u00e9\u20ac"},
                                         {"\xf0\x9f\x98\x80", u"\U0001f600"},
                                         {"\xef\xbb\xbfx", u"\ufeffx"},
                                         {"\xf4\x8f\xbf\xbf\xef\xbf\xbf", u"\U0010ffff\uffff"},
                                         {"\xe2\x82|", {0xdce2, 0xdc82, '|'}},
                                         {"\xf0\x9f\xc3\xa9", {0xdcf0, 0xdc9f, 0xe9}},
                                         {"\xf0\x9f\x98\x80\x80", {0xd83d, 0xde00, 0xdc80}}}) {
            QCOMPARE(textFromBytes(bytes), QStringView{text}.toString());
            QCOMPARE(bytesFromText(text), bytes);
        }
    }

    /// Overlong, surrogates, beyond the last code point, broken off.
    void everyByteOfWhatIsNotValid() {
        for (const QByteArray bytes :
             {"\xc1\xbf", "\xe0\x9f\xbf", "\xf0\x8f\xbf\xbf", "\xed\xa0\x80", "\xed\xb2\x80",
              "\xf4\x90\x80\x80", "\xf8\x88\x80\x80\x80", "\xf0\x9f\x98", "\x80\xbf\xfe\xff"}) {
            QString escaped;
            for (const char byte : bytes) {
                escaped += QChar{0xdc00 + static_cast<unsigned char>(byte)};
            }
            QCOMPARE(textFromBytes(bytes.toStdString()), escaped);
            QCOMPARE(bytesFromText(escaped), bytes.toStdString());
        }
    }

    void foreignText() {
        const std::u16string text{'a', 0xd83d, '|', 0xdc7f, 0xdd00, 0xd83d, 0xdc80};
        QCOMPARE(bytesFromText(text), "a\xef\xbf\xbd|\xef\xbf\xbd\xef\xbf\xbd\xf0\x9f\x92\x80");
    }
};

QTEST_GUILESS_MAIN(TestByteText)
#include "test_bytetext.moc"
