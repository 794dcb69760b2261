// SPDX-License-Identifier: MIT
#include "OpenRoad.h"

#include "FileSave.h"
#include "OpenDocument.h"
#include "Parser.h"
#include "SettingsStore.h"

void StartUpState(AppState& app, Services& services)
{
    // An author who turned backups off gets none from the first save on.
    app.Prefs.MakeBackup = StoredBackupChoice(services.store);
    app.Prefs.LimitDescription = StoredDescriptionLimit(services.store);
    app.Header.FileLoaded = false;
    app.Header.FileChanged = false;
    app.Header.FileFolder =
        StartFolder(services.store, app.FirstOpenFolder.empty() ? app.ProgramFolder : app.FirstOpenFolder);
    app.Recent.MaxRecentFiles = 9;
    ShowRecentFiles(app.Recent, services.store);
    LoadStandardLists(app.Lists, app.ProgramFolder, services.dialogs);
}

bool LadeDATDateiCommandLine(AppState& app, const std::string& path, OpenRoad road, Services& services,
                             ParseProgress& progress)
{
    HeaderData opened;
    TakeFileToOpen(opened, path, services.dialogs);
    // A save killed while it rewrote the file is undone before the file is read.
    const auto restore = [&services](const OpenPart& part) { RestoreInterruptedSaveOf(part, services.dialogs); };
    if (!GetGlobalContent(opened, services.dialogs, progress, restore))
        return false;
    opened.Loading = true;
    app.Header = std::move(opened);
    LoadStandardLists(app.Lists, app.ProgramFolder, services.dialogs);
    LadeDefaults(app.Prefs, services.store);
    if (road == OpenRoad::Chosen)
        StoreLastPath(services.store, app.Header.FileFolder);
    AddRecentFile(app.Recent, services.store, app.Header.FilePath);
    return true;
}

std::string CaptionFor(const std::string& baseTitle, const std::string& partName)
{
    return baseTitle + " [" + partName + "]";
}
