// SPDX-License-Identifier: MIT
#include "SaveAs.h"

#include <QCoreApplication>
#include <sys/stat.h>
#include <system_error>

#include "Dialogs.h"
#include "OpenPart.h"
#include "Paths.h"
#include "SettingsStore.h"

namespace {

std::string translated(const char* text) { return QCoreApplication::translate("SaveAs", text).toStdString(); }

// The system's reason in the words of a sentence: "permission denied".
std::string reasonInWords(int errnoValue)
{
    auto reason = std::generic_category().message(errnoValue);
    if (!reason.empty() && reason[0] >= 'A' && reason[0] <= 'Z')
        reason[0] = static_cast<char>(reason[0] - 'A' + 'a');
    return reason;
}

bool somethingIsNamed(const std::string& path)
{
    struct stat info {};
    return ::lstat(path.c_str(), &info) == 0;
}

// The "Name:" line's file name, after its folder ("s\\3001s01.dat" names "3001s01.dat").
std::string nameLineFile(const std::string& partName) { return partName.substr(partName.rfind('\\') + 1); }

// Where the document is saved; put back when a Save As ends short of a save.
struct Place {
    std::string filePath, fileFolder, partName;
    std::shared_ptr<OpenPart> part;
    std::optional<FileStamp> readStamp;
};

Place placeOf(const HeaderData& header)
{
    return {header.FilePath, header.FileFolder, header.PartName, header.Part, header.ReadStamp};
}

void putBack(HeaderData& header, Place place)
{
    header.FilePath = std::move(place.filePath);
    header.FileFolder = std::move(place.fileFolder);
    header.PartName = std::move(place.partName);
    header.Part = std::move(place.part);
    header.ReadStamp = place.readStamp;
}

void offerNewName(HeaderData& header, const std::string& fileName, Dialogs& dialogs,
                  const std::function<void()>& recompose)
{
    const auto said = nameLineFile(header.PartName);
    if (said == fileName)
        return;
    const auto question = translated("The new file is named ") + fileName + translated(", and its Name: line says ") +
                          (said.empty() ? translated("nothing") : said) + translated(". Write ") + fileName +
                          translated(" into the Name: line?");
    if (dialogs.message(QuestionBox(question, translated("Save As"))) != Answer::Yes)
        return;
    header.PartName = header.PartName.substr(0, header.PartName.size() - said.size()) + fileName;
    recompose();
}

} // namespace

std::string WhyNotWritable(const HeaderData& header)
{
    if (!header.Part)
        return {};
    const int denial = header.Part->whyNotWritable();
    return denial == 0 ? std::string() : reasonInWords(denial);
}

UnwritableAnswer AskAboutUnwritablePart(const HeaderData& header, Dialogs& dialogs)
{
    const auto why = WhyNotWritable(header);
    if (why.empty())
        return UnwritableAnswer::Writable;
    const auto text = translated("Cannot save ") + header.FilePath + ": " + why + ".\r\n" +
                      translated("Save your changes in another file?");
    return dialogs.message({text, translated("Read-Only File"), Buttons::YesNo, Icon::Exclamation, Answer::Yes}) ==
                   Answer::Yes
               ? UnwritableAnswer::SaveAs
               : UnwritableAnswer::Stay;
}

std::optional<std::string> ChooseNewName(const HeaderData& header, Dialogs& dialogs)
{
    auto chosen = dialogs.openFile(
        {translated("Save DAT-File As"), translated("LDraw DAT-File (*.dat)"), "dat", header.FileFolder, true});
    if (chosen)
        *chosen = AbsolutePath(*chosen);
    return chosen;
}

SaveOutcome SaveUnderNewName(AppState& app, Services& services, const std::string& path,
                             const std::function<SaveOutcome()>& save, const std::function<void()>& recompose)
{
    auto& header = app.Header;
    if (somethingIsNamed(path) &&
        services.dialogs.message({path + translated(" already exists.\r\nDo you want to replace it?"),
                                  translated("Save As"), Buttons::YesNo, Icon::Exclamation, Answer::No}) != Answer::Yes)
        return SaveOutcome::Declined;
    auto before = placeOf(header);
    header.FilePath = path;
    header.FileFolder = DateiNurPfad(path);
    header.Part = nullptr; // the file at path, found when written; the part read stays as it is
    header.ReadStamp = std::nullopt;
    offerNewName(header, DateiNurName(path, services.dialogs), services.dialogs, recompose);
    const auto outcome = save();
    if (outcome != SaveOutcome::Saved) {
        const bool renamed = header.PartName != before.partName;
        putBack(header, std::move(before));
        if (renamed)
            recompose();
        return outcome;
    }
    StoreLastPath(services.store, header.FileFolder);
    PushRecentFile(services.store, path, app.Recent.MaxRecentFiles);
    ShowRecentFiles(app.Recent, services.store);
    return outcome;
}
