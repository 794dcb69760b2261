// SPDX-License-Identifier: MIT
// The keyword, comment and history lists with their Add, Edit and Delete buttons.
#include <QListWidget>

#include "Dialogs.h"
#include "FileText.h"
#include "LineLists.h"
#include "frmMain.h"

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

std::string frmMain::askForLine(const LineForm& form, const std::string& defaultText)
{
    return AskForLine(services_.dialogs, form.prompt, form.title, defaultText, form.history);
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
