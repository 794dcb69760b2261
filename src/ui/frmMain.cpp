// SPDX-License-Identifier: MIT
#include "frmMain.h"

#include <QComboBox>
#include <QFile>
#include <QFrame>
#include <QIcon>
#include <QLabel>
#include <QLayout>
#include <QLineEdit>
#include <QListWidget>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QScrollArea>
#include <QTimer>

#include "Dialogs.h"
#include "OpenRoad.h"
#include "Paths.h"
#include "TwipLayout.h"
#include "WindowProgress.h"

namespace {

// major.minor.revision, from the project's version.
std::string versionText()
{
    return std::to_string(QUILLMARK_VERSION_MAJOR) + "." + std::to_string(QUILLMARK_VERSION_MINOR) + "." +
           std::to_string(QUILLMARK_VERSION_PATCH);
}

// The platform's keys for a standard command. Key schemes without a Quit key (Windows', which some
// platforms use) get Ctrl+Q, which every Linux desktop uses for it.
QList<QKeySequence> shortcutsFor(QKeySequence::StandardKey command)
{
    auto keys = QKeySequence::keyBindings(command);
    if (keys.isEmpty() && command == QKeySequence::Quit)
        keys.append(QKeySequence(Qt::CTRL | Qt::Key_Q));
    return keys;
}

// The client area in twips.
constexpr int ClientWidth = 9240;
constexpr int ClientHeight = 8550;

} // namespace

frmMain::frmMain(AppState& app, Services& services, QWidget* parent)
    : QMainWindow(parent), app_(app), services_(services)
{
    setObjectName("frmMain");
    setWindowTitle("Quillmark");
    // The icon is linked in from a static library, whose resources register only when asked.
    Q_INIT_RESOURCE(resources);
    setWindowIcon(QIcon(":/quillmark.png"));
    setAcceptDrops(true);
    // The client area scrolls only where the screen is too small for the window grown with its font.
    scroller_ = new QScrollArea(this);
    scroller_->setObjectName("scroller");
    scroller_->setFrameShape(QFrame::NoFrame);
    scroller_->setFocusPolicy(Qt::NoFocus); // the focus starts in the description, not on the frame around it
    client_ = new QWidget;
    client_->setObjectName("client");
    scroller_->setWidget(client_);
    setCentralWidget(scroller_);
    createControls();
    createMenus();
    setTabOrder();
    progress_ = std::make_unique<WindowProgress>(*lblStatuszeile);
    for (QWidget* field : std::initializer_list<QWidget*>{txPartDescription, txAuthorRealName, txAuthorUserName,
                                                          cbPartTypes, cbLicenses, cbBFCStatement, cbCategory})
        field->installEventFilter(this);
    scroller_->setWidgetResizable(true); // the client fills the window, and scrolls below its design size
    client_->installEventFilter(this);   // its growth goes to the lists: see placeControls
    layOut();
}

frmMain::~frmMain() = default;

