// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <ostream>
#include <string>
#include <vector>

#include "FileRepairs.h"
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

// What a repair makes of one file: the edits of its bytes as read, what its log says, and why it is
// left as it is (empty: it is not).
struct FileEdits {
    std::vector<TextEdit> edits;
    std::vector<std::string> notes;
    std::string left;
};
using Repairer = std::function<FileEdits(std::string_view bytes, const HeaderData& read, const HeaderData& edited)>;

// fix as edits: each file's bytes with the edits repair gives (after the header edits asked for on
// the record), written through the same safe save as edit's, or shown as a diff (dry run) or as JSON.
int RunRepair(const std::vector<std::string>& arguments, const SaveOptions& options, const EditOptions& edit,
              const BatchOptions& batch, std::ostream& out, std::ostream& err, const Repairer& repair);
