#pragma once

#include "base/kepttext.h"
#include "base/productfile.h"
#include "base/recordlist.h"

/// The SMTP server's block list, one word a line:
///
///     spam.example.com  what follows the word is not read
///
/// Lines that begin with "#", "|", white space or a character that does not print are skipped.
/// Reading puts each entry at the head, so that reading and writing reverse the order.

struct smtpreject_entry {
    KeptText domain;
    smtpreject_entry *next = nullptr;
};

/// Newest first.
extern RecordChain<smtpreject_entry> smtpreject_list;
extern ProductFile rejectFile;

/// Puts the entries of the file's bytes at the head of `list`. Throws std::bad_alloc with what was
/// read until then in the list. How many lines have a word that is in no record.
std::size_t parseSmtpRejects(KeptText bytes, RecordChain<smtpreject_entry> &list);
void formatSmtpRejects(const RecordChain<smtpreject_entry> &list, std::string &bytes);

/// Fills smtpreject_list anew from the file; empty when it cannot be read.
void readSmtpRejectFile();
void writeSmtpRejectFile();
