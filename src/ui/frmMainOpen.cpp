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
    if (openInProgress() || !SavedBeforeOpen(app_, [this] { return saveWithChecks(); }))
        return;
    std::string path = app_.PendingFile;
    app_.PendingFile.clear();
    if (path.empty()) {
        const auto chosen =
            services_.dialogs.openFile({"Load DAT-File", "LDraw DAT-File (*.dat)", "dat", app_.Header.FileFolder});
        if (!chosen)
            return; // Cancel: the file the user was working on stays open
        path = *chosen;
    }
    openChosenFile([&] { LadeDATDateiCommandLine(app_, path, services_); }, true, OpenCommand);
}

void frmMain::OpenFile(const std::string& path)
{
    if (openInProgress() || !MayOpenAnotherFile(app_, services_.dialogs, [this] { return saveWithChecks(); }))
        return;
    openChosenFile([&] { TakeRecentFile(app_, path, services_); }, false, OpenRecentFile);
}

void frmMain::MRecentFile_Click(int index)
{
    OpenFile(app_.Recent.MRecentFile[static_cast<std::size_t>(index)].caption);
    showRecentFiles();
}

bool frmMain::saveWithChecks() { return checkHeaderAndSave().outcome == SaveOutcome::Saved; }

void frmMain::openChosenFile(const std::function<void()>& takeFile, bool removeTabs, const Procedure& procedure)
{
    try {
        readChosenFile(takeFile, removeTabs);
    } catch (const std::exception& error) {
        abandonOpen(error, procedure);
    }
    finishCloseRequestedDuringOpen();
}

void frmMain::readChosenFile(const std::function<void()>& takeFile, bool removeTabs)
{
    app_.Header.Loading = true;
    clearWindow();
    BeginOpen(app_, services_);
    fillComboBoxes();
    takeFile();
    showCaption();
    EnableControls();
    lblStatuszeile->setText("Parsing file. Please wait...");
    AddRecentFile(app_.Recent, services_.store, app_.Header.FilePath);
    showRecentFiles();
    RestoreInterruptedSaveOf(app_.Header.FilePath, services_.dialogs);
    GetGlobalContent(app_.Header, services_.dialogs, *progress_);
    lblStatuszeile->setText("");
    fillWindowFromRecord();
    // The header shown and saved is always the one composed from the file just read.
    MakeNewHeader();
    if (removeTabs && RemoveDescriptionTabs(app_.Header, services_.dialogs)) {
        txPartDescription->setText(ToWidget(app_.Header.PartDescription, app_.Header.Encoding));
        showTextsFromTheirStart();
        MakeNewHeader();
    }
    app_.Header.Loading = false;
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

void frmMain::showCaption() { setWindowTitle(QString::fromStdString(CaptionFor(baseTitle_, app_.Header.PartName))); }

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
    const SaveContext context{services_.dialogs,           services_.clock,
                              app_.Prefs.MakeBackup,       [this] { return newHeaderText_; },
                              [this] { MakeNewHeader(); }, app_.Prefs.LimitDescription};
    auto result = CheckHeaderAndSave(app_.Header, context);
    if (result.outcome == SaveOutcome::DescriptionTooLong)
        showDescriptionTooLong();
    return result;
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
    lblLength->setText(QString("Length: %1").arg(text.toUcs4().size()));
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
