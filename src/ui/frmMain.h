// SPDX-License-Identifier: MIT
#pragma once

#include <QMainWindow>
#include <array>
#include <functional>
#include <memory>
#include <set>
#include <utility>

#include "AppState.h"
#include "ErrorReport.h"
#include "OpenRoad.h"
#include "SaveChecks.h"
#include "SaveStops.h"

class QAction;
class QFileSystemWatcher;
class QComboBox;
class QFrame;
class QLabel;
class QLineEdit;
class QListWidget;
class QMenu;
class QPlainTextEdit;
class QPushButton;
class QScrollArea;
class WindowProgress;

// The main window: every field of the header in its own control, the new header beside the old
// one, the three line lists, the status line and the menus. Controls carry their names as
// objectName; members of a control array are named with their index ("Label2_0", "MRecentFile_3").
class frmMain : public QMainWindow {
    Q_OBJECT

public:
    frmMain(AppState& app, Services& services, QWidget* parent = nullptr);
    ~frmMain() override;

    // Start-up from the window's side: lists, recent files, caption, greeting, and the file named
    // by the first argument, which is opened once the window shows; then, with offerPreferences,
    // the preferences while they hold no name.
    void StartUp(const QStringList& arguments, bool offerPreferences = false);

    void MDateiOeffnen_Click();
    void MDateiSpeichern_Click();
    void MDateiSpeichernUnter_Click();
    void MDateiBeenden_Click() { close(); }
    void MTrackerCheck_Click();
    void OpenFile(const std::string& path);
    void MInfo_Click();
    void MHilfeInhalt_Click();
    void MRecentFile_Click(int index);
    void MEditCategory_Click();
    void MEditPartTyps_Click();
    void MEditBFCStatement_Click();
    void MEditLicense_Click();
    void MEinstellDefault_Click();
    // While the preferences hold no real name and no user name: the preferences window, saying
    // what the names are for. Run once the window shows and the file named at start is open.
    void OfferPreferencesWithoutNames();
    void cmdSetPreferences_Click();

    // Recomposes the new header from the record, refreshes the length display, marks the change.
    void MakeNewHeader();
    void EnableControls();

