// SPDX-License-Identifier: MIT
// quillmark(1) tells every keyboard shortcut of the window and every option of its --help.
#include <QAction>
#include <QFile>
#include <QProcess>

#include "WindowFixture.h"

namespace {

QString section(const QString& page, const QString& title)
{
    const auto start = page.indexOf("\n.SH " + title + "\n");
    if (start < 0)
        return {};
    const auto end = page.indexOf("\n.SH ", start + 1);
    return page.mid(start, end < 0 ? -1 : end - start);
}

QString manualPage()
{
    QFile file(QUILLMARK_WINDOW_MAN_PAGE);
    EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << QUILLMARK_WINDOW_MAN_PAGE;
    return QString::fromUtf8(file.readAll());
}

TEST_F(WindowTest, TheManualPageListsEveryShortcutOfTheWindow)
{
    startUp();
    const auto shortcuts = section(manualPage(), "KEYBOARD SHORTCUTS");
    ASSERT_FALSE(shortcuts.isEmpty());
    int seen = 0;
    for (const auto* action : window->findChildren<QAction*>())
        for (const auto& keys : action->shortcuts()) {
            const auto written = keys.toString(QKeySequence::PortableText);
            EXPECT_TRUE(shortcuts.contains(
                QRegularExpression("\n\\.BR? (.*, )?" + QRegularExpression::escape(written) + "( |\n|\"|,)")))
                << action->objectName().toStdString() << " " << written.toStdString();
            ++seen;
        }
    EXPECT_GE(seen, 6);
}

TEST(WindowManualPage, DescribesEveryOptionOfTheHelp)
{
    QProcess program;
    program.start(QUILLMARK_PROGRAM_FOLDER "/quillmark", {"--help"});
    ASSERT_TRUE(program.waitForFinished(30000));
    const auto help = QString::fromUtf8(program.readAllStandardOutput());
    const auto options = section(manualPage(), "OPTIONS");
    const QRegularExpression option("^  (--[a-z-]+)", QRegularExpression::MultilineOption);
    int seen = 0;
    for (auto found = option.globalMatch(help); found.hasNext(); ++seen) {
        const auto roff = found.next().captured(1).replace("-", "\\-");
        EXPECT_TRUE(options.contains(roff)) << roff.toStdString();
    }
    EXPECT_GE(seen, 2);
}

} // namespace
