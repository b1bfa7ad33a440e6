#include "lists/addressgroup.h"

#include "lists/editlist.h"
#include "widgets/recordrows.h"

namespace {

constexpr int buttonWidth = 60;
constexpr QSize leastBox{120, 40};

} // namespace

AddressGroup::AddressGroup(const char *caption, EditList *editor, const Slots &slotsOf,
                           const AddressChain &addresses, Shown shown)
    : ListGroup(caption, {1000, 0}, editor, Shrinking::Yes),
      chain_{addresses.copied(
          [](const maillist_addr_entry &entry) { return maillist_addr_entry{entry.addr}; })} {
    box()->setMinimumSize(leastBox);
    // The box takes what height there is; only the buttons beside it ask for some.
    box()->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Ignored);
    appendRows(box(), chain_, shown);
    addEditButtons(editor, slotsOf.add, slotsOf.modify, slotsOf.remove, slotsOf.selected);
    connect(addButton("Search..."), &QPushButton::clicked, editor, slotsOf.search);
    connect(addButton("Load File"), &QPushButton::clicked, editor, slotsOf.load);
    fixColumnWidth(buttonWidth);
    column()->addStretch();
}
