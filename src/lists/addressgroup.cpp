#include "lists/addressgroup.h"

#include "lists/editlist.h"

namespace {

constexpr int buttonWidth = 60;
constexpr int buttonHeight = 22;
constexpr QSize minimumBox{120, 40};

} // namespace

AddressGroup::AddressGroup(const Kind &kind, EditList *editor, const maillist_entry &list)
    : ListGroup(kind.caption, {.box = 1000, .column = 0}, editor),
      chain_{(list.*kind.chain).copied()} {
    box()->setMinimumSize(minimumBox);
    // The box takes what height there is; only the buttons beside it ask for some.
    box()->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Ignored);
    RecordRows{editor, box(), &chain_.head, kind.shown, &EditList::Read}.fill();
    addEditButtons(editor, kind.add, kind.modify, kind.remove, kind.selected);
    connect(addButton("Search..."), &QPushButton::clicked, editor, kind.search);
    connect(addButton("Load File"), &QPushButton::clicked, editor, kind.load);
    fixColumnWidth(buttonWidth);
    for (QPushButton *button : findChildren<QPushButton *>()) {
        fixHeight(button, buttonHeight);
    }
    column()->addStretch();
}
