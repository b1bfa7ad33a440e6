# shellcheck shell=bash
# Completes the page names and options of kcmtarvex_mail and kcmtarvex_mail-admin. A page that the
# line names already is not offered again.
_kcmtarvex_mail()
{
    local current=${COMP_WORDS[COMP_CWORD]} word words
    if [[ $current == -* ]]; then
        words='-h --help -v --version -init --init'
    else
        words=
        for word in smtpserver pop3server imapserver fetch debatch alias list; do
            [[ " ${COMP_WORDS[*]:1:COMP_CWORD-1} " == *" $word "* ]] || words+=" $word"
        done
    fi
    mapfile -t COMPREPLY < <(compgen -W "$words" -- "$current")
}
complete -F _kcmtarvex_mail kcmtarvex_mail kcmtarvex_mail-admin
