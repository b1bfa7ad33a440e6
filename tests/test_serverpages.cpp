#include "config/settings.h"

#include "dialogdriver.h"
#include "windows.h"

#include <map>
#include <memory>

namespace {

/// By their keys; none for an absent text.
std::map<std::string, std::optional<std::string>> allValues() {
    std::map<std::string, std::optional<std::string>> values;
    for (Setting *setting : settings().all()) {
        values[setting->key()] = setting->exchange(std::nullopt);
    }
    return values;
}

using NewPage = std::unique_ptr<KConfigWidget> (*)();

template <class Page>
std::unique_ptr<KConfigWidget> newPage() {
    return std::make_unique<Page>(nullptr, "page");
}

using Case = std::tuple<NewPage, std::string, const char *, const char *, const char *>;

} // namespace

class TestServerPages : public QObject {
    Q_OBJECT

private slots:
    void textTooLongToBeEditedIsKept() {
        settingByKey("mail.domains", std::string(100'001, 'x'));
        const auto values = allValues();
        newPage<MailDebatch>()->storeValues();
        QVERIFY(allValues() == values);
    }

    /// What the fields would not take from the user, or could make something else of, stays.
    void oneEditChangesItsSetting() {
        settingByKey("smtp.sock.port", "70000");
        settingByKey("smtp.allow", "10.0.0.0 255.255.128.0, 192.168.0.0/16");
        settingByKey("smtp.auth", "none");
        settingByKey("smtp.hosts", "\xff\xc3 not UTF-8");
        settingByKey("mail.domains", "  two  blanks ");
        const NewPage delivery = newPage<MailDebatch>;
        std::vector<Case> cases{
            {delivery, "mail.debatch.time", "&Idle time (secs):", "7", "7"},
            {delivery, "mail.domains", "&Local Domains:", " a.example  b ", " a.example  b "},
            {delivery, "smtp.direct", "&Direct Send:", "yes", "yes"},
            {delivery, "smtp.hosts", "&Remote SMTP Server:", "", ""},
            {delivery, "smtp.time", "&Poll Time (mins):", "30", "30"},
            {delivery, "mail.auto.send", "&Auto connect queue size:", "9", "9"},
            {delivery, "mail.from.force", "&From Header force:", "me", "me"},
            {newPage<MailSMTP>, "smtp.auth", "A&uth Access:", "", ""}};
        using Server = std::pair<NewPage, std::string>;
        for (const auto &[page, server] :
             {Server{newPage<MailSMTP>, "smtp"}, Server{newPage<MailPOP3>, "pop"},
              Server{newPage<MailIMAP>, "imap"}}) {
            cases.insert(cases.end(),
                         {{page, server + ".sock.enabled", "Enable server", nullptr, "no"},
                          {page, server + ".sock.port", "&Port:", "65535", "65535"},
                          {page, server + ".sock.timeout", "&Timeout (secs):", "999", "999"},
                          {page, server + ".sock.max", "&Max Connections:", "0", "0"},
                          {page, server + ".allow", "&Allow Access:", "x,ALL", "all"},
                          {page, server + ".block", "&Block Access:", "10.0.0.0/8", "10.0.0.0/8"}});
        }
        for (const auto &[make, key, caption, typed, value] : cases) {
            auto values = allValues();
            const auto page = make();
            page->storeValues();
            QVERIFY2(allValues() == values, key.c_str());
            page->show();
            if (typed == nullptr) {
                press(page.get(), caption);
            } else {
                type(fieldBeside<QWidget>(page.get(), caption), typed);
            }
            page->storeValues();
            QVERIFY2(std::exchange(values[key], value) != value && allValues() == values,
                     key.c_str());
        }
    }
};

QTEST_MAIN(TestServerPages)
#include "test_serverpages.moc"
