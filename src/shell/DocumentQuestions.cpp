// SPDX-License-Identifier: MIT
#include "DocumentQuestions.h"

#include <algorithm>

#include "Dialogs.h"
#include "FileSave.h"
#include "Preferences.h"

bool MayCloseWindow(AppState& app, Services& services, const std::string& newHeader)
{
    if (!app.Header.FileChanged)
        return true;
    const auto answer = services.dialogs.message(
        {Translatable("Messages", "Do you want to save the changes to the file?"),
         Translatable("Messages", "File Changed"), Buttons::YesNoCancel, Icon::Question, Answer::Yes});
    if (answer != Answer::Yes)
        return answer == Answer::No;
    return FileSave(app.Header, newHeader, app.Prefs.MakeBackup, services.clock, services.dialogs).saved;
}

bool MayOpenAnotherFile(const AppState& app, Dialogs& dialogs, const std::function<bool()>& saveWithChecks)
{
    if (!app.Header.FileChanged)
        return true;
    const auto answer = dialogs.message(
        {Translatable("Messages", "The current file has been changed. Do you want to save the changes?"),
         Translatable("Messages", "Current File has changed"), Buttons::YesNoCancel, Icon::Question, Answer::Yes});
    if (answer != Answer::Yes)
        return answer == Answer::No;
    return saveWithChecks(); // a refused save keeps the edits and the file
}

bool MayEditList(ListKind kind, Dialogs& dialogs)
{
    if (kind != ListKind::Category)
        return true;
    return dialogs.message(
               {Translatable("Messages",
                             "To change the category can result in an non LDraw conform part. Please "
                             "change the category only if there is an official "
                             "statement from LSC.") "\r\n" Translatable("Messages", "Do you want to proceed?"),
                Translatable("Messages", "Category Change"), Buttons::YesNo, Icon::Exclamation, Answer::No}) ==
           Answer::Yes;
}

bool TakePreferencesIntoRecord(AppState& app, Services& services, const ToFileText& toFile)
{
    if (PreferencesHoldNoName(services.store)) {
        services.dialogs.message(
            InformationBox(Translatable("Messages", "Your preferences hold no name yet, so the names in this "
                                                    "file stay as they are. Enter yours in Option › "
                                                    "Preferences.")));
        return false;
    }
    const auto answer = services.dialogs.message(QuestionBox(
        Translatable("Messages", "Are you sure to substitute the existing Real Name, Username and License Type with "
                                 "your values set in the preferences?"),
        Translatable("Messages", "Default Values")));
    if (answer != Answer::Yes)
        return false;
    LadeDefaults(app.Prefs, services.store);
    auto& h = app.Header;
    for (const auto& [value, field] : {std::pair{&app.Prefs.DefaultRealName, &h.AuthorRealName},
                                       std::pair{&app.Prefs.DefaultUserName, &h.AuthorUserName}})
        if (!value->empty()) // a name the preferences lack never empties the file's
            if (const auto bytes = toFile(*value))
                *field = *bytes;
    const auto& licenses = app.Lists.Licenses;
    if (const auto license = toFile(app.Prefs.DefaultLicense);
        license && std::find(licenses.begin(), licenses.end(), *license) != licenses.end())
        h.License = *license;
    return true;
}
