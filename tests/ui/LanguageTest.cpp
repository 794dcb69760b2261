// SPDX-License-Identifier: MIT
// The window speaks the user's language where a translation is installed, English when
// QUILLMARK_LANGUAGE=en says so; the messages of the core reach the user translated too.
#include <QAbstractButton>
#include <QMenuBar>
#include <QMessageBox>
#include <QTranslator>

#include "QtDialogs.h"
#include "SaveChecks.h"
#include "WindowFixture.h"
#include "WindowLanguage.h"

namespace {

class LanguageTest : public WindowTest {
protected:
    LanguageTest() { qunsetenv("QUILLMARK_LANGUAGE"); }
    ~LanguageTest() override
    {
        qunsetenv("QUILLMARK_LANGUAGE");
        for (auto* translator : QCoreApplication::instance()->findChildren<QTranslator*>()) {
            QCoreApplication::removeTranslator(translator);
            delete translator;
        }
    }

    QStringList menuTitles() const
    {
        QStringList titles;
        for (const auto* action : window->menuBar()->actions())
            titles << action->text();
        return titles;
    }

    const QLocale german{QLocale::German, QLocale::Germany};
};

TEST_F(LanguageTest, AGermanDesktopGetsTheGermanWindow)
{
    const auto locale = WindowLocale(german);
    EXPECT_EQ(locale.language(), QLocale::German);
    ASSERT_TRUE(InstallWindowTranslation(locale, QUILLMARK_PROGRAM_FOLDER));
    startUp();
    EXPECT_EQ(menuTitles(), QStringList({"&Datei", "&Bearbeiten", "&Optionen", "&Hilfe"}));
    EXPECT_EQ(text("Label1"), "Teilbeschreibung:");
    EXPECT_EQ(text("Label2_3"), "Lizenz:");
    EXPECT_EQ(text("lblStatuszeile"), "Willkommen bei Quillmark.");
}

TEST_F(LanguageTest, QuillmarkLanguageEnForcesEnglishOnAGermanDesktop)
{
    qputenv("QUILLMARK_LANGUAGE", "en");
    const auto locale = WindowLocale(german);
    EXPECT_EQ(locale.language(), QLocale::English);
    EXPECT_FALSE(InstallWindowTranslation(locale, QUILLMARK_PROGRAM_FOLDER));
    startUp();
    EXPECT_EQ(menuTitles(), QStringList({"F&ile", "&Edit", "&Option", "&Help"}));
}

// A refusal is the core's sentence and the core's "not possible" line, each translated.
TEST_F(LanguageTest, TheCoresMessagesShowInGermanLineByLine)
{
    ASSERT_TRUE(InstallWindowTranslation(german, QUILLMARK_PROGRAM_FOLDER));
    startUp();
    QtDialogs qt(window.get());
    whenDialogShows<QMessageBox>([](QMessageBox& box) {
        EXPECT_EQ(box.text(), "Bitte den Autor angeben!\r\nDie Datei kann nicht gespeichert werden");
        EXPECT_EQ(box.windowTitle(), "Benutzername fehlt");
        box.button(QMessageBox::Ok)->click();
    });
    qt.message({RefusalText("You need to mention the Author!"), MissingUserNameTitle, Buttons::Ok, Icon::Critical,
                Answer::Ok});
}

} // namespace
