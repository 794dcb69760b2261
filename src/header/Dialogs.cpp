// SPDX-License-Identifier: MIT
#include "Dialogs.h"

MessageBox StopBox(std::string text) { return {std::move(text), ProgramTitle, Buttons::Ok, Icon::None, Answer::Ok}; }

MessageBox InformationBox(std::string text)
{
    return {std::move(text), ProgramTitle, Buttons::Ok, Icon::Information, Answer::Ok};
}

MessageBox QuestionBox(std::string text, std::string title)
{
    return {std::move(text), std::move(title), Buttons::YesNo, Icon::Question, Answer::Yes};
}
