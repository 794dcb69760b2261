// SPDX-License-Identifier: MIT
// The Qt side of the dialogs seam: each box shows the buttons, icon and default it was asked for,
// and the button the user presses comes back as the matching answer.
#include <QInputDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>

#include "QtDialogs.h"
#include "WindowFixture.h"

namespace {

struct BoxCase {
    Buttons buttons;
    Icon icon;
    Answer defaultButton;
    QMessageBox::StandardButtons shownButtons;
    QMessageBox::Icon shownIcon;
    QMessageBox::StandardButton shownDefault;
    QMessageBox::StandardButton pressed; // NoButton: the user presses Escape
    Answer answer;
};

TEST_F(WindowTest, QtMessageBoxesShowWhatWasAskedAndAnswerWhatWasPressed)
{
    startUp();
    QtDialogs qt(window.get());
    const BoxCase cases[] = {
        {Buttons::Ok, Icon::None, Answer::Ok, QMessageBox::Ok, QMessageBox::NoIcon, QMessageBox::Ok, QMessageBox::Ok,
         Answer::Ok},
        {Buttons::Ok, Icon::Information, Answer::Ok, QMessageBox::Ok, QMessageBox::Information, QMessageBox::Ok,
         QMessageBox::NoButton, Answer::Ok},
        {Buttons::YesNo, Icon::Exclamation, Answer::No, QMessageBox::Yes | QMessageBox::No, QMessageBox::Warning,
         QMessageBox::No, QMessageBox::Yes, Answer::Yes},
        {Buttons::YesNo, Icon::Question, Answer::Yes, QMessageBox::Yes | QMessageBox::No, QMessageBox::Question,
         QMessageBox::Yes, QMessageBox::NoButton, Answer::No},
        {Buttons::YesNoCancel, Icon::Critical, Answer::Cancel, QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel,
         QMessageBox::Critical, QMessageBox::Cancel, QMessageBox::No, Answer::No},
        {Buttons::YesNoCancel, Icon::Question, Answer::Yes, QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel,
         QMessageBox::Question, QMessageBox::Yes, QMessageBox::NoButton, Answer::Cancel},
    };
    for (const auto& c : cases) {
        whenDialogShows<QMessageBox>([&](QMessageBox& box) {
            EXPECT_EQ(box.text(), "Text");
            EXPECT_EQ(box.windowTitle(), "Title");
            EXPECT_EQ(box.standardButtons(), c.shownButtons);
            EXPECT_EQ(box.icon(), c.shownIcon);
            EXPECT_EQ(box.standardButton(box.defaultButton()), c.shownDefault);
            if (c.pressed == QMessageBox::NoButton)
                QTest::keyClick(&box, Qt::Key_Escape);
            else
                box.button(c.pressed)->click();
        });
        EXPECT_EQ(qt.message({"Text", "Title", c.buttons, c.icon, c.defaultButton}), c.answer);
    }
}

// A box stays over its window, also when the window manager places the window only after the box
// showed.
TEST_F(WindowTest, QtBoxesFollowTheirWindow)
{
    startUp();
    QtDialogs qt(window.get());
    whenDialogShows<QMessageBox>([this](QMessageBox& box) {
        window->move(window->pos() + QPoint(120, 80));
        EXPECT_LE((box.frameGeometry().center() - window->frameGeometry().center()).manhattanLength(), 8);
        box.accept();
    });
    qt.message(StopBox("Text"));
}

TEST_F(WindowTest, QtInputBoxGivesTheTypedTextOrNothingWhenCancelled)
{
    startUp();
    QtDialogs qt(window.get());
    for (const bool accept : {true, false}) {
        whenDialogShows<QInputDialog>([&](QInputDialog& box) {
            EXPECT_EQ(box.labelText(), "Prompt");
            EXPECT_EQ(box.textValue(), "default ");
            const auto* field = box.findChild<QLineEdit*>();
            EXPECT_EQ(field->selectedText(), "") << "typing adds to the text";
            EXPECT_EQ(field->cursorPosition(), 8);
            box.setTextValue("typed");
            accept ? box.accept() : box.reject();
        });
        EXPECT_EQ(qt.input("Prompt", "Title", "default "), accept ? "typed" : "");
    }
}

} // namespace
