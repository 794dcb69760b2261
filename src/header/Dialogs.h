// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>

// Everything the program asks or tells the user goes through this seam, so that the logic
// never shows a window itself: the window implements it with Qt's dialogs, the command-line
// tool with its own rules, and tests with a scripted fake.

enum class Buttons { Ok, YesNo, YesNoCancel };
enum class Icon { None, Information, Question, Exclamation, Critical };
enum class Answer { Ok, Yes, No, Cancel };

inline constexpr const char* ProgramTitle = "Quillmark";

// Marks a text, or a line of one, that the window shows in the user's language: Qt's translation
// tools collect the texts so marked under their context ("Messages" for what goes through this
// seam), and the window looks each line up there. The programs keep the English text, which the
// command line shows as it is.
#define Translatable(context, text) text

struct MessageBox {
    std::string text;
    std::string title = ProgramTitle;
    Buttons buttons = Buttons::Ok;
    Icon icon = Icon::None;
    Answer defaultButton = Answer::Ok;
};

struct OpenFileRequest {
    std::string title;
    std::string filter;
    std::string defaultSuffix;
    std::string startFolder;
};

class Dialogs {
public:
    virtual ~Dialogs() = default;
    virtual Answer message(const MessageBox& box) = 0;
    // The typed text, or "" when the user cancelled.
    virtual std::string input(const std::string& prompt, const std::string& title, const std::string& defaultText) = 0;
    // The chosen path, or nullopt when the user cancelled.
    virtual std::optional<std::string> openFile(const OpenFileRequest& request) = 0;
};

// The common kinds of box.
MessageBox StopBox(std::string text);
MessageBox InformationBox(std::string text);
MessageBox QuestionBox(std::string text, std::string title);

// Answers every box with its default button and cancels every input and file dialog: for runs
// where nobody is there to ask, such as measuring and fuzzing.
class DefaultAnswers : public Dialogs {
public:
    Answer message(const MessageBox& box) override { return box.defaultButton; }
    std::string input(const std::string&, const std::string&, const std::string&) override { return {}; }
    std::optional<std::string> openFile(const OpenFileRequest&) override { return std::nullopt; }
};
