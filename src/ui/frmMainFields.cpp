// SPDX-License-Identifier: MIT
// The single-value header fields: every edit goes into the record at once and recomposes.
#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QPushButton>

#include "Composer.h"
#include "Dialogs.h"
#include "FileText.h"
#include "LineLists.h"
#include "SaveChecks.h"
#include "frmMain.h"

namespace {

// The widget shows line ends its own way; the saved text is kept beside it.
QString shownHeader(const std::string& text, TextEncoding encoding)
{
    auto shown = ToWidget(text, encoding);
    shown.replace("\r\n", "\n");
    return shown;
}

// Focus that moves to another control of the window, not to a message box, a menu or another
// window.
bool leftForAnotherControl(QEvent* event)
{
    if (event->type() != QEvent::FocusOut)
        return false;
    const auto reason = static_cast<QFocusEvent*>(event)->reason();
    return reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason && reason != Qt::MenuBarFocusReason;
}

// A character key pressed with Alt asks for a menu or a button: it neither types nor picks a
// list entry. Ctrl+Alt is AltGr on some keyboards, which types characters; Alt+Down still opens a
// drop-down list.
bool commandKey(const QKeyEvent& key)
{
    return key.modifiers().testFlag(Qt::AltModifier) && !key.modifiers().testFlag(Qt::ControlModifier) &&
           !key.text().isEmpty() && key.text().front().isPrint();
}

} // namespace

void frmMain::connectHandlers()
{
    const std::pair<QComboBox*, std::string HeaderData::*> combos[] = {{cbPartTypes, &HeaderData::PartType},
                                                                       {cbLicenses, &HeaderData::License},
                                                                       {cbBFCStatement, &HeaderData::Bfc},
                                                                       {cbCategory, &HeaderData::Category}};
    for (const auto& [combo, field] : combos)
        connect(combo, &QComboBox::currentIndexChanged, this, [this, combo = combo, field = field](int index) {
            if (index >= 0)
                updateComboField(*combo, app_.Header.*field);
        });
    static const LineForm keywordAdd{Translatable("Messages", "Please enter your Keyword with comma separated."),
                                     Translatable("Messages", "Keywords")};
    static const LineForm keywordEdit{Translatable("Messages", "Please change your Keywords like you wish."),
                                      Translatable("Messages", "Keywords")};
    static const LineForm commentAdd{Translatable("Messages", "Please enter your Comment"),
                                     Translatable("Messages", "Comment")};
    static const LineForm commentEdit{Translatable("Messages", "Please enter Comments"),
                                      Translatable("Messages", "Comments")};
    static const LineForm history{HistoryPrompt, Translatable("Messages", "History"), true};
    connect(cmdAdd, &QPushButton::clicked, this, [this] { addLine(app_.Header.Keywords, keywordAdd, ""); });
    connect(cmdEdit, &QPushButton::clicked, this, [this] { editLine(app_.Header.Keywords, *lsKeyWords, keywordEdit); });
    connect(cmdDelete, &QPushButton::clicked, this, [this] { deleteLine(app_.Header.Keywords, *lsKeyWords); });
    connect(cmdCommentsAdd, &QPushButton::clicked, this, [this] { addLine(app_.Header.Comments, commentAdd, ""); });
    connect(cmdCommentsEdit, &QPushButton::clicked, this,
            [this] { editLine(app_.Header.Comments, *lsComments, commentEdit); });
    connect(cmdCommentsDelete, &QPushButton::clicked, this, [this] { deleteLine(app_.Header.Comments, *lsComments); });
    connect(cmdHistoryAdd, &QPushButton::clicked, this, [this] {
        addLine(app_.Header.History, history, HistoryStub(services_.clock.now(), app_.Prefs.DefaultUserName));
    });
    connect(cmdHistoryEdit, &QPushButton::clicked, this,
            [this] { editLine(app_.Header.History, *lsHistory, history); });
    connect(cmdHistoryDelete, &QPushButton::clicked, this, [this] { deleteLine(app_.Header.History, *lsHistory); });
    connect(lsKeyWords, &QListWidget::itemDoubleClicked, cmdEdit, [this] { cmdEdit->click(); });
    connect(lsComments, &QListWidget::itemDoubleClicked, cmdCommentsEdit, [this] { cmdCommentsEdit->click(); });
    connect(lsHistory, &QListWidget::itemDoubleClicked, cmdHistoryEdit, [this] { cmdHistoryEdit->click(); });
    connect(cmdSetPreferences, &QPushButton::clicked, this, &frmMain::cmdSetPreferences_Click);
}