void frmMain::createControls()
{
    using Row = ControlRow<frmMain, QLabel, QLineEdit, QComboBox, QListWidget, QPushButton, QPlainTextEdit, QFrame>;
    static const Row rows[] = {
        {&frmMain::Label1, "Label1", QT_TR_NOOP("Part Description:"), 120, 120, 1335, 255},
        {&frmMain::txPartDescription, "txPartDescription", nullptr, 1560, 120, 6375, 285},
        {&frmMain::lblLength, "lblLength", QT_TR_NOOP("Length:"), 8160, 120, 975, 255},
        {&frmMain::Label2_0, "Label2_0", QT_TR_NOOP("File Name:"), 120, 480, 1335, 255},
        {&frmMain::txFileName, "txFileName", nullptr, 1560, 480, 7575, 285},
        {&frmMain::Label2_1, "Label2_1", QT_TR_NOOP("Author:"), 120, 840, 1335, 255},
        {&frmMain::Label4, "Label4", QT_TR_NOOP("Real Name"), 1560, 840, 855, 255},
        {&frmMain::txAuthorRealName, "txAuthorRealName", nullptr, 2520, 840, 3015, 285},
        {&frmMain::Label3, "Label3", QT_TR_NOOP("Username:"), 5640, 840, 855, 255},
        {&frmMain::txAuthorUserName, "txAuthorUserName", nullptr, 6600, 840, 2535, 285},
        {&frmMain::Label2_2, "Label2_2", QT_TR_NOOP("Part Type:"), 120, 1200, 1335, 255},
        {&frmMain::cbPartTypes, "cbPartTypes", nullptr, 1560, 1200, 7575, 315},
        {&frmMain::Label2_3, "Label2_3", QT_TR_NOOP("License Type:"), 120, 1560, 1335, 255},
        {&frmMain::cbLicenses, "cbLicenses", nullptr, 1560, 1560, 6135, 315},
        {&frmMain::cmdSetPreferences, "cmdSetPreferences", QT_TR_NOOP("Set Preferences"), 7800, 1560, 1335, 255},
        {&frmMain::Label6, "Label6", QT_TR_NOOP("BFC Statement"), 120, 1920, 1335, 255},
        {&frmMain::cbBFCStatement, "cbBFCStatement", nullptr, 1560, 1920, 7575, 315},
        {&frmMain::Label8, "Label8", QT_TR_NOOP("Category"), 120, 2280, 1335, 255},
        {&frmMain::cbCategory, "cbCategory", nullptr, 1560, 2280, 7575, 315},
        {&frmMain::Label9, "Label9", QT_TR_NOOP("Keywords"), 120, 2640, 1335, 255},
        {&frmMain::lsKeyWords, "lsKeyWords", nullptr, 1560, 2640, 3855, 840},
        {&frmMain::cmdEdit, "cmdEdit", QT_TR_NOOP("Edit"), 5520, 2640, 735, 255},
        {&frmMain::cmdAdd, "cmdAdd", QT_TR_NOOP("Add"), 5520, 2880, 735, 255},
        {&frmMain::cmdDelete, "cmdDelete", QT_TR_NOOP("Delete"), 5520, 3240, 735, 255},
        {&frmMain::Label11, "Label11", QT_TR_NOOP("Comments"), 6600, 2640, 2415, 255},
        {&frmMain::lsComments, "lsComments", nullptr, 6480, 2880, 2655, 1035},
        {&frmMain::Label10, "Label10", QT_TR_NOOP("History"), 120, 3600, 1335, 255},
        {&frmMain::lsHistory, "lsHistory", nullptr, 1560, 3600, 3855, 840},
        {&frmMain::cmdHistoryEdit, "cmdHistoryEdit", QT_TR_NOOP("Edit"), 5520, 3600, 735, 255},
        {&frmMain::cmdHistoryAdd, "cmdHistoryAdd", QT_TR_NOOP("Add"), 5520, 3840, 735, 255},
        {&frmMain::cmdHistoryDelete, "cmdHistoryDelete", QT_TR_NOOP("Delete"), 5520, 4200, 735, 255},
        {&frmMain::cmdCommentsEdit, "cmdCommentsEdit", QT_TR_NOOP("Edit"), 6480, 4200, 735, 255},
        {&frmMain::cmdCommentsAdd, "cmdCommentsAdd", QT_TR_NOOP("Add"), 7440, 4200, 735, 255},
        {&frmMain::cmdCommentsDelete, "cmdCommentsDelete", QT_TR_NOOP("Delete"), 8400, 4200, 735, 255},
        {&frmMain::Label7, "Label7", QT_TR_NOOP("New Header:"), 120, 4680, 1335, 255},
        {&frmMain::txNewHeader, "txNewHeader", nullptr, 1560, 4560, 7575, 1815},
        {&frmMain::Label5, "Label5", QT_TR_NOOP("Old Header:"), 120, 6600, 1335, 255},
        {&frmMain::txOldHeader, "txOldHeader", nullptr, 1560, 6480, 7575, 1695},
        {&frmMain::lblStatuszeile, "lblStatuszeile", "", 120, 8280, 6735, 255},
        {&frmMain::Line1, "Line1", nullptr, 0, 0, 9240, 15},
        {&frmMain::Line2, "Line2", nullptr, 0, 10, 9240, 15},
    };
    BuildControls(*this, client_, rows);
    // Captions widen within the design's width, wherever the window has grown to.
    layOutControls_ = [this](double scale) { LayOutControls(*this, rows, scale, client_->minimumWidth()); };
    lblLength->setAutoFillBackground(true);
    for (QPlainTextEdit* box : {txNewHeader, txOldHeader}) {
        box->setReadOnly(true);
        box->setLineWrapMode(QPlainTextEdit::NoWrap);
        box->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
        box->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    }
    for (auto* line : {Line1, Line2})
        line->setFrameShape(QFrame::HLine);
    connectHandlers();
}

