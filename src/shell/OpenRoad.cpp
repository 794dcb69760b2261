#include "OpenRoad.h"

#include "OpenDocument.h"
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

void BeginOpen(AppState& app, Services& services)
{
    app.Header.Loading = true;
    ResetHeaderRecord(app.Header);
    LoadStandardLists(app.Lists, app.ProgramFolder, services.dialogs);
    LadeDefaults(app.Prefs, services.store);
}

void LadeDATDateiCommandLine(AppState& app, const std::string& path, Services& services)
{
    TakeFileToOpen(app.Header, path, services.dialogs);
    StoreLastPath(services.store, app.Header.FileFolder);
}

void TakeRecentFile(AppState& app, const std::string& path, Services& services)
{
    TakeFileToOpen(app.Header, path, services.dialogs);
}

std::string CaptionFor(const std::string& baseTitle, const std::string& partName)
{
    return baseTitle + " [" + partName + "]";
}