    // The composed header exactly as saving writes it (the widget shows it with its own line ends).
    const std::string& newHeaderText() const { return newHeaderText_; }
    bool openInProgress() const { return app_.Header.Loading; }

protected:
    void closeEvent(QCloseEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dropEvent(QDropEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    void changeEvent(QEvent* event) override;
    void moveEvent(QMoveEvent* event) override;

private:
    // Building the window.
    void createControls();
    void createMenus();
    void addRecentFileItems(QMenu& menu);
    void openFileMenuWithAltF();
    void setTabOrder();
    void connectHandlers();
    void layOut();
    void placeControls();
    void fitOnScreen();

    // Opening.
    // The question before another file replaces this one; true when the open may go on.
    bool mayReplaceDocument();
    // Opens path; a failure is reported for procedure, and a close requested meanwhile is carried
    // out at the end.
    void openChosenFile(const std::string& path, OpenRoad road, const Procedure& procedure);
    void readChosenFile(const std::string& path, OpenRoad road);
    void clearWindow();
    void fillComboBoxes();
    void fillCombo(QComboBox& combo, ListKind kind);
    void abandonOpen(const std::exception& error, const Procedure& procedure);
    void fillWindowFromRecord();
    void showTextsFromTheirStart();
    void SelectComboItem(QComboBox& combo, const std::string& text);
    void showCaption();
    void showReadOnly(); // the status line says why a part read cannot be written
    void showModified(); // the caption's mark for unsaved changes
    void showRecentFiles();
    void finishCloseRequestedDuringOpen();

    // Saving.
    SaveResult checkHeaderAndSave();
    void saveUnderNewName();
    // After a save: the file read again as it now stands on disk, and the status line's word.
    void showSaved(const std::string& backupPath);

    // Another program's changes to the open part.
    void watchPart();
    void partChangedOnDisk();
    void showDescriptionTooLong();

    // Field editing.
    void updateTextField(QLineEdit& box, std::string& field);
    void updateComboField(QComboBox& combo, std::string& field);
    void moveFocusOnEnter(QObject* watched);
    bool typedIntoBox(QObject* watched, QEvent* event);
    void showLength();

    // The Parts Tracker's repairs on the open document.
    std::vector<StopRow> fixForTracker(const std::set<std::string>& ids, const StringList& categories,
                                       const ColourCodes& colours);
    void showFixedFields();

    // Line lists.
    void FillKeywordList();
    void FillCommentList();
    void FillHistoryList();
    // The input box of a list's Add and Edit; history lines are held to the Parts Tracker's form.
    struct LineForm {
        const char* prompt;
        const char* title;
        bool history = false;
    };
    std::string askForLine(const LineForm& form, const std::string& defaultText);
    void addLine(EntryList& list, const LineForm& form, const std::string& defaultText);
    void fillLineList(QListWidget& box, const EntryList& list);
    void editLine(EntryList& list, QListWidget& box, const LineForm& form);
    void deleteLine(EntryList& list, QListWidget& box);
    void refillLists();

    // What stops a save and what the Parts Tracker would say of the file as it would be saved.
    std::vector<StopRow> stopRows(const StringList& categories, const ColourCodes& colours);
    // The same with the program's colour list; report tells what could not be read.
    std::vector<StopRow> stopRows(const std::function<void(const std::string&)>& report);
    QWidget* fieldOf(const TrackerFinding& finding) const;
    bool focusFieldOf(const TrackerFinding& finding);
    QString trackerSummary();

    void showPreferences(bool explainNames);
    void editStandardList(ListKind kind, QComboBox& combo, const char* handler);
    std::optional<std::string> toFile(const std::string& utf8);

    AppState& app_;
    Services& services_;
    std::function<void(double scale)> layOutControls_; // places the controls for a font
    double scale_ = 1;                                 // the layout's growth with the window font
    QSize fitFrame_{0, 0};                             // the window manager's frame as fitOnScreen knew it
    std::string baseTitle_;
    std::string newHeaderText_;
    bool closeRequestedDuringOpen_ = false;
    QFileSystemWatcher* watcher_;    // the part and its folder, for another program's changes
    std::string diskMarkAskedAbout_; // the part on disk as it was when the user chose to keep editing
    std::set<std::pair<const QObject*, int>> keysPressedInBox_; // (box, key) pressed and not yet released

    // The controls, by the names the program has always used.
    QLabel* Label1;
    QLineEdit* txPartDescription;
    QLabel* lblLength;
    QLabel* Label2_0;
    QLabel* Label2_1;
    QLabel* Label2_2;
    QLabel* Label2_3;
    QLineEdit* txFileName;
    QLabel* Label4;
    QLineEdit* txAuthorRealName;
    QLabel* Label3;
    QLineEdit* txAuthorUserName;
    QComboBox* cbPartTypes;
    QComboBox* cbLicenses;
    QPushButton* cmdSetPreferences;
    QLabel* Label6;
    QComboBox* cbBFCStatement;
    QLabel* Label8;
    QComboBox* cbCategory;
    QLabel* Label9;
    QListWidget* lsKeyWords;
    QPushButton* cmdEdit;
    QPushButton* cmdAdd;
    QPushButton* cmdDelete;
    QLabel* Label11;
    QListWidget* lsComments;
    QLabel* Label10;
    QListWidget* lsHistory;
    QPushButton* cmdHistoryEdit;
    QPushButton* cmdHistoryAdd;
    QPushButton* cmdHistoryDelete;
    QPushButton* cmdCommentsEdit;
    QPushButton* cmdCommentsAdd;
    QPushButton* cmdCommentsDelete;
    QLabel* Label7;
    QPlainTextEdit* txNewHeader;
    QLabel* Label5;
    QPlainTextEdit* txOldHeader;
    QLabel* lblStatuszeile;
    QFrame* Line1;
    QFrame* Line2;
    QWidget* client_;       // every control above lies on it
    QScrollArea* scroller_; // around the client, scrolling only in a window smaller than its design

    QAction* MDateiOeffnen;
    QAction* MDateiSpeichern;
    QAction* MDateiSpeichernUnter;
    QAction* MTrackerCheck;
    QAction* MDateiBeenden;
    std::array<QAction*, 11> MRecentFile;
    QAction* MEditCategory;
    QAction* MEditPartTyps;
    QAction* MEditBFCStatement;
    QAction* MEditLicense;
    QAction* MEinstellDefault;
    QAction* MHilfeInhalt;
    QAction* MInfo;

    std::unique_ptr<WindowProgress> progress_;
};
