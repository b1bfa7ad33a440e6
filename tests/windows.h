#pragma once

// All pages and dialogs.
#include "alias/editalias.h"
#include "alias/editaliasentry.h"
#include "alias/mailalias.h"
#include "fetch/editfetch.h"
#include "fetch/mailfetch.h"
#include "lists/editlist.h"
#include "lists/editlistaddr.h"
#include "lists/editlistmember.h"
#include "lists/listload.h"
#include "lists/listsearch.h"
#include "lists/maillist.h"
#include "server/editsmtp.h"
#include "server/maildebatch.h"
#include "server/mailimap.h"
#include "server/mailpop3.h"
#include "server/mailsmtp.h"
