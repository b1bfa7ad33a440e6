#include "lists/listsearch.h"

#include "lists/smalldialogsizes.h"
#include "platform/qlistbox.h"
#include "widgets/textfield.h"

#include <functional>

ListSearch::ListSearch(QWidget *parent, const char *name)
    : FormDialog(parent, name, "Mail List Search"),
      text_{addField(translatable("&Search for:"), listDialogLabel, {})} {
    addButtons(listDialogBorder, 20);
    fixSize(listDialogSize, listDialogSize);
}

std::string ListSearch::text() const { return text_->bytes(); }

std::optional<int> nextRowHolding(const QListBox *box, const std::string &needle) {
    // A searcher that is made once: rows are short, and std::string_view::find begins anew at each.
    const std::boyer_moore_horspool_searcher searcher{needle.begin(), needle.end()};
    const int count = box->count();
    const std::optional<int> current = box->currentRow();
    int row = current.value_or(count - 1);
    for (int left = current ? count - 1 : count; left > 0; --left) {
        row = row + 1 == count ? 0 : row + 1;
        const std::string_view text = box->text(row);
        if (searcher(text.begin(), text.end()).first != text.end() || needle.empty()) {
            return row;
        }
    }
    return std::nullopt;
}