void frmMain::createMenus()
{
    struct MenuRow {
        const char* menu;          // the menu's name; nullptr for an item of the menu bar itself
        QAction* frmMain::*member; // nullptr for a separator
        const char* name;
        const char* caption;
        void (frmMain::*handler)();
        QKeySequence::StandardKey shortcut = QKeySequence::UnknownKey; // beside the access keys
        QKeySequence ownShortcut = {};                                 // where no standard key fits
    };
    static const std::pair<const char*, const char*> menus[] = {
        {"MDatei", QT_TR_NOOP("F&ile")}, {"MEdit", QT_TR_NOOP("&Edit")}, {"MEinstellungen", QT_TR_NOOP("&Option")}};
    static const MenuRow items[] = {
        {"MDatei", &frmMain::MDateiOeffnen, "MDateiOeffnen", QT_TR_NOOP("O&pen"), &frmMain::MDateiOeffnen_Click,
         QKeySequence::Open},
        {"MDatei", &frmMain::MDateiSpeichern, "MDateiSpeichern", QT_TR_NOOP("&Save"), &frmMain::MDateiSpeichern_Click,
         QKeySequence::Save},
        {"MDatei", &frmMain::MTrackerCheck, "MTrackerCheck", QT_TR_NOOP("Check for the Parts &Tracker"),
         &frmMain::MTrackerCheck_Click, QKeySequence::UnknownKey, QKeySequence(Qt::CTRL | Qt::Key_T)},
        {"MDatei", nullptr, "MDateiTrenner2", nullptr, nullptr},
        {"MDatei", &frmMain::MDateiBeenden, "MDateiBeenden", QT_TR_NOOP("E&xit"), &frmMain::MDateiBeenden_Click,
         QKeySequence::Quit},
        {"MEdit", &frmMain::MEditCategory, "MEditCategory", QT_TR_NOOP("&Category"), &frmMain::MEditCategory_Click},
        {"MEdit", &frmMain::MEditPartTyps, "MEditPartTyps", QT_TR_NOOP("&Part Types"), &frmMain::MEditPartTyps_Click},
        {"MEdit", &frmMain::MEditBFCStatement, "MEditBFCStatement", QT_TR_NOOP("&BFC Statements"),
         &frmMain::MEditBFCStatement_Click},
        {"MEdit", &frmMain::MEditLicense, "MEditLicense", QT_TR_NOOP("&License Types"), &frmMain::MEditLicense_Click},
        {"MEinstellungen", &frmMain::MEinstellDefault, "MEinstellDefault", QT_TR_NOOP("Preferences"),
         &frmMain::MEinstellDefault_Click},
        {nullptr, &frmMain::MInfo, "MInfo", "?", &frmMain::MInfo_Click, QKeySequence::HelpContents},
    };
    for (const auto& [name, caption] : menus)
        menuBar()->addMenu(tr(caption))->setObjectName(name);
    for (const auto& item : items) {
        auto* menu = item.menu ? menuBar()->findChild<QMenu*>(item.menu) : nullptr;
        if (item.member == nullptr) {
            menu->addSeparator()->setObjectName(item.name);
            continue;
        }
        auto* action = menu ? menu->addAction(tr(item.caption)) : menuBar()->addAction(tr(item.caption));
        action->setObjectName(item.name);
        auto keys = shortcutsFor(item.shortcut);
        if (!item.ownShortcut.isEmpty())
            keys << item.ownShortcut;
        action->setShortcuts(keys);
        connect(action, &QAction::triggered, this, item.handler);
        this->*item.member = action;
    }
    addRecentFileItems(*menuBar()->findChild<QMenu*>("MDatei"));
    openFileMenuWithAltF();
}

