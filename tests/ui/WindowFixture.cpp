// SPDX-License-Identifier: MIT
#include "WindowFixture.h"

#include <QDropEvent>
#include <QLabel>
#include <QLineEdit>
#include <filesystem>

const std::string GoodPart = "0 Brick  2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                             "0 !LDRAW_ORG Part UPDATE 2004-01\r\n"
                             "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n\r\n"
                             "0 BFC CERTIFY CCW\r\n\r\n0 !CATEGORY Brick\r\n0 !KEYWORDS brick, stud\r\n\r\n"
                             "0 !HISTORY 2004-01-01 [ssample] made\r\n0 // a comment\r\n\r\n"
                             "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n";

WindowTest::WindowTest()
{
    for (const char* list : {"category.txt", "parttype.txt", "bfc.txt", "licenses.txt", "colourcodes.txt"})
        std::filesystem::copy_file(std::filesystem::path(QUILLMARK_PROGRAM_FOLDER) / list, programFolder.path() / list);
    app.ProgramFolder = programFolder.path().string();
}

WindowTest::~WindowTest()
{
    if (window) {
        app.Header.FileChanged = false; // no close question when the test is over
        window->close();
    }
    EXPECT_TRUE(dialogs.scriptUsedUp()) << "a scripted answer was not used";
}

void WindowTest::startUp(const QStringList& arguments)
{
    window = std::make_unique<frmMain>(app, services);
    window->StartUp(arguments);
    QApplication::processEvents(); // the file named by the arguments opens once the window shows
}

void WindowTest::openThroughPendingFile(const std::string& path)
{
    app.PendingFile = path;
    window->MDateiOeffnen_Click();
}

void WindowTest::atDesignAndLargeFont(const std::function<void(double points)>& check)
{
    const QFont designFont = QApplication::font();
    for (const double points : {8.0, 14.0}) {
        QFont font = designFont;
        font.setPointSizeF(points);
        QApplication::setFont(font);
        startUp();
        check(points);
    }
    QApplication::setFont(designFont);
}

void Drop(QWidget& target, QMimeData& data)
{
    QDragEnterEvent enter(QPoint(10, 10), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(&target, &enter);
    QDropEvent event(QPointF(10, 10), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(&target, &event);
}

QStringList RowsOf(const QListWidget& list)
{
    QStringList rows;
    for (int i = 0; i < list.count(); ++i)
        rows << list.item(i)->text();
    return rows;
}

std::string WindowTest::text(const char* name) const
{
    if (auto* box = window->findChild<QLineEdit*>(name))
        return box->text().toStdString();
    if (auto* label = window->findChild<QLabel*>(name))
        return label->text().toStdString();
    ADD_FAILURE() << "no text control " << name;
    return {};
}

void WindowTest::pollForDialog(std::function<bool(QWidget*)> act)
{
    auto* timer = new QTimer(window.get());
    timer->setInterval(10);
    QObject::connect(timer, &QTimer::timeout, timer, [timer, act] {
        if (auto* modal = QApplication::activeModalWidget(); modal && act(modal))
            timer->deleteLater();
    });
    timer->start();
}
