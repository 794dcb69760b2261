// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <ostream>
#include <string>
#include <string_view>

#include "Dialogs.h"

// The dialogs seam for the command line: every message becomes one line on the error stream,
// prefixed with the file at hand, and questions are answered by the command's own rule, never
// by reading standard input.
class ConsoleDialogs : public Dialogs {
public:
    using Answerer = std::function<Answer(const MessageBox&)>;

    explicit ConsoleDialogs(std::ostream& err, Answerer answerer = {});

    void setCurrentFile(const std::string& path);
    // The text of the last box shown, answered or not.
    const std::string& lastMessage() const { return lastMessage_; }
    const std::string& lastTitle() const { return lastTitle_; }

    Answer message(const MessageBox& box) override;
    std::string input(const std::string& prompt, const std::string& title, const std::string& defaultText) override;
    std::optional<std::string> openFile(const OpenFileRequest& request) override;

private:
    std::ostream& err_;
    Answerer answerer_;
    std::string currentFile_;
    std::string lastMessage_;
    std::string lastTitle_;
};

// Text as one line on the console, each control character shown as an escape: "\n", "\r", "\t",
// or "\x" and two hex digits. A file's name may hold any of them.
std::string ShownText(std::string_view text);

// A message on one line: its CR LF become "; ", any other control character an escape.
std::string OneLine(const std::string& text);
