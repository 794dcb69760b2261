// SPDX-License-Identifier: MIT
// The two roads of opening a file, saving, closing, and files dropped on the window.
#include <QCloseEvent>
#include <QComboBox>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMimeData>
#include <QPlainTextEdit>

#include "DescriptionTabs.h"
#include "Dialogs.h"
#include "DocumentQuestions.h"
#include "ErrorReport.h"
#include "FileSave.h"
#include "FileText.h"
#include "ListEditor.h"
#include "OpenRoad.h"
#include "Parser.h"
#include "Paths.h"
#include "WindowProgress.h"
#include "frmMain.h"
#include "frmOption.h"

namespace {

const Procedure OpenCommand{"MDateiOeffnen_Click", OwnerKind::Formular, "frmMain"};
const Procedure OpenRecentFile{"OpenFile", OwnerKind::Modul, "modQuillmark"};
const Procedure SaveCommand{"MDateiSpeichern_Click", OwnerKind::Formular, "frmMain"};

std::optional<std::string> firstLocalFile(const QMimeData& data)
{
    for (const auto& url : data.urls())
        if (url.isLocalFile())
            return QFile::encodeName(url.toLocalFile()).toStdString();
    return std::nullopt;
}

} // namespace

void frmMain::MDateiOeffnen_Click()
{
    if (openInProgress() || !mayReplaceDocument())
        return;
    std::string path = app_.PendingFile;
    app_.PendingFile.clear();
    if (path.empty()) {
        const auto chosen = services_.dialogs.openFile({Translatable("Messages", "Load DAT-File"),
                                                        Translatable("Messages", "LDraw DAT-File (*.dat)"), "dat",
                                                        app_.Header.FileFolder});
        if (!chosen)
            return; // Cancel: the file the user was working on stays open
        path = *chosen;
    }
    openChosenFile(path, OpenRoad::Chosen, OpenCommand);
}

void frmMain::OpenFile(const std::string& path)
{
    if (openInProgress() || !mayReplaceDocument())
        return;
    openChosenFile(path, OpenRoad::Recent, OpenRecentFile);
}

void frmMain::MRecentFile_Click(int index)
{
    OpenFile(app_.Recent.MRecentFile[static_cast<std::size_t>(index)].caption);
    showRecentFiles();
}

bool frmMain::mayReplaceDocument()
{
    return MayOpenAnotherFile(app_, services_.dialogs,
                              [this] { return checkHeaderAndSave().outcome == SaveOutcome::Saved; });
}

void frmMain::openChosenFile(const std::string& path, OpenRoad road, const Procedure& procedure)
{
    try {
        readChosenFile(path, road);
    } catch (const std::exception& error) {
        abandonOpen(error, procedure);
    }
    finishCloseRequestedDuringOpen();
}

void frmMain::readChosenFile(const std::string& path, OpenRoad road)
{
    const bool firstFile = !app_.Header.FileLoaded;
    app_.Header.Loading = true;
    lblStatuszeile->setText(tr("Parsing file. Please wait..."));
    const bool opened = LadeDATDateiCommandLine(app_, path, road, services_, *progress_);
    lblStatuszeile->setText("");
    if (!opened) { // the document that was open stays, untouched
        app_.Header.Loading = false;
        return;
    }
    clearWindow();
    fillComboBoxes();
    showCaption();
    EnableControls();
    if (firstFile) // the fields were disabled when the window took the focus
        txPartDescription->setFocus(Qt::OtherFocusReason);
    showRecentFiles();
    fillWindowFromRecord();
    // The header shown and saved is always the one composed from the file just read.
    MakeNewHeader();
    if (road == OpenRoad::Chosen && RemoveDescriptionTabs(app_.Header, services_.dialogs)) {
        txPartDescription->setText(ToWidget(app_.Header.PartDescription, app_.Header.Encoding));
        showTextsFromTheirStart();
        MakeNewHeader();
    }
    app_.Header.HeaderAtOpenOrSave = newHeaderText_;
    app_.Header.Loading = false;
    showModified();
}

void frmMain::abandonOpen(const std::exception& error, const Procedure& procedure)
{
    ReportError(services_.dialogs, ErrorOf(error), procedure);
    app_.Header.Loading = false;
    lblStatuszeile->setText("");
}

void frmMain::finishCloseRequestedDuringOpen()
{
    if (!closeRequestedDuringOpen_)
        return;
    closeRequestedDuringOpen_ = false;
    close();
}

void frmMain::clearWindow()
{
    for (QLineEdit* box : {txAuthorRealName, txAuthorUserName, txFileName, txPartDescription})
        box->clear();
    txNewHeader->clear();
    newHeaderText_.clear();
    txOldHeader->clear();
    for (QComboBox* combo : {cbBFCStatement, cbCategory, cbLicenses, cbPartTypes})
        combo->clear();
    for (QListWidget* list : {lsKeyWords, lsHistory, lsComments})
        list->clear();
}

void frmMain::fillComboBoxes()
{
    const std::pair<QComboBox*, ListKind> combos[] = {{cbPartTypes, ListKind::PartType},
                                                      {cbCategory, ListKind::Category},
                                                      {cbBFCStatement, ListKind::Bfc},
                                                      {cbLicenses, ListKind::License}};
    for (const auto& [combo, kind] : combos)
        fillCombo(*combo, kind);
}

void frmMain::fillCombo(QComboBox& combo, ListKind kind)
{
    const QSignalBlocker quiet(combo);
    combo.clear();
    for (const auto& entry : SortedForDisplay(EntriesOf(app_.Lists, kind)))
        combo.addItem(ListEntryToWidget(entry));
    combo.setCurrentIndex(-1);
}

