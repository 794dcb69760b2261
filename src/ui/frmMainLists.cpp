// SPDX-License-Identifier: MIT
// The keyword, comment and history lists with their Add, Edit and Delete buttons.
#include <QListWidget>

#include "Dialogs.h"
#include "FileText.h"
#include "LineLists.h"
#include "MetaLine.h"
#include "Text.h"
#include "frmMain.h"

namespace {

bool inTrackerHistoryForm(const std::string& typed)
{
    return IsHistoryLine(QString::fromUtf8("0 !HISTORY " + std::string(TrimBlanks(typed))));
}

} // namespace

void frmMain::fillLineList(QListWidget& box, const EntryList& list)
{
    box.clear();
    for (const auto entry : list)
        box.addItem(ToWidget(std::string(entry), app_.Header.Encoding));
}

void frmMain::FillKeywordList() { fillLineList(*lsKeyWords, app_.Header.Keywords); }
void frmMain::FillCommentList() { fillLineList(*lsComments, app_.Header.Comments); }
void frmMain::FillHistoryList() { fillLineList(*lsHistory, app_.Header.History); }

void frmMain::refillLists()
{
    FillKeywordList();
    FillCommentList();
    FillHistoryList();
}

// The text typed into the input box. A history line the Parts Tracker would refuse is pointed out
// before it is taken: the user keeps it, or gets the box back with it to mend it.
std::string frmMain::askForLine(const LineForm& form, const std::string& defaultText)
{
    std::string typed = defaultText;
    for (;;) {
        typed = services_.dialogs.input(form.prompt, form.title, typed);
        if (!form.history || TrimBlanks(typed).empty() || inTrackerHistoryForm(typed))
            return typed;
        const auto keep = services_.dialogs.message(
            {Translatable("Messages", "The Parts Tracker takes history lines only as \"YYYY-MM-DD [user] what "
                                      "changed\" (or {Real Name} in place of [user]), and would refuse") "\r\n" +
                 typed + "\r\n" + Translatable("Messages", "Keep it as it is?"),
             Translatable("Messages", "History"), Buttons::YesNo, Icon::Exclamation, Answer::No});
        if (keep == Answer::Yes)
            return typed;
    }
}

void frmMain::addLine(EntryList& list, const LineForm& form, const std::string& defaultText)
{
    const auto typed = askForLine(form, defaultText);
    if (const auto bytes = toFile(typed))
        AddLineEntry(list, *bytes);
    refillLists();
    MakeNewHeader();
}

void frmMain::editLine(EntryList& list, QListWidget& box, const LineForm& form)
{
    const int row = box.currentRow();
    if (row < 0 || box.selectedItems().isEmpty())
        return;
    const auto old = ToUtf8(std::string(list[static_cast<std::size_t>(row)]), app_.Header.Encoding);
    const auto typed = askForLine(form, old);
    if (const auto bytes = toFile(typed))
        EditLineEntry(list, static_cast<std::size_t>(row), *bytes);
    refillLists();
    box.setCurrentRow(row);
    MakeNewHeader();
}

void frmMain::deleteLine(EntryList& list, QListWidget& box)
{
    const int row = box.currentRow();
    if (row < 0 || box.selectedItems().isEmpty())
        return;
    DeleteLineEntry(list, static_cast<std::size_t>(row));
    refillLists();
    MakeNewHeader();
}