bool frmMain::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == client_ && event->type() == QEvent::Resize && layOutControls_) {
        placeControls();
        return false;
    }
    const std::pair<QLineEdit*, std::string HeaderData::*> boxes[] = {{txPartDescription, &HeaderData::PartDescription},
                                                                      {txAuthorRealName, &HeaderData::AuthorRealName},
                                                                      {txAuthorUserName, &HeaderData::AuthorUserName}};
    if (event->type() == QEvent::KeyPress) {
        if (commandKey(*static_cast<QKeyEvent*>(event)))
            return true; // a key meant for a menu or a button, which found none, types nothing either
        const auto key = static_cast<QKeyEvent*>(event)->key();
        keysPressedInBox_.insert({watched, key});
        if (key == Qt::Key_Return || key == Qt::Key_Enter)
            moveFocusOnEnter(watched); // the key still reaches the control
    }
    if (typedIntoBox(watched, event) || leftForAnotherControl(event))
        for (const auto& [box, field] : boxes)
            if (watched == box && box->isEnabled())
                updateTextField(*box, app_.Header.*field);
    if (event->type() == QEvent::FocusOut)
        std::erase_if(keysPressedInBox_, [watched](const auto& pressed) { return pressed.first == watched; });
    return QMainWindow::eventFilter(watched, event);
}

// A key's release edits a box only when the box also had the key's press: the release of a key
// that opened a menu, closed a dialog or chose a menu item lands in the box without being typed
// there. Focus leaving the box (to a menu, say) forgets its presses.
bool frmMain::typedIntoBox(QObject* watched, QEvent* event)
{
    if (event->type() != QEvent::KeyRelease)
        return false;
    return keysPressedInBox_.erase({watched, static_cast<QKeyEvent*>(event)->key()}) > 0;
}

void frmMain::moveFocusOnEnter(QObject* watched)
{
    const std::pair<QWidget*, QWidget*> chain[] = {{txPartDescription, txAuthorRealName},
                                                   {txAuthorRealName, txAuthorUserName},
                                                   {txAuthorUserName, cbPartTypes},
                                                   {cbPartTypes, cbLicenses},
                                                   {cbLicenses, cbBFCStatement},
                                                   {cbBFCStatement, cbCategory},
                                                   {cbCategory, lsKeyWords}};
    for (const auto& [from, to] : chain)
        if (watched == from) {
            // Keyboard focus shows its frame, as after Tab.
            setAttribute(Qt::WA_KeyboardFocusChange);
            to->setFocus(Qt::TabFocusReason);
        }
}

void frmMain::updateTextField(QLineEdit& box, std::string& field)
{
    const auto bytes = FromWidget(box.text(), app_.Header.Encoding);
    if (!bytes) {
        box.setText(ToWidget(field, app_.Header.Encoding));
        services_.dialogs.message({UnencodableMessage(), ProgramTitle, Buttons::Ok, Icon::Exclamation, Answer::Ok});
        return;
    }
    field = *bytes;
    MakeNewHeader();
}

void frmMain::updateComboField(QComboBox& combo, std::string& field)
{
    if (const auto bytes = toFile(combo.currentText().toStdString()))
        field = *bytes;
    MakeNewHeader();
}

void frmMain::MakeNewHeader()
{
    newHeaderText_ = ComposeHeader(app_.Header);
    txNewHeader->setPlainText(shownHeader(newHeaderText_, app_.Header.Encoding));
    // Keys that change nothing, or a letter typed and deleted again, leave the file unchanged; a
    // changed body stays a change.
    if (!app_.Header.Loading)
        app_.Header.FileChanged = app_.Header.BodyChanged || newHeaderText_ != app_.Header.HeaderAtOpenOrSave;
    showModified();
    showLength();
}

void frmMain::showLength()
{
    const auto length = txPartDescription->text().toUcs4().size();
    lblLength->setText(tr("Length: %1").arg(length));
    const bool tooLong = app_.Prefs.LimitDescription && static_cast<std::size_t>(length) > DescriptionLimit;
    lblLength->setStyleSheet(tooLong ? "background-color: rgb(255, 0, 0);" : "background-color: rgb(0, 255, 0);");
}

std::optional<std::string> frmMain::toFile(const std::string& utf8)
{
    auto bytes = FromUtf8(utf8, app_.Header.Encoding);
    if (!bytes)
        services_.dialogs.message({UnencodableMessage(), ProgramTitle, Buttons::Ok, Icon::Exclamation, Answer::Ok});
    return bytes;
}
