# The words of the POP3 server's pages.
set(server POP3)
set(key pop)
set(port 110)
set(tabs [[<b>POP3</b> | <a href="tarvex-mail-imap.html">IMAP</a>]])
set(note_en [[
The mailboxes elsewhere from which mail is collected by POP3 are on the
<a href="tarvex-mail-fetchers.html">Fetchers</a> tab.]])
set(note_de [[
Die Postfächer auf anderen Servern, aus denen E-Mails über POP3 abgeholt werden, finden Sie auf dem Reiter
<a href="tarvex-mail-fetchers.html">Fetchers</a>.]])
