// SPDX-License-Identifier: MIT
// Keys and first steps: Tab in reading order, characters typed with AltGr, the help window, the
// first start's order, the preferences' refusal of empty names, and the command line's options.
#include <QAction>
#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>
#include <QTextBrowser>
#include <sys/wait.h>

#include "SettingsStore.h"
#include "WindowFixture.h"
#include "frmHelp.h"
#include "frmOption.h"

namespace {

// The names of the controls that Tab reaches from the focus widget on, count of them.
QStringList tabWalk(int count)
{
    QStringList walked;
    for (int step = 0; step < count; ++step) {
        walked << QApplication::focusWidget()->objectName();
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    }
    return walked;
}

TEST_F(WindowTest, TabWalksTheMainWindowInReadingOrder)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    child<QWidget>("txPartDescription")->setFocus();
    const QStringList order = {"txPartDescription", "txAuthorRealName",  "txAuthorUserName", "cbPartTypes",
                               "cbLicenses",        "cmdSetPreferences", "cbBFCStatement",   "cbCategory",
                               "lsKeyWords",        "cmdEdit",           "cmdAdd",           "cmdDelete",
                               "lsComments",        "cmdCommentsEdit",   "cmdCommentsAdd",   "cmdCommentsDelete",
                               "lsHistory",         "cmdHistoryEdit",    "cmdHistoryAdd",    "cmdHistoryDelete",
                               "txNewHeader",       "txOldHeader",       "txPartDescription"};
    EXPECT_EQ(tabWalk(static_cast<int>(order.size())), order);
}

TEST_F(WindowTest, TabWalksThePreferencesInReadingOrderAndEmptyNamesAreRefused)
{
    store.write(DefaultGroup, "RealName", "Jane Doe");
    store.write(DefaultGroup, "UserName", "jdoe");
    startUp();
    whenDialogShows<frmOption>([](frmOption& dialog) {
        auto* realName = dialog.findChild<QLineEdit*>("txRealName");
        dialog.activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(&dialog));
        realName->setFocus();
        EXPECT_EQ(tabWalk(8), QStringList({"txRealName", "txUserName", "cbLicenses", "chkBackup", "chkDescriptionLimit",
                                           "cmdSave", "cmdCancel", "txRealName"}));
        realName->setText("  ");
        dialog.findChild<QPushButton*>("cmdSave")->click();
        EXPECT_TRUE(dialog.isVisible()) << "an empty real name is not saved";
        EXPECT_TRUE(dialog.findChild<QLabel*>("lblRefusal")->text().startsWith("Enter your real name"));
        realName->setText("Jane Roe");
        dialog.findChild<QLineEdit*>("txUserName")->clear();
        dialog.findChild<QPushButton*>("cmdSave")->click();
        EXPECT_TRUE(dialog.isVisible()) << "nor an empty user name";
        EXPECT_TRUE(dialog.findChild<QLabel*>("lblRefusal")->text().startsWith("Enter your username"));
        dialog.findChild<QPushButton*>("cmdCancel")->click();
    });
    window->MEinstellDefault_Click();
    EXPECT_EQ(store.read(DefaultGroup, "RealName", ""), "Jane Doe") << "Cancel keeps the old values";
    EXPECT_EQ(store.read(DefaultGroup, "UserName", ""), "jdoe");
}

// Where AltGr arrives as Ctrl+Alt, it types the characters an author's "[user]" needs.
TEST_F(WindowTest, CharactersTypedWithCtrlAltReachTheField)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    auto* userName = child<QLineEdit>("txAuthorUserName");
    userName->setFocus();
    userName->clear();
    QTest::keyClicks(userName, "[]@{}", Qt::ControlModifier | Qt::AltModifier);
    EXPECT_EQ(userName->text(), "[]@{}");
    EXPECT_EQ(app.Header.AuthorUserName, "[]@{}");
}

TEST_F(WindowTest, F1OpensTheHelpWithTheWindowsKeys)
{
    startUp();
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    QString shown;
    whenDialogShows<frmHelp>([&shown](frmHelp& help) {
        shown = help.findChild<QTextBrowser*>("txHelp")->toPlainText();
        help.accept();
    });
    QTest::keyClick(window.get(), Qt::Key_F1);
    EXPECT_TRUE(shown.startsWith("The window")) << shown.left(80).toStdString();
    for (const char* keys : {"Ctrl+Shift+S", "Ctrl+T", "Tab, Shift+Tab"})
        EXPECT_TRUE(shown.contains(keys)) << keys;
    EXPECT_FALSE(shown.contains("quillmark-cli check")) << "only the window's section";
}

// On a first start with a file named, the file is read and shown before the preferences are
// offered over it.
TEST_F(WindowTest, TheFirstStartShowsTheFileBeforeOfferingThePreferences)
{
    const auto path = part("3001.dat", GoodPart);
    window = std::make_unique<frmMain>(app, services);
    bool offered = false;
    whenDialogShows<frmOption>([&](frmOption& dialog) {
        offered = true;
        EXPECT_TRUE(app.Header.FileLoaded);
        EXPECT_FALSE(app.Header.Loading);
        EXPECT_NE(caption().find("[3001.dat]"), std::string::npos);
        EXPECT_EQ(text("txPartDescription"), "Brick  2 x 4");
        dialog.findChild<QPushButton*>("cmdCancel")->click();
    });
    window->StartUp({QString::fromStdString(path)}, true);
    ASSERT_TRUE(QTest::qWaitFor([&] { return offered; }, 5000));
}

int exitStatusOf(const std::string& command)
{
    const int status = std::system(command.c_str());
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

// Options are answered or refused before any window: an unknown one with exit status 2.
TEST(WindowProgram, AnswersHelpAndVersionAndRefusesAnUnknownOption)
{
    const std::string program = "timeout 60 " QUILLMARK_PROGRAM_FOLDER "/quillmark ";
    EXPECT_EQ(exitStatusOf(program + "--help >/dev/null"), 0);
    EXPECT_EQ(exitStatusOf(program + "--version >/dev/null"), 0);
    EXPECT_EQ(exitStatusOf(program + "--bogus 2>/dev/null"), 2);
    EXPECT_EQ(exitStatusOf(program + "/no/such.dat --bogus 2>/dev/null"), 2);
}

} // namespace