void frmMain::fillWindowFromRecord()
{
    const auto encoding = app_.Header.Encoding;
    txPartDescription->setText(ToWidget(app_.Header.PartDescription, encoding));
    txFileName->setText(ToWidget(app_.Header.PartName, encoding));
    txAuthorRealName->setText(ToWidget(app_.Header.ParsedRealName, encoding));
    txAuthorUserName->setText(ToWidget(app_.Header.AuthorUserName, encoding));
    showTextsFromTheirStart();
    app_.Header.AuthorRealName = app_.Header.ParsedRealName;
    refillLists();
    auto oldHeader = ToWidget(app_.Header.OldHeader, encoding);
    txOldHeader->setPlainText(oldHeader.replace("\r\n", "\n"));
    SelectComboItem(*cbBFCStatement, app_.Header.Bfc);
    SelectComboItem(*cbCategory, app_.Header.Category);
    SelectComboItem(*cbLicenses, app_.Header.License);
    SelectComboItem(*cbPartTypes, app_.Header.PartType);
}

// A text longer than its box shows its start, as the file has it: the end alone would look like
// a text that lost its first words.
void frmMain::showTextsFromTheirStart()
{
    for (QLineEdit* box : {txPartDescription, txFileName, txAuthorRealName, txAuthorUserName})
        box->setCursorPosition(0);
}

void frmMain::SelectComboItem(QComboBox& combo, const std::string& text)
{
    const auto wanted = ToWidget(text, app_.Header.Encoding);
    for (int i = 0; i < combo.count(); ++i)
        if (combo.itemText(i) == wanted)
            combo.setCurrentIndex(i); // the last equal entry ends selected
    combo.repaint();
}

// "[*]" is where Qt shows "*" while the file has unsaved changes; a "[*]" in the file's name is
// doubled so that it stays text.
void frmMain::showCaption()
{
    // The name of the file as it is on disk; its "Name:" line may say another.
    const auto caption =
        QString::fromStdString(CaptionFor(baseTitle_, DateiNurName(app_.Header.FilePath, services_.dialogs)));
    setWindowTitle(QString(caption).replace("[*]", "[*][*]") + "[*]");
    showModified();
}

void frmMain::showModified() { setWindowModified(app_.Header.FileChanged); }

void frmMain::showRecentFiles()
{
    ShowRecentFiles(app_.Recent, services_.store);
    for (std::size_t i = 0; i < MRecentFile.size(); ++i) {
        const auto& item = app_.Recent.MRecentFile[i];
        if (i > 0) // a "&" in a path is part of the name, not an access key
            MRecentFile[i]->setText(QString::fromStdString(item.caption).replace("&", "&&"));
        MRecentFile[i]->setVisible(item.visible);
    }
}

void frmMain::MDateiSpeichern_Click()
{
    if (openInProgress())
        return;
    try {
        checkHeaderAndSave();
    } catch (const std::exception& error) {
        ReportError(services_.dialogs, ErrorOf(error), SaveCommand);
    }
}

SaveResult frmMain::checkHeaderAndSave()
{
    const SaveContext context{services_.dialogs,
                              services_.clock,
                              app_.Prefs.MakeBackup,
                              [this] { return newHeaderText_; },
                              [this] { MakeNewHeader(); },
                              app_.Prefs.LimitDescription,
                              std::string("Option › Preferences › ") + DescriptionLimitCaption};
    auto result = CheckHeaderAndSave(app_.Header, context);
    if (result.outcome == SaveOutcome::DescriptionTooLong)
        showDescriptionTooLong();
    if (result.outcome == SaveOutcome::Saved)
        showSaved(result.backupPath);
    return result;
}

void frmMain::showSaved(const std::string& backupPath)
{
    const auto name = [](const std::string& path) { return QFile::decodeName(QByteArray::fromStdString(path)); };
    auto status = tr("Saved %1").arg(name(app_.Header.FilePath));
    if (!backupPath.empty())
        status = tr("Saved %1 (backup %2)")
                     .arg(name(app_.Header.FilePath), name(DateiNurName(backupPath, services_.dialogs)));
    lblStatuszeile->setText(status + "; " + trackerSummary());
    showModified();
}

void frmMain::showDescriptionTooLong()
{
    txPartDescription->setFocus(Qt::OtherFocusReason);
    const auto text = txPartDescription->text();
    // The limit counts characters; the box counts UTF-16 units, two for a character beyond the
    // basic plane.
    int start = 0;
    for (std::size_t character = 0; character < DescriptionLimit && start < text.size(); ++character)
        start += text.at(start).isHighSurrogate() && start + 1 < text.size() ? 2 : 1;
    txPartDescription->setSelection(start, static_cast<int>(text.size()) - start);
    lblLength->setText(tr("Length: %1").arg(text.toUcs4().size()));
}

void frmMain::closeEvent(QCloseEvent* event)
{
    if (openInProgress()) {
        closeRequestedDuringOpen_ = true; // closes once the open has ended
        event->ignore();
        return;
    }
    MayCloseWindow(app_, services_, newHeaderText_) ? event->accept() : event->ignore();
}

void frmMain::dragEnterEvent(QDragEnterEvent* event)
{
    if (event->mimeData()->hasUrls() && firstLocalFile(*event->mimeData()))
        event->acceptProposedAction();
}

void frmMain::dropEvent(QDropEvent* event)
{
    const auto file = firstLocalFile(*event->mimeData());
    if (!file || openInProgress())
        return;
    event->acceptProposedAction();
    app_.PendingFile = AbsolutePath(*file);
    MDateiOeffnen_Click();
}
