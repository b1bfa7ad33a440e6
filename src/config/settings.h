#pragma once

#include "config/settingvalues.h"

#include <string>
#include <vector>

/// One key of the master file with its value.
class Setting {
public:
    Setting(const Setting &) = delete;
    Setting &operator=(const Setting &) = delete;
    virtual ~Setting() = default;

    /// Parses a text into the value, or renders the value when there is none.
    virtual std::optional<std::string> exchange(TextOrNone text) = 0;

    [[nodiscard]] const char *key() const { return key_; }

protected:
    /// Enters the setting in its table.
    Setting(class SettingTable &table, const char *key);

private:
    const char *key_;
};

/// The settings in the order in which they were declared.
class SettingTable {
public:
    [[nodiscard]] const std::vector<Setting *> &all() const { return all_; }
    /// The first setting whose key is the given one, letter case aside; null when there is none.
    [[nodiscard]] Setting *find(const std::string &key) const;

private:
    friend class Setting;
    std::vector<Setting *> all_;
};

/// What one unit in the file stands for in the store.
enum class Scale : int {};

/// A setting whose handler needs nothing but its value.
template <class Value, std::optional<std::string> (*handler)(Value &, TextOrNone)>
struct HandledSetting : Setting {
    HandledSetting(SettingTable &table, const char *key, const Value &standard = {})
        : Setting{table, key}, value{standard} {}
    std::optional<std::string> exchange(TextOrNone text) override { return handler(value, text); }
    Value value;
};

/// Absent until the file gives it. Absent and empty differ: an absent text leaves the template's
/// line for the key as it is.
using TextSetting = HandledSetting<std::optional<std::string>, textSetting>;
/// Holds 0 or 1.
using BoolSetting = HandledSetting<std::int32_t, boolSetting>;
/// Holds hour * 256 + minute.
using TimeSetting = HandledSetting<std::int32_t, timeSetting>;
using AccessListSetting = HandledSetting<std::optional<AccessList>, accessListSetting>;

struct NumberSetting : Setting {
    NumberSetting(SettingTable &table, const char *key, std::int32_t standard,
                  Scale unit = Scale{1})
        : Setting{table, key}, value{standard}, scale{unit} {}
    std::optional<std::string> exchange(TextOrNone text) override {
        return numberSetting(value, text, static_cast<int>(scale));
    }
    std::int32_t value;
    Scale scale;
};

/// Every key that the product's services share, each once, with its type and default. A member is
/// its key with underscores; where two keys would have the same name, the text's ends in "_text".
struct Settings : SettingTable {
    // General
    NumberSetting poll_time{*this, "poll.time", 5};
    TextSetting admin_email{*this, "admin.email"};
    TextSetting server_name{*this, "server.name"};
    NumberSetting sock_buffer{*this, "sock.buffer", 0};
    NumberSetting cache_big{*this, "cache.big", 0, Scale{1024}};
    NumberSetting cache_max{*this, "cache.max", 0, Scale{1024}};
    NumberSetting low_disc{*this, "low.disc", 5};
    NumberSetting low_mem{*this, "low.mem", 512};
    NumberSetting con_data_size{*this, "con.data.size", 15};
    NumberSetting con_data_set{*this, "con.data.set", 0};
    NumberSetting con_con_size{*this, "con.con.size", 15};
    NumberSetting con_con_set{*this, "con.con.set", 0};
    NumberSetting log_state{*this, "log.state", 1};
    NumberSetting store_state{*this, "store.state", 1};
    NumberSetting log_buffer{*this, "log.buffer", 8192};
    NumberSetting fetch_buffer{*this, "fetch.buffer", 8192};
    BoolSetting wimp_lock{*this, "wimp.lock", false};

