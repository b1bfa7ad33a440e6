#pragma once

#include "lists/maillistfile.h"
#include "widgets/formdialog.h"

#include <array>
#include <vector>

class EditListAddr;
class KNumericSpinBox;
class ListGroup;
class QCheckBox;
class QGroupBox;
class QListBox;

/// Edits one mailing list. Everything, the three address lists included, is a copy: the record
/// changes only when `store` is called, after the dialog was accepted.
class EditList : public FormDialog {
    Q_OBJECT

public:
    /// `list` is what the dialog starts with; null for a new list.
    EditList(QWidget *parent, const char *name, const maillist_entry *list);

    /// Hands everything over to the record, the address lists by giving them away; what the editor
    /// does not edit stays as it is.
    void store(maillist_entry &list);

public slots:
    void MemberAdd();
    void MemberRemove();
    void MemberSelected(const char *text);
    void MemberModify();
    void MemberSearch();
    void MemberLoad();
    void AllowAdd();
    void AllowRemove();
    void AllowSelected(const char *text);
    void AllowModify();
    void AllowSearch();
    void AllowLoad();
    void BlockAdd();
    void BlockRemove();
    void BlockSelected(const char *text);
    void BlockModify();
    void BlockSearch();
    void BlockLoad();
    void Add(QListBox *box, maillist_addr_entry **chain);
    void AddMember(QListBox *box, maillist_addr_entry **chain);
    void Remove(QListBox *box, maillist_addr_entry **chain);
    void Selected(QListBox *box, maillist_addr_entry **chain, const char *text);
    void SelectedMember(QListBox *box, maillist_addr_entry **chain, const char *text);
    void Search(QListBox *box, maillist_addr_entry **chain);
    void Load(QListBox *box, maillist_addr_entry **chain);
    void Read(maillist_addr_entry *entry, EditListAddr *dialog);
    void browseInfo();
    void browseHeader();
    void browseFooter();

private:
    /// One address list: the working copy and the box that shows it.
    struct Addresses {
        AddressChain maillist_entry::*field;
        AddressChain chain;
        QListBox *box = nullptr;
    };
    struct TextField {
        QLineEdit *edit;
        std::string maillist_entry::*field;
    };
    struct OptionBox {
        QCheckBox *box;
        std::uint32_t bit;
    };
    struct NumberField {
        KNumericSpinBox *box;
        std::int32_t maillist_entry::*field;
    };

    /// What stands behind a number, in a label of that width in pixels.
    struct Unit {
        const char *caption;
        int width;
    };

    using Slot = void (EditList::*)();

    /// A text of the list, the caption of its field, and what "Browse..." behind it does, if it
    /// stands there.
    struct TextRow {
        TranslatableText caption;
        std::string maillist_entry::*field;
        Slot browse;
    };
    static const std::array<TextRow, 5> addressRows;
    static const std::array<TextRow, 3> fileRows;

    /// What the buttons beside an address list, and a chosen row of it, do.
    struct AddressSlots {
        Slot add;
        Slot modify;
        Slot remove;
        Slot search;
        Slot load;
        void (EditList::*selected)(const char *);
    };

    QGroupBox *newTextFields(const maillist_entry &list);
    /// One row for each field, with labels of one width.
    template <std::size_t count>
    void addTextFields(QVBoxLayout *rows, int labelWidth, const std::array<TextRow, count> &fields,
                       const maillist_entry &list);
    [[nodiscard]] QLineEdit *fieldOf(std::string maillist_entry::*field) const;
    QGroupBox *newOptions(const maillist_entry &list);
    void addTrigger(QHBoxLayout *row, const char *caption, CaptionColumn &captions,
                    const Unit &unit, std::int32_t maillist_entry::*field,
                    const maillist_entry &list);
    ListGroup *newAddressGroup(const char *caption, Addresses &addresses,
                               const maillist_entry &list, const AddressSlots &slotsOf);

    std::vector<TextField> texts_;
    std::vector<OptionBox> options_;
    std::vector<NumberField> triggers_;
    Addresses members_{&maillist_entry::member, {}};
    Addresses allowed_{&maillist_entry::allow, {}};
    Addresses blocked_{&maillist_entry::block, {}};
};
