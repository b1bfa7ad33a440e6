#pragma once

#include "lists/maillistfile.h"
#include "widgets/listgroup.h"

class EditList;

/// One address list of the list editor: a working copy of the list's addresses, the box that shows
/// them, and the five buttons.
class AddressGroup : public ListGroup {
public:
    /// The editor's slots for one list.
    struct Slots {
        void (EditList::*add)();
        void (EditList::*modify)();
        void (EditList::*remove)();
        void (EditList::*search)();
        void (EditList::*load)();
        void (EditList::*selected)(const char *);
    };
    /// The text of an address's row.
    using Shown = KeptText (*)(const maillist_addr_entry &);

    AddressGroup(const char *caption, EditList *editor, const Slots &slotsOf,
                 const AddressChain &addresses, Shown shown);

    [[nodiscard]] maillist_addr_entry **chain() { return &chain_.head; }
    /// The working copy changes hands; the group's is empty afterwards.
    [[nodiscard]] AddressChain takeChain() { return std::move(chain_); }

private:
    AddressChain chain_;
};