    // Files and directories
    TextSetting file_user_dbase{*this, "file.user.dbase"};
    TextSetting file_user_groups{*this, "file.user.groups"};
    TextSetting file_user_changes{*this, "file.user.changes"};
    TextSetting file_user_exec{*this, "file.user.exec"};
    TextSetting file_log_master{*this, "file.log.master"};
    TextSetting file_mimetypes{*this, "file.mimetypes"};
    TextSetting file_schedule{*this, "file.schedule"};
    TextSetting mail_file_alias{*this, "mail.file.alias"};
    TextSetting mail_file_smtpreject{*this, "mail.file.smtpreject"};
    TextSetting mail_file_maillist{*this, "mail.file.maillist"};
    TextSetting proxy_cache_index{*this, "proxy.cache.index"};
    TextSetting proxy_cache_request{*this, "proxy.cache.request"};
    TextSetting proxy_cache_peers{*this, "proxy.cache.peers"};
    TextSetting news_file_active{*this, "news.file.active"};
    TextSetting news_file_articles{*this, "news.file.articles"};
    TextSetting news_file_new{*this, "news.file.new"};
    TextSetting news_file_clients{*this, "news.file.clients"};
    TextSetting news_file_groups{*this, "news.file.groups"};
    TextSetting news_file_spools{*this, "news.file.spools"};
    TextSetting news_file_content{*this, "news.file.content"};
    TextSetting news_file_help{*this, "news.file.help"};
    TextSetting dns_file_domains{*this, "dns.file.domains"};
    TextSetting dns_file_hosts{*this, "dns.file.hosts"};
    TextSetting mail_dir_incoming{*this, "mail.dir.incoming"};
    TextSetting mail_dir_outgoing{*this, "mail.dir.outgoing"};
    TextSetting mail_dir_oddments{*this, "mail.dir.oddments"};
    TextSetting proxy_cache_dir{*this, "proxy.cache.dir"};
    TextSetting news_dir_incoming{*this, "news.dir.incoming"};
    TextSetting news_dir_outgoing{*this, "news.dir.outgoing"};
    TextSetting web_dir{*this, "web.dir"};
    TextSetting proxy_error_path{*this, "proxy.error.path"};
    TextSetting web_error_path{*this, "web.error.path"};

    // Service switches
    BoolSetting smtp_sock_enabled{*this, "smtp.sock.enabled", true};
    BoolSetting imap_sock_enabled{*this, "imap.sock.enabled", true};
    BoolSetting pop_sock_enabled{*this, "pop.sock.enabled", true};
    BoolSetting proxy_ftp_sock_enabled{*this, "proxy.ftp.sock.enabled", true};
    BoolSetting proxy_http_sock_enabled{*this, "proxy.http.sock.enabled", true};
    BoolSetting proxy_telnet_sock_enabled{*this, "proxy.telnet.sock.enabled", true};
    BoolSetting proxy_socks_tcp_enabled{*this, "proxy.socks.tcp.enabled", true};
    BoolSetting proxy_raudio_tcp_enabled{*this, "proxy.raudio.tcp.enabled", true};
    BoolSetting proxy_socks_udp_enabled{*this, "proxy.socks.udp.enabled", true};
    BoolSetting proxy_raudio_udp_enabled{*this, "proxy.raudio.udp.enabled", true};
    BoolSetting web_sock_enabled{*this, "web.sock.enabled", true};
    BoolSetting nntp_sock_enabled{*this, "nntp.sock.enabled", true};

    // Ports
    NumberSetting smtp_sock_port{*this, "smtp.sock.port", 25};
    NumberSetting imap_sock_port{*this, "imap.sock.port", 143};
    NumberSetting pop_sock_port{*this, "pop.sock.port", 110};
    NumberSetting proxy_external_sock_port{*this, "proxy.external.sock.port", 8080};
    NumberSetting proxy_ftp_sock_port{*this, "proxy.ftp.sock.port", 8021};
    NumberSetting proxy_http_sock_port{*this, "proxy.http.sock.port", 8080};
    NumberSetting proxy_telnet_sock_port{*this, "proxy.telnet.sock.port", 8023};
    NumberSetting proxy_socks_sock_port{*this, "proxy.socks.sock.port", 1080};
    NumberSetting proxy_raudio_sock_port{*this, "proxy.raudio.sock.port", 7070};
    NumberSetting proxy_icp_sock_port{*this, "proxy.icp.sock.port", 3130};
    NumberSetting web_sock_port{*this, "web.sock.port", 80};
    NumberSetting nntp_sock_port{*this, "nntp.sock.port", 119};

