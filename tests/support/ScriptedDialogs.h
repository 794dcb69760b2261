// SPDX-License-Identifier: MIT
#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "Dialogs.h"

// A dialogs seam for tests: every box is recorded, and answered from a script given in advance.
// A box, input or file dialog that the script does not expect fails the test.
class ScriptedDialogs : public Dialogs {
public:
    void expectMessage(Answer answer) { answers_.push_back(answer); }
    void expectInput(std::string typed) { inputs_.push_back(std::move(typed)); }
    void expectOpenFile(std::optional<std::string> chosen) { files_.push_back(std::move(chosen)); }
    // The next message box throws instead of answering, as a failure inside a command would.
    void failNextMessage() { failNext_ = true; }

    Answer message(const MessageBox& box) override;
    std::string input(const std::string& prompt, const std::string& title, const std::string& defaultText) override;
    std::optional<std::string> openFile(const OpenFileRequest& request) override;

    struct Input {
        std::string prompt, title, defaultText;
    };
    std::vector<MessageBox> messages;
    std::vector<Input> inputsShown;
    std::vector<OpenFileRequest> fileDialogsShown;

    // True when every scripted answer was used.
    bool scriptUsedUp() const { return answers_.empty() && inputs_.empty() && files_.empty(); }

private:
    bool failNext_ = false;
    std::deque<Answer> answers_;
    std::deque<std::string> inputs_;
    std::deque<std::optional<std::string>> files_;
};
