#include "ConsoleDialogs.h"

#include "LineEnds.h"

ConsoleDialogs::ConsoleDialogs(std::ostream& err, Answerer answerer) : err_(err), answerer_(std::move(answerer)) {}

Answer ConsoleDialogs::message(const MessageBox& box)
{
    lastMessage_ = box.text;
    lastTitle_ = box.title;
    if (box.buttons != Buttons::Ok && answerer_)
        return answerer_(box);
    err_ << currentFile_ << ": " << OneLine(box.text) << '\n';
    return box.buttons == Buttons::Ok ? Answer::Ok : box.defaultButton;
}

std::string ConsoleDialogs::input(const std::string& /*prompt*/, const std::string& /*title*/,
                                  const std::string& /*defaultText*/)
{
    return {};
}

std::optional<std::string> ConsoleDialogs::openFile(const OpenFileRequest& /*request*/) { return std::nullopt; }

std::string OneLine(const std::string& text) { return ReplaceAll(text, "\r\n", "; "); }