    // Time-outs
    NumberSetting smtp_sock_timeout{*this, "smtp.sock.timeout", 120};
    NumberSetting imap_sock_timeout{*this, "imap.sock.timeout", 120};
    NumberSetting pop_sock_timeout{*this, "pop.sock.timeout", 120};
    NumberSetting proxy_ftp_sock_timeout{*this, "proxy.ftp.sock.timeout", 120};
    NumberSetting proxy_telnet_sock_timeout{*this, "proxy.telnet.sock.timeout", 120};
    NumberSetting proxy_socks_sock_timeout{*this, "proxy.socks.sock.timeout", 120};
    NumberSetting proxy_raudio_sock_timeout{*this, "proxy.raudio.sock.timeout", 120};
    NumberSetting web_sock_timeout{*this, "web.sock.timeout", 120};
    NumberSetting nntp_sock_timeout{*this, "nntp.sock.timeout", 120};

    // Connection limits
    NumberSetting smtp_sock_max{*this, "smtp.sock.max", 20};
    NumberSetting imap_sock_max{*this, "imap.sock.max", 20};
    NumberSetting pop_sock_max{*this, "pop.sock.max", 20};
    NumberSetting proxy_ftp_sock_max{*this, "proxy.ftp.sock.max", 20};
    NumberSetting proxy_http_sock_max{*this, "proxy.http.sock.max", 20};
    NumberSetting proxy_telnet_sock_max{*this, "proxy.telnet.sock.max", 20};
    NumberSetting proxy_socks_sock_max{*this, "proxy.socks.sock.max", 20};
    NumberSetting proxy_raudio_sock_max{*this, "proxy.raudio.sock.max", 20};
    NumberSetting web_sock_max{*this, "web.sock.max", 20};
    NumberSetting nntp_sock_max{*this, "nntp.sock.max", 20};

    // Access lists
    AccessListSetting smtp_allow{*this, "smtp.allow"};
    AccessListSetting pop_allow{*this, "pop.allow"};
    AccessListSetting imap_allow{*this, "imap.allow"};
    AccessListSetting proxy_ftp_allow{*this, "proxy.ftp.allow"};
    AccessListSetting proxy_web_allow{*this, "proxy.web.allow"};
    AccessListSetting proxy_telnet_allow{*this, "proxy.telnet.allow"};
    AccessListSetting proxy_socks_allow{*this, "proxy.socks.allow"};
    AccessListSetting proxy_raudio_allow{*this, "proxy.raudio.allow"};
    AccessListSetting nntp_allow{*this, "nntp.allow"};
    AccessListSetting web_allow{*this, "web.allow"};
    AccessListSetting dns_allow{*this, "dns.allow"};
    AccessListSetting smtp_auth{*this, "smtp.auth"};
    AccessListSetting proxy_ftp_auth{*this, "proxy.ftp.auth"};
    AccessListSetting proxy_web_auth{*this, "proxy.web.auth"};
    AccessListSetting proxy_telnet_auth{*this, "proxy.telnet.auth"};
    AccessListSetting proxy_socks_auth{*this, "proxy.socks.auth"};
    AccessListSetting nntp_auth{*this, "nntp.auth"};
    AccessListSetting web_auth{*this, "web.auth"};
    AccessListSetting smtp_block{*this, "smtp.block"};
    AccessListSetting pop_block{*this, "pop.block"};
    AccessListSetting imap_block{*this, "imap.block"};
    AccessListSetting proxy_ftp_block{*this, "proxy.ftp.block"};
    AccessListSetting proxy_web_block{*this, "proxy.web.block"};
    AccessListSetting proxy_telnet_block{*this, "proxy.telnet.block"};
    AccessListSetting proxy_socks_block{*this, "proxy.socks.block"};
    AccessListSetting proxy_raudio_block{*this, "proxy.raudio.block"};
    AccessListSetting nntp_block{*this, "nntp.block"};
    AccessListSetting web_block{*this, "web.block"};
    AccessListSetting dns_block{*this, "dns.block"};

    // Mail
    TextSetting pop_hosts{*this, "pop.hosts"};
    TextSetting pop_headers{*this, "pop.headers"};
    NumberSetting pop_time{*this, "pop.time", 0};
    TextSetting smtp_hosts{*this, "smtp.hosts"};
    TextSetting smtp_direct{*this, "smtp.direct"};
    NumberSetting smtp_time{*this, "smtp.time", 0};
    TextSetting mail_domains{*this, "mail.domains"};
    NumberSetting mail_debatch_time{*this, "mail.debatch.time", 0};
    NumberSetting mail_auto_send{*this, "mail.auto.send", 0};
    TextSetting mail_from_force{*this, "mail.from.force"};

