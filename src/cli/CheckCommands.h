#pragma once

#include <ostream>
#include <string>
#include <vector>

class ConsoleDialogs;

// check: every save check on every file, without writing anything.
int RunCheck(const std::vector<std::string>& paths, bool json, ConsoleDialogs& dialogs, std::ostream& out,
             std::ostream& err);

struct SaveOptions {
    bool backup = true;
    bool fix = false;
    bool allowMissingUserName = false;
};

// save: re-saves every file as "&Save" does, answering its questions by the options.
int RunSave(const std::vector<std::string>& paths, const SaveOptions& options, std::ostream& out, std::ostream& err);