// Alt+F opens the File menu as in most programs, beside its own access key Alt+I.
void frmMain::openFileMenuWithAltF()
{
    auto* altF = new QAction(this);
    altF->setObjectName("MDateiAltF");
    altF->setShortcut(QKeySequence(Qt::ALT | Qt::Key_F));
    addAction(altF);
    connect(altF, &QAction::triggered, this,
            [this] { menuBar()->setActiveAction(menuBar()->findChild<QMenu*>("MDatei")->menuAction()); });
}

// The separator and the ten recent-file items at the end of the File menu, hidden until used.
void frmMain::addRecentFileItems(QMenu& menu)
{
    MRecentFile[0] = menu.addSeparator();
    MRecentFile[0]->setObjectName("MRecentFile_0");
    MRecentFile[0]->setVisible(false);
    for (int i = 1; i <= 10; ++i) {
        auto* item = menu.addAction(QString("RecentFile%1").arg(i));
        item->setObjectName(QString("MRecentFile_%1").arg(i));
        item->setVisible(false);
        connect(item, &QAction::triggered, this, [this, i] { MRecentFile_Click(i); });
        MRecentFile[static_cast<std::size_t>(i)] = item;
    }
}

void frmMain::setTabOrder()
{
    ChainTabOrder({txPartDescription, txFileName,     txAuthorRealName, txAuthorUserName, cbPartTypes,
                   cbLicenses,        cbBFCStatement, cbCategory,       txOldHeader,      txNewHeader,
                   lsKeyWords,        cmdAdd,         cmdDelete,        cmdEdit,          cmdSetPreferences,
                   lsHistory,         cmdHistoryEdit, cmdHistoryDelete, cmdHistoryAdd,    lsComments,
                   cmdCommentsEdit,   cmdCommentsAdd, cmdCommentsDelete});
    for (QLabel* text : {Label1, lblLength, Label4, Label3, Label6, Label8, Label9, Label11, Label10, Label7, Label5,
                         lblStatuszeile, Label2_0, Label2_1, Label2_2, Label2_3})
        text->setFocusPolicy(Qt::NoFocus);
}

// The twip layout grown with the window font; called again whenever the font changes (a desktop
// theme may set its font once the window exists).
void frmMain::layOut()
{
    scale_ = LayoutScale(font());
    client_->setMinimumSize(Pixels(ClientWidth, scale_), Pixels(ClientHeight, scale_));
    placeControls();
    fitOnScreen();
}

// The controls at their design places, and the room the window has beyond its design size shared
// out: the keyword, history and comment lists and the old header grow into it, the controls
// beside and below them move along, and everything else stays where it is.
void frmMain::placeControls()
{
    layOutControls_(scale_);
    // Half of the width to the keyword and history lists, half to the comment list; a quarter of
    // the height to each of the keyword and history lists, half to the comments and the old header.
    ShareRoom({{lsKeyWords, 0, 0, 0.5, 0.25},
               {cmdEdit, 0.5, 0, 0, 0},
               {cmdAdd, 0.5, 0, 0, 0},
               {cmdDelete, 0.5, 0, 0, 0},
               {Label10, 0, 0.25, 0, 0},
               {lsHistory, 0, 0.25, 0.5, 0.25},
               {cmdHistoryEdit, 0.5, 0.25, 0, 0},
               {cmdHistoryAdd, 0.5, 0.25, 0, 0},
               {cmdHistoryDelete, 0.5, 0.25, 0, 0},
               {Label11, 0.5, 0, 0, 0},
               {lsComments, 0.5, 0, 0.5, 0.5},
               {cmdCommentsEdit, 0.5, 0.5, 0, 0},
               {cmdCommentsAdd, 0.5, 0.5, 0, 0},
               {cmdCommentsDelete, 0.5, 0.5, 0, 0},
               {Label7, 0, 0.5, 0, 0},
               {txNewHeader, 0, 0.5, 0, 0},
               {Label5, 0, 0.5, 0, 0},
               {txOldHeader, 0, 0.5, 1, 0.5}},
              (client_->size() - client_->minimumSize()).expandedTo(QSize(0, 0)));
    const int width = client_->width();
    Line1->setGeometry(0, 0, width, 1);
    Line2->setGeometry(0, 1, width, 1);
    lblStatuszeile->setGeometry(0, client_->height() - lblStatuszeile->height(), width, lblStatuszeile->height());
}

