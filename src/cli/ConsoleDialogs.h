#pragma once

#include <functional>
#include <ostream>
#include <string>

#include "Dialogs.h"

// The dialogs seam for the command line: every message becomes one line on the error stream,
// prefixed with the file at hand, and questions are answered by the command's own rule, never
// by reading standard input.
class ConsoleDialogs : public Dialogs {
public:
    using Answerer = std::function<Answer(const MessageBox&)>;

    explicit ConsoleDialogs(std::ostream& err, Answerer answerer = {});

    void setCurrentFile(const std::string& path) { currentFile_ = path; }
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

// A message on one line: its CR LF become "; ".
std::string OneLine(const std::string& text);
