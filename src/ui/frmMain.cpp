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

constexpr int ClientWidth = Pixels(9240);
constexpr int ClientHeight = Pixels(8550);

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
    auto* client = new QWidget(this);
    client->setObjectName("client");
    client->setFixedSize(ClientWidth, ClientHeight);
    setCentralWidget(client);
    createControls();
    createMenus();
    setTabOrder();
    progress_ = std::make_unique<WindowProgress>(*lblStatuszeile);
    for (QWidget* field : std::initializer_list<QWidget*>{txPartDescription, txAuthorRealName, txAuthorUserName,
                                                          cbPartTypes, cbLicenses, cbBFCStatement, cbCategory})
        field->installEventFilter(this);
    layout()->setSizeConstraint(QLayout::SetFixedSize);
}

frmMain::~frmMain() = default;

QComboBox* frmMain::fieldCombo(const char* name, int left, int top, int width, int height)
{
    auto* combo = PlaceChild<QComboBox>(centralWidget(), name, left, top, width, height);
    combo->setEditable(false);
    return combo;
}

QPlainTextEdit* frmMain::headerBox(const char* name, int left, int top, int width, int height)
{
    auto* box = PlaceChild<QPlainTextEdit>(centralWidget(), name, left, top, width, height);
    box->setReadOnly(true);
    box->setLineWrapMode(QPlainTextEdit::NoWrap);
    box->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    box->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    return box;
}

