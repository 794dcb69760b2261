// SPDX-License-Identifier: MIT
#pragma once

#include <QApplication>
#include <QListWidget>
#include <QTimer>
#include <QWindow>
#include <functional>
#include <gtest/gtest.h>
#include <memory>

#include "AppState.h"
#include "FixedClock.h"
#include "IniSettingsStore.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"
#include "frmMain.h"

// The real main window over a program folder with the default list files, a settings file and
// part files of its own, talking to the user through scripted dialogs.
class WindowTest : public ::testing::Test {
protected:
    WindowTest();
    ~WindowTest() override;

    void startUp(const QStringList& arguments = {});
    // Writes a part file into the work folder and returns its path.
    std::string part(const std::string& name, const std::string& bytes) const { return work.write(name, bytes); }
    void openThroughPendingFile(const std::string& path);
    // Starts the window with the design's 8 pt font and again with 14 pt, and runs check on each.
    void atDesignAndLargeFont(const std::function<void(double points)>& check);

    template <typename T>
    T* child(const char* name) const
    {
        auto* found = window->findChild<T*>(name);
        EXPECT_NE(found, nullptr) << name;
        return found;
    }
    // The caption as the window system shows it, with "*" while the file has unsaved changes.
    std::string caption() const { return window->windowHandle()->title().toStdString(); }
    std::string text(const char* name) const;
    // Runs act on the next modal dialog of type T once it shows, while the caller's exec() waits.
    template <typename T>
    void whenDialogShows(std::function<void(T&)> act)
    {
        pollForDialog([act](QWidget* modal) {
            auto* dialog = qobject_cast<T*>(modal);
            if (dialog == nullptr)
                return false;
            act(*dialog);
            return true;
        });
    }

    TempDir programFolder;
    TempDir work;
    IniSettingsStore store{work.file("Quillmark.ini")};
    ScriptedDialogs dialogs;
    FixedClock clock;
    Services services{store, dialogs, clock};
    AppState app;
    std::unique_ptr<frmMain> window;

private:
    void pollForDialog(std::function<bool(QWidget*)> act);
};

// A drag that enters target and is dropped there, as the window system delivers it.
void Drop(QWidget& target, QMimeData& data);

// The texts of a list's rows, top to bottom.
QStringList RowsOf(const QListWidget& list);

// A small, complete part file.
extern const std::string GoodPart;
