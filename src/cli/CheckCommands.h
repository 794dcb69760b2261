// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <ostream>
#include <string>
#include <vector>

#include "FindingLines.h"
#include "HeaderEdits.h"
#include "PartSettings.h"

// How check and save work through many files.
struct BatchOptions {
    unsigned threads = 0;         // 0: one per core
    bool quiet = false;           // no summary at the end
    bool limitDescription = true; // the description's 64 characters
    bool errIsTerminal = false;   // a progress line is drawn on a terminal only
};

struct CheckOptions {
    OutputFormat format = OutputFormat::Text;
    bool tracker = false;         // the Parts Tracker's rules too
    CommandLineSettings settings; // each given one stands over the config file's
    std::string config;           // the config file of every part; empty: the nearest quillmark.toml
    bool isolated = false;        // no config file at all
};

// check: every save check on every file (folders searched for part files), without writing.
int RunCheck(const std::vector<std::string>& arguments, const CheckOptions& options, const BatchOptions& batch,
             std::ostream& out, std::ostream& err);

struct SaveOptions {
    bool backup = true;
    bool fix = false;
    bool allowMissingUserName = false;
};

// save: re-saves every file as "&Save" does, answering its questions by the options.
int RunSave(const std::vector<std::string>& arguments, const SaveOptions& options, const BatchOptions& batch,
            std::ostream& out, std::ostream& err);

struct EditOptions {
    HeaderEdits edits;
    bool dryRun = false; // a diff of what the save would write instead of the save
    bool json = false;   // one JSON object per file with its old and new header, nothing written
    // Runs on each record after the edits, before the save; each note it returns is told with the file.
    std::function<std::vector<std::string>(HeaderData&)> afterEdits;
};

// edit: save with the edits made to each record first. Values that must come from a standard
// list, or an added history line without a user, are refused before any file is read.
int RunEdit(const std::vector<std::string>& arguments, const SaveOptions& options, EditOptions edit,
            const BatchOptions& batch, std::ostream& out, std::ostream& err);