void frmMain::createControls()
{
    Label1 = PlaceCaptioned<QLabel>(centralWidget(), "Label1", "Part Description:", 120, 120, 1335, 255);
    txPartDescription = PlaceChild<QLineEdit>(centralWidget(), "txPartDescription", 1560, 120, 6375, 285);
    lblLength = PlaceCaptioned<QLabel>(centralWidget(), "lblLength", "Length:", 8160, 120, 975, 255);
    lblLength->setAutoFillBackground(true);
    Label2[0] = PlaceCaptioned<QLabel>(centralWidget(), "Label2_0", "File Name:", 120, 480, 1335, 255);
    txFileName = PlaceChild<QLineEdit>(centralWidget(), "txFileName", 1560, 480, 7575, 285);
    Label2[1] = PlaceCaptioned<QLabel>(centralWidget(), "Label2_1", "Author:", 120, 840, 1335, 255);
    Label4 = PlaceCaptioned<QLabel>(centralWidget(), "Label4", "Real Name", 1560, 840, 855, 255);
    txAuthorRealName = PlaceChild<QLineEdit>(centralWidget(), "txAuthorRealName", 2520, 840, 3015, 285);
    Label3 = PlaceCaptioned<QLabel>(centralWidget(), "Label3", "Username:", 5640, 840, 855, 255);
    txAuthorUserName = PlaceChild<QLineEdit>(centralWidget(), "txAuthorUserName", 6600, 840, 2535, 285);
    Label2[2] = PlaceCaptioned<QLabel>(centralWidget(), "Label2_2", "Part Type:", 120, 1200, 1335, 255);
    cbPartTypes = fieldCombo("cbPartTypes", 1560, 1200, 7575, 315);
    Label2[3] = PlaceCaptioned<QLabel>(centralWidget(), "Label2_3", "Liscense Type:", 120, 1560, 1335, 255);
    cbLicenses = fieldCombo("cbLicenses", 1560, 1560, 6135, 315);
    cmdSetPreferences =
        PlaceCaptioned<QPushButton>(centralWidget(), "cmdSetPreferences", "Set Preferences", 7800, 1560, 1335, 255);
    Label6 = PlaceCaptioned<QLabel>(centralWidget(), "Label6", "BFC Statement", 120, 1920, 1335, 255);
    cbBFCStatement = fieldCombo("cbBFCStatement", 1560, 1920, 7575, 315);
    Label8 = PlaceCaptioned<QLabel>(centralWidget(), "Label8", "Category", 120, 2280, 1335, 255);
    cbCategory = fieldCombo("cbCategory", 1560, 2280, 7575, 315);
    Label9 = PlaceCaptioned<QLabel>(centralWidget(), "Label9", "Keywords", 120, 2640, 1335, 255);
    lsKeyWords = PlaceChild<QListWidget>(centralWidget(), "lsKeyWords", 1560, 2640, 3855, 840);
    cmdEdit = PlaceCaptioned<QPushButton>(centralWidget(), "cmdEdit", "Edit", 5520, 2640, 735, 255);
    cmdAdd = PlaceCaptioned<QPushButton>(centralWidget(), "cmdAdd", "Add", 5520, 2880, 735, 255);
    cmdDelete = PlaceCaptioned<QPushButton>(centralWidget(), "cmdDelete", "Delete", 5520, 3240, 735, 255);
    Label11 = PlaceCaptioned<QLabel>(centralWidget(), "Label11", "Comments", 6600, 2640, 2415, 255);
    lsComments = PlaceChild<QListWidget>(centralWidget(), "lsComments", 6480, 2880, 2655, 1035);
    Label10 = PlaceCaptioned<QLabel>(centralWidget(), "Label10", "History", 120, 3600, 1335, 255);
    lsHistory = PlaceChild<QListWidget>(centralWidget(), "lsHistory", 1560, 3600, 3855, 840);
    cmdHistoryEdit = PlaceCaptioned<QPushButton>(centralWidget(), "cmdHistoryEdit", "Edit", 5520, 3600, 735, 255);
    cmdHistoryAdd = PlaceCaptioned<QPushButton>(centralWidget(), "cmdHistoryAdd", "Add", 5520, 3840, 735, 255);
    cmdHistoryDelete = PlaceCaptioned<QPushButton>(centralWidget(), "cmdHistoryDelete", "Delete", 5520, 4200, 735, 255);
    cmdCommentsEdit = PlaceCaptioned<QPushButton>(centralWidget(), "cmdCommentsEdit", "Edit", 6480, 4200, 735, 255);
    cmdCommentsAdd = PlaceCaptioned<QPushButton>(centralWidget(), "cmdCommentsAdd", "Add", 7440, 4200, 735, 255);
    cmdCommentsDelete =
        PlaceCaptioned<QPushButton>(centralWidget(), "cmdCommentsDelete", "Delete", 8400, 4200, 735, 255);
    Label7 = PlaceCaptioned<QLabel>(centralWidget(), "Label7", "New Header:", 120, 4680, 1335, 255);
    txNewHeader = headerBox("txNewHeader", 1560, 4560, 7575, 1815);
    Label5 = PlaceCaptioned<QLabel>(centralWidget(), "Label5", "Old Header:", 120, 6600, 1335, 255);
    txOldHeader = headerBox("txOldHeader", 1560, 6480, 7575, 1695);
    lblStatuszeile = PlaceCaptioned<QLabel>(centralWidget(), "lblStatuszeile", "", 120, 8280, 6735, 255);
    Line1 = PlaceChild<QFrame>(centralWidget(), "Line1", 0, 0, 9240, 15);
    Line2 = PlaceChild<QFrame>(centralWidget(), "Line2", 0, 10, 9240, 15);
    for (auto* line : {Line1, Line2})
        line->setFrameShape(QFrame::HLine);
    connectHandlers();
}