    // Proxy
    TextSetting proxy_external{*this, "proxy.external"};
    TextSetting proxy_multiport_hosts{*this, "proxy.multiport.hosts"};
    TextSetting proxy_www_hook{*this, "proxy.www.hook"};
    TextSetting proxy_cache_exclude{*this, "proxy.cache.exclude"};
    NumberSetting proxy_cache_index_save{*this, "proxy.cache.index.save", 0};
    NumberSetting proxy_cache_strict{*this, "proxy.cache.strict", 0};
    NumberSetting proxy_cache_size{*this, "proxy.cache.size", 0};
    NumberSetting proxy_cache_file_size{*this, "proxy.cache.file.size", 0};
    NumberSetting proxy_cache_expiry_time{*this, "proxy.cache.expiry.time", 0};
    NumberSetting proxy_cache_expiry_images{*this, "proxy.cache.expiry.images", 0};
    NumberSetting proxy_cache_expiry_html{*this, "proxy.cache.expiry.html", 0};
    NumberSetting proxy_cache_expiry_misc{*this, "proxy.cache.expiry.misc", 0};
    NumberSetting proxy_cache_request_maxrun{*this, "proxy.cache.request.maxrun", 0};
    NumberSetting proxy_cache_request_retries{*this, "proxy.cache.request.retries", 0};
    NumberSetting proxy_cache_request_max{*this, "proxy.cache.request.max", 0};
    TimeSetting proxy_cache_request_start{*this, "proxy.cache.request.start"};
    TimeSetting proxy_cache_request_end{*this, "proxy.cache.request.end"};
    TextSetting proxy_cache_title_format{*this, "proxy.cache.title.format"};
    TextSetting proxy_headers_log{*this, "proxy.headers.log"};
    TextSetting log_format{*this, "log.format"};
    TextSetting proxy_headers_remove{*this, "proxy.headers.remove"};
    TextSetting proxy_headers_add{*this, "proxy.headers.add"};
    BoolSetting proxy_add_via{*this, "proxy.add.via", false};
    TextSetting proxy_telnet_gethost{*this, "proxy.telnet_gethost"};
    TextSetting proxy_telnet_nonet{*this, "proxy.telnet_nonet"};
    TextSetting proxy_telnet_err{*this, "proxy.telnet_err"};
    TextSetting proxy_telnet_unknown{*this, "proxy.telnet_unknown"};
    TextSetting proxy_telnet_connect{*this, "proxy.telnet_connect"};
    TextSetting proxy_telnet_connected{*this, "proxy.telnet_connected"};
    TextSetting proxy_telnet_connect_opt{*this, "proxy.telnet_connect_opt"};
    TextSetting proxy_telnet_deny{*this, "proxy.telnet_deny"};
    TextSetting proxy_telnet_auth_text{*this, "proxy.telnet_auth"};
    TextSetting proxy_telnet_login{*this, "proxy.telnet_login"};
    TextSetting proxy_telnet_passwd{*this, "proxy.telnet_passwd"};
    TextSetting proxy_telnet_badpasswd{*this, "proxy.telnet_badpasswd"};
    TextSetting proxy_multiport_welcome{*this, "proxy.multiport_welcome"};
    TextSetting proxy_multiport_login{*this, "proxy.multiport_login"};
    TextSetting proxy_multiport_connect{*this, "proxy.multiport_connect"};
    TextSetting proxy_content_filter{*this, "proxy.content_filter"};

    // News
    NumberSetting news_article_list_size{*this, "news.article.list.size", 0};
    NumberSetting news_article_list_time{*this, "news.article.list.time", 0};
    NumberSetting news_article_hash{*this, "news.article.hash", 0};
    NumberSetting news_active_hash{*this, "news.active.hash", 0};
    BoolSetting news_active_build{*this, "news.active.build", false};
    NumberSetting news_debatch_call{*this, "news.debatch.call", 0};
    NumberSetting news_debatch_batch{*this, "news.debatch.batch", 0};
    BoolSetting news_debatch_online{*this, "news.debatch.online", false};
    NumberSetting news_overview_cache_size{*this, "news.overview.cache.size", 0};
    NumberSetting news_client_batch{*this, "news.client.batch", 0};
    NumberSetting news_client_batch_size{*this, "news.client.batch.size", 0};
    BoolSetting news_allow_newnews{*this, "news.allow.newnews", false};
    TextSetting news_header_post_remove{*this, "news.header.post.remove"};
    TextSetting news_header_post_add{*this, "news.header.post.add"};

