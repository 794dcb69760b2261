// SPDX-License-Identifier: MIT
#include "RecentFiles.h"

#include "SettingsStore.h"

namespace {

std::string recentKey(int number)
{
    std::string key = "RecentFile";
    return key.append(std::to_string(number));
}

} // namespace

RecentFilesMenu::RecentFilesMenu()
{
    for (int i = 1; i <= 10; ++i)
        MRecentFile[static_cast<std::size_t>(i)].caption = recentKey(i);
}

void ShowRecentFiles(RecentFilesMenu& menu, const SettingsStore& store)
{
    if (store.read(RecentFilesGroup, recentKey(1), "").empty())
        return;
    const auto pairs = store.readGroup(RecentFilesGroup);
    for (std::size_t k = 0; k < pairs.size() && k + 1 < menu.MRecentFile.size(); ++k) {
        menu.MRecentFile[0].visible = true;
        menu.MRecentFile[k + 1] = {true, pairs[k].second};
    }
}

bool IsRecentFile(const RecentFilesMenu& menu, const std::string& path)
{
    for (int i = 1; i <= menu.MaxRecentFiles; ++i)
        if (menu.MRecentFile[static_cast<std::size_t>(i)].caption == path)
            return true;
    return false;
}

void PushRecentFile(SettingsStore& store, const std::string& path, int maxRecentFiles)
{
    for (int i = maxRecentFiles - 1; i >= 1; --i) {
        const auto value = store.read(RecentFilesGroup, recentKey(i), "");
        if (!value.empty())
            store.write(RecentFilesGroup, recentKey(i + 1), value);
    }
    store.write(RecentFilesGroup, recentKey(1), path);
}

void AddRecentFile(RecentFilesMenu& menu, SettingsStore& store, const std::string& path)
{
    if (path.empty())
        return;
    if (!IsRecentFile(menu, path))
        PushRecentFile(store, path, menu.MaxRecentFiles);
    ShowRecentFiles(menu, store);
}