void frmMain::createMenus()
{
    auto* MDatei = menuBar()->addMenu("F&ile");
    MDatei->setObjectName("MDatei");
    const auto action = [this](QMenu* menu, const char* name, const char* caption, auto handler) {
        auto* item = menu->addAction(caption);
        item->setObjectName(name);
        connect(item, &QAction::triggered, this, handler);
        return item;
    };
    MDateiOeffnen = action(MDatei, "MDateiOeffnen", "O&pen", &frmMain::MDateiOeffnen_Click);
    MDateiSpeichern = action(MDatei, "MDateiSpeichern", "&Save", &frmMain::MDateiSpeichern_Click);
    MTrackerCheck = action(MDatei, "MTrackerCheck", "Check for the Parts &Tracker", &frmMain::MTrackerCheck_Click);
    MDatei->addSeparator()->setObjectName("MDateiTrenner2");
    MDateiBeenden = action(MDatei, "MDateiBeenden", "E&xit", &QWidget::close);
    MRecentFile[0] = MDatei->addSeparator();
    MRecentFile[0]->setObjectName("MRecentFile_0");
    MRecentFile[0]->setVisible(false);
    for (int i = 1; i <= 10; ++i) {
        auto* item = MDatei->addAction(QString("RecentFile%1").arg(i));
        item->setObjectName(QString("MRecentFile_%1").arg(i));
        item->setVisible(false);
        connect(item, &QAction::triggered, this, [this, i] { MRecentFile_Click(i); });
        MRecentFile[static_cast<std::size_t>(i)] = item;
    }

    auto* MEdit = menuBar()->addMenu("&Edit");
    MEdit->setObjectName("MEdit");
    MEditCategory = action(MEdit, "MEditCategory", "&Category", &frmMain::MEditCategory_Click);
    MEditPartTyps = action(MEdit, "MEditPartTyps", "&Part Types", &frmMain::MEditPartTyps_Click);
    MEditBFCStatement = action(MEdit, "MEditBFCStatement", "&BFC Statements", &frmMain::MEditBFCStatement_Click);
    MEditLicense = action(MEdit, "MEditLicense", "&License Types", &frmMain::MEditLicense_Click);

    auto* MEinstellungen = menuBar()->addMenu("&Option");
    MEinstellungen->setObjectName("MEinstellungen");
    MEinstellDefault = action(MEinstellungen, "MEinstellDefault", "Preferences", &frmMain::MEinstellDefault_Click);

    MInfo = menuBar()->addAction("?");
    MInfo->setObjectName("MInfo");
    connect(MInfo, &QAction::triggered, this, &frmMain::MInfo_Click);
}

void frmMain::setTabOrder()
{
    ChainTabOrder({txPartDescription, txFileName,     txAuthorRealName, txAuthorUserName, cbPartTypes,
                   cbLicenses,        cbBFCStatement, cbCategory,       txOldHeader,      txNewHeader,
                   lsKeyWords,        cmdAdd,         cmdDelete,        cmdEdit,          cmdSetPreferences,
                   lsHistory,         cmdHistoryEdit, cmdHistoryDelete, cmdHistoryAdd,    lsComments,
                   cmdCommentsEdit,   cmdCommentsAdd, cmdCommentsDelete});
    for (QLabel* text : {Label1, lblLength, Label4, Label3, Label6, Label8, Label9, Label11, Label10, Label7, Label5,
                         lblStatuszeile, Label2[0], Label2[1], Label2[2], Label2[3]})
        text->setFocusPolicy(Qt::NoFocus);
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
    Line1->setGeometry(0, 0, ClientWidth, 1);
    Line2->setGeometry(0, 1, ClientWidth, 1);
    lblStatuszeile->setGeometry(0, ClientHeight - lblStatuszeile->height(), ClientWidth, lblStatuszeile->height());
    lblStatuszeile->setText("Welcome to Quillmark programm.");
    // The shell hands the arguments over already split: the first one is the path, blanks and all.
    // It is remembered in full, so that the recent files still find it from another folder.
    app_.PendingFile =
        arguments.isEmpty() ? std::string() : AbsolutePath(QFile::encodeName(arguments.first()).toStdString());
    show();
    if (!app_.PendingFile.empty())
        MDateiOeffnen_Click();
}

void frmMain::MInfo_Click()
{
    services_.dialogs.message(InformationBox("Quillmark Version: " + versionText() + "\r\n" + "Copyright " +
                                             QUILLMARK_COPYRIGHT_YEARS + " " + QUILLMARK_COPYRIGHT_HOLDER));
}