// The design size is the window's smallest, and its first; on a screen too small for it, the
// screen's size, the client area scrolling. The window manager's frame counts once it is known:
// see moveEvent.
void frmMain::fitOnScreen()
{
    QSize room = client_->minimumSize();
    if (const QScreen* shownOn = screen())
        room =
            room.boundedTo(shownOn->availableGeometry().size() - fitFrame_ - QSize(0, menuBar()->sizeHint().height()));
    const bool first = scroller_->minimumSize() == QSize(0, 0);
    scroller_->setMinimumSize(room); // the window's layout adds the menu bar, as it is drawn
    if (first) {
        layout()->activate();
        resize(minimumSize());
    }
}

// The window manager frames the window only after it shows, and moves it then; a move that leaves
// the frame as it was changes nothing.
void frmMain::moveEvent(QMoveEvent* event)
{
    QMainWindow::moveEvent(event);
    const QSize frame = frameGeometry().size() - geometry().size();
    if (frame == fitFrame_ || !layOutControls_)
        return;
    fitFrame_ = frame;
    fitOnScreen();
}

void frmMain::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::FontChange && layOutControls_)
        layOut();
    QMainWindow::changeEvent(event);
}

void frmMain::EnableControls()
{
    const bool enabled = app_.Header.FileLoaded;
    for (QWidget* control : std::initializer_list<QWidget*>{
             txAuthorRealName, txAuthorUserName, txPartDescription, txNewHeader, txOldHeader, cbBFCStatement,
             cbCategory, cbLicenses, cbPartTypes, cmdAdd, cmdDelete, cmdEdit, cmdHistoryAdd, cmdHistoryDelete,
             cmdHistoryEdit, cmdCommentsAdd, cmdCommentsDelete, cmdCommentsEdit, cmdSetPreferences})
        control->setEnabled(enabled);
    MDateiSpeichern->setEnabled(enabled);
    MTrackerCheck->setEnabled(enabled);
    // The file name is only shown: it never takes input once the program runs.
    txFileName->setEnabled(false);
}

void frmMain::StartUp(const QStringList& arguments)
{
    StartUpState(app_, services_);
    showRecentFiles();
    EnableControls();
    fillComboBoxes();
    baseTitle_ = "Quillmark " + versionText();
    setWindowTitle(QString::fromStdString(baseTitle_));
    lblStatuszeile->setText(tr("Welcome to the Quillmark program."));
    // The shell hands the arguments over already split: the first one is the path, blanks and all.
    // It is remembered in full, so that the recent files still find it from another folder.
    app_.PendingFile =
        arguments.isEmpty() ? std::string() : AbsolutePath(QFile::encodeName(arguments.first()).toStdString());
    show();
    // Once the window manager has placed the window, so that what the open tells shows over it.
    if (!app_.PendingFile.empty())
        QTimer::singleShot(0, this, [this] { MDateiOeffnen_Click(); });
}

void frmMain::MInfo_Click()
{
    const auto version = tr("Quillmark Version: %1").arg(QString::fromStdString(versionText()));
    const auto copyright = tr("Copyright %1 %2").arg(QUILLMARK_COPYRIGHT_YEARS, QUILLMARK_COPYRIGHT_HOLDER);
    services_.dialogs.message(InformationBox((version + "\r\n" + copyright).toStdString()));
}
