#pragma once

#include "lists/maillistfile.h"
#include "widgets/listgroup.h"

class EditList;

/// One address list of the list editor: a working copy of the list's addresses, the box that shows
/// them, and the five buttons.
class AddressGroup : public ListGroup {
public:
    struct Kind {
        const char *caption;
        AddressChain maillist_entry::*chain;
        KeptText (*shown)(const maillist_addr_entry &);
        void (EditList::*add)();
        void (EditList::*modify)();
        void (EditList::*remove)();
        void (EditList::*selected)(const char *);
        void (EditList::*search)();
        void (EditList::*load)();
    };

    AddressGroup(const Kind &kind, EditList *editor, const maillist_entry &list);

    [[nodiscard]] maillist_addr_entry **chain() { return &chain_.head; }
    /// The working copy changes hands; the group's is empty afterwards.
    [[nodiscard]] AddressChain takeChain() { return std::move(chain_); }

private:
    AddressChain chain_;
};
