// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <functional>
#include <nlohmann/json.hpp>
#include <string>
#include <sys/types.h>
#include <vector>

// A language client for tests: runs quillmark-cli lsp with pipes for its standard input and
// output, and talks the base protocol to it. Every wait has a watchdog: a server that does not
// answer in time fails the test and is killed.
class LspClient {
public:
    // environment: NAME=VALUE settings added to the server's.
    explicit LspClient(const std::vector<std::string>& environment = {});
    ~LspClient();
    LspClient(const LspClient&) = delete;
    LspClient& operator=(const LspClient&) = delete;

    void send(const nlohmann::json& message);
    void sendBytes(const std::string& bytes);
    void notify(const std::string& method, nlohmann::json params);
    // Sends a request and returns its id.
    int request(const std::string& method, nlohmann::json params);

    // The next message; a null json when the server closed its output.
    nlohmann::json next();
    // The next message that satisfies wanted; the others in between are dropped.
    nlohmann::json nextWhere(const std::function<bool(const nlohmann::json&)>& wanted);
    nlohmann::json responseTo(int id);
    // The next diagnostics published for uri.
    nlohmann::json diagnosticsOf(const std::string& uri);

    // initialize (with these client capabilities) and initialized; the server's capabilities.
    nlohmann::json initialize(nlohmann::json capabilities = nlohmann::json::object());
    void open(const std::string& uri, const std::string& text, int version = 1);

    void closeInput();
    // Waits for the server to end; its exit status, or -1 when a signal ended it.
    int exitStatus();

private:
    std::string readSome();

    pid_t server_ = -1;
    int toServer_ = -1, fromServer_ = -1;
    std::string buffer_;
    int nextId_ = 1;
    std::chrono::seconds patience_{60};
};

// A file: uri of an absolute path.
std::string UriOf(const std::string& path);

// A small unofficial part whose licence the Parts Tracker refuses: the tests' document.
inline const std::string SmallPart = "0 Brick  1 x  2\r\n"
                                     "0 Name: 3004.dat\r\n"
                                     "0 Author: Ann Example [ann]\r\n"
                                     "0 !LDRAW_ORG Unofficial_Part\r\n"
                                     "0 !LICENSE Redistributable under CCAL version 2.0 : see CAreadme.txt\r\n"
                                     "\r\n"
                                     "0 BFC CERTIFY CCW\r\n"
                                     "\r\n"
                                     "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n";