    // DNS
    TextSetting dns_servers{*this, "dns.servers"};
    NumberSetting dns_timeout{*this, "dns.timeout", 0};
    NumberSetting dns_retries{*this, "dns.retries", 0};
    TextSetting dns_search{*this, "dns.search"};

    // Dial-up
    NumberSetting dialler_port{*this, "dialler.port", 0};
    NumberSetting dialler_timeout{*this, "dialler.timeout", 0};
    NumberSetting dialler_retries{*this, "dialler.retries", 0};
    TextSetting dialler_driver{*this, "dialler.driver"};
    TextSetting dialler_script{*this, "dialler.script"};
    TextSetting dialler_user{*this, "dialler.user"};
    TextSetting dialler_pass{*this, "dialler.pass"};
    TextSetting dialler_phone{*this, "dialler.phone"};
    TextSetting dialler_provider{*this, "dialler.provider"};
    TextSetting dialler_init{*this, "dialler.init"};
    TextSetting dialler_cmd{*this, "dialler.cmd"};
    TextSetting dialler_discmd{*this, "dialler.discmd"};
    NumberSetting dialler_linktime{*this, "dialler.linktime", 60};
    NumberSetting dialler_dialtime{*this, "dialler.dialtime", 30};
    NumberSetting dialler_retrytime{*this, "dialler.retrytime", 5};
    TextSetting dialin_file{*this, "dialin.file"};
    TextSetting dialin_addr{*this, "dialin.addr"};

    // Utility services
    BoolSetting util_ftp_enable{*this, "util.ftp.enable", false};
    BoolSetting util_dns_enable{*this, "util.dns.enable", false};
    BoolSetting util_bootp_enable{*this, "util.bootp.enable", false};
    BoolSetting util_tftp_enable{*this, "util.tftp.enable", false};
    BoolSetting util_finger_enable{*this, "util.finger.enable", false};
    BoolSetting util_auth_enable{*this, "util.auth.enable", false};
    BoolSetting util_daytime_enable{*this, "util.daytime.enable", false};
    BoolSetting util_time_enable{*this, "util.time.enable", false};
    BoolSetting util_ntp_enable{*this, "util.ntp.enable", false};
    BoolSetting util_telnet_enable{*this, "util.telnet.enable", false};
    BoolSetting util_echo_enable{*this, "util.echo.enable", false};
    BoolSetting util_discard_enable{*this, "util.discard.enable", false};
    BoolSetting util_chargen_enable{*this, "util.chargen.enable", false};
    AccessListSetting util_allow{*this, "util.allow"};
    AccessListSetting util_block{*this, "util.block"};
    NumberSetting util_timeout{*this, "util.timeout", 0};
    TextSetting util_ftp_dir{*this, "util.ftp.dir"};
    TextSetting util_ftp_welcome{*this, "util.ftp.welcome"};
    BoolSetting util_ftp_ext{*this, "util.ftp.ext", false};
    BoolSetting util_ftp_lock{*this, "util.ftp.lock", false};
    TextSetting util_time_server{*this, "util.time.server"};
    TextSetting util_bootp_config{*this, "util.bootp.config"};
    TextSetting util_bootp_options{*this, "util.bootp.options"};
    TextSetting util_bootp_lease{*this, "util.bootp.lease"};
    TextSetting util_tftp_dir{*this, "util.tftp.dir"};
    TextSetting util_auth_response{*this, "util.auth.response"};
    TextSetting util_bootp_addr{*this, "util.bootp.addr"};
};

/// The process's one store. It holds the defaults until the master file is read, and is never
/// emptied.
Settings &settings();

/// Reaches a setting by its key, whatever the key's letter case: stores `text`, or returns the
/// value's text when there is none. None for an unknown key and for an absent text.
std::optional<std::string> settingByKey(const std::string &key, TextOrNone text);
