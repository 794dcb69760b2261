// SPDX-License-Identifier: MIT
#include "ScriptedDialogs.h"

#include <gtest/gtest.h>
#include <stdexcept>

Answer ScriptedDialogs::message(const MessageBox& box)
{
    messages.push_back(box);
    if (failNext_) {
        failNext_ = false;
        throw std::runtime_error("scripted failure");
    }
    if (answers_.empty()) {
        ADD_FAILURE() << "unexpected message box: " << box.title << ": " << box.text;
        return box.buttons == Buttons::Ok ? Answer::Ok : Answer::Cancel;
    }
    const auto answer = answers_.front();
    answers_.pop_front();
    return answer;
}

std::string ScriptedDialogs::input(const std::string& prompt, const std::string& title, const std::string& defaultText)
{
    inputsShown.push_back({prompt, title, defaultText});
    if (inputs_.empty()) {
        ADD_FAILURE() << "unexpected input box: " << title << ": " << prompt;
        return {};
    }
    auto typed = std::move(inputs_.front());
    inputs_.pop_front();
    return typed;
}

std::optional<std::string> ScriptedDialogs::openFile(const OpenFileRequest& request)
{
    fileDialogsShown.push_back(request);
    if (files_.empty()) {
        ADD_FAILURE() << "unexpected file dialog: " << request.title;
        return std::nullopt;
    }
    auto chosen = std::move(files_.front());
    files_.pop_front();
    return chosen;
}
