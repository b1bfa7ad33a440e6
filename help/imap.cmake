# The words of the IMAP server's pages.
set(server IMAP)
set(key imap)
set(port 143)
set(tabs [[<a href="tarvex-mail-pop3.html">POP3</a> | <b>IMAP</b>]])
set(note_en [[
A change here leaves the <a href="tarvex-mail-pop3.html">POP3</a> server as it is.]])
set(note_de [[
Eine Änderung hier lässt den <a href="tarvex-mail-pop3.html">POP3</a>-Server, wie er ist.]])
