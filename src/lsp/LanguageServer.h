// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <functional>
#include <map>
#include <nlohmann/json.hpp>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "Completion.h"
#include "Documents.h"
#include "FileFindings.h"
#include "FileRepairs.h"

// What the server works with, given by the program that starts it.
struct ServerSetup {
    // The findings of check on a document's bytes, as if its path held them; throws when the
    // bytes cannot be read as a part (a binary text).
    std::function<std::vector<FileFinding>(const std::string& bytes, const std::string& path)> check;
    // fix's repairs (those named) of a document's bytes, as if its path held them; throws as check.
    std::function<FileRepairs(const std::string& bytes, const std::string& path, const std::set<std::string>& chosen)>
        repair;
    CompletionLists lists;                     // historyStart is filled by the next
    std::function<std::string()> historyStart; // "YYYY-MM-DD [user] " of today
    std::chrono::milliseconds pause{150};      // after a change, before its check starts
    std::string version;
};

// The result of one check of one version of a document.
struct CheckedVersion {
    std::string uri;
    long long version = 0;
    std::vector<FileFinding> findings;
    std::string failure; // why the text could not be checked; empty when it was
};

// The protocol's state and its answers: one message at a time, on one thread. What it sends goes
// through send; the checks it wants go to startCheck, whose results come back through checked.
class LanguageServer {
public:
    using Send = std::function<void(const nlohmann::json&)>;
    // Starts the check of the document's text as it stands now (text and path copied).
    using StartCheck = std::function<void(const Document&)>;
    using ForgetCheck = std::function<void(const std::string& uri)>;

    LanguageServer(const ServerSetup& setup, Send send, StartCheck startCheck, ForgetCheck forgetCheck);

    // One message's body as read.
    void received(const std::string& body);
    // A header that was not the base protocol's.
    void broken(const std::string& problem);
    void checked(CheckedVersion result);

    bool exited() const { return exited_; }
    // The exit status once exited or once the input ended: 0 only after shutdown.
    int exitStatus() const { return shutDown_ ? 0 : 1; }

private:
    struct Request {
        nlohmann::json id;
        std::string method;
        nlohmann::json params;
    };
    void notification(const std::string& method, const nlohmann::json& params);
    void request(const Request& request);
    std::optional<nlohmann::json> answer(const Request& request); // nullopt: it waits for a check
    void respond(const nlohmann::json& id, nlohmann::json result);
    void fail(const nlohmann::json& id, int code, const std::string& message);

    nlohmann::json initialize(const nlohmann::json& params);
    void opened(const nlohmann::json& params);
    void changed(const nlohmann::json& params);
    void closed(const nlohmann::json& params);
    nlohmann::json hover(const Document& document, TextPosition position) const;
    nlohmann::json completion(const Document& document, TextPosition position) const;
    nlohmann::json codeActions(const Document& document, const nlohmann::json& params) const;
    // The action that makes the repairs of the document; null when they change nothing.
    nlohmann::json repairAction(const Document& document, const std::set<std::string>& chosen, const char* kind,
                                const std::string& title) const;
    void cancel(const nlohmann::json& id);
    void publish(const Document& document);
    // The findings of the document as it stands; null until its check is done.
    const std::vector<FileFinding>* currentFindings(const Document& document) const;
    std::string lineText(const Document& document, std::size_t line) const;

    const ServerSetup& setup_;
    Send send_;
    StartCheck startCheck_;
    ForgetCheck forgetCheck_;
    PositionEncoding encoding_ = PositionEncoding::Utf16;
    bool initialized_ = false, shutDown_ = false, exited_ = false;
    Documents documents_;
    std::map<std::string, CheckedVersion> checked_;       // the last result of each open document
    std::map<std::string, std::vector<Request>> waiting_; // requests that want a document's findings
};
