// SPDX-License-Identifier: MIT
#pragma once

#include "Dialogs.h"

class QWidget;

// The dialogs seam with Qt's message boxes, input boxes and file dialog. Texts are UTF-8.
class QtDialogs : public Dialogs {
public:
    explicit QtDialogs(QWidget* parent = nullptr) : parent_(parent) {}
    void setParent(QWidget* parent) { parent_ = parent; }

    Answer message(const MessageBox& box) override;
    std::string input(const std::string& prompt, const std::string& title, const std::string& defaultText) override;
    std::optional<std::string> openFile(const OpenFileRequest& request) override;

private:
    QWidget* parent_;
};
