// SPDX-License-Identifier: MIT
#include "ConsoleDialogs.h"

#include "LineEnds.h"

ConsoleDialogs::ConsoleDialogs(std::ostream& err, Answerer answerer) : err_(err), answerer_(std::move(answerer)) {}

Answer ConsoleDialogs::message(const MessageBox& box)
{
    lastMessage_ = box.text;
    lastTitle_ = box.title;
    if (box.buttons != Buttons::Ok && answerer_)
        return answerer_(box);
    // A text that names the file itself is not prefixed with it a second time.
    const auto line = OneLine(box.text);
    err_ << (line.starts_with(currentFile_ + ": ") ? "" : currentFile_ + ": ") << line << '\n';
    return box.buttons == Buttons::Ok ? Answer::Ok : box.defaultButton;
}

std::string ConsoleDialogs::input(const std::string& /*prompt*/, const std::string& /*title*/,
                                  const std::string& /*defaultText*/)
{
    return {};
}

std::optional<std::string> ConsoleDialogs::openFile(const OpenFileRequest& /*request*/) { return std::nullopt; }

void ConsoleDialogs::setCurrentFile(const std::string& path) { currentFile_ = ShownText(path); }

std::string ShownText(std::string_view text)
{
    std::string shown;
    shown.reserve(text.size());
    for (const char c : text) {
        const auto code = static_cast<unsigned char>(c);
        if (code >= 0x20 && code != 0x7F)
            shown += c;
        else if (c == '\n' || c == '\r' || c == '\t')
            shown += c == '\n' ? "\\n" : c == '\r' ? "\\r" : "\\t";
        else {
            constexpr char Hex[] = "0123456789abcdef";
            shown += "\\x";
            shown += Hex[code >> 4];
            shown += Hex[code & 0xF];
        }
    }
    return shown;
}

std::string OneLine(const std::string& text) { return ShownText(ReplaceAll(text, "\r\n", "; ")); }
