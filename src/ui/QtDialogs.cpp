// SPDX-License-Identifier: MIT
#include "QtDialogs.h"

#include <QCoreApplication>
#include <QEvent>
#include <QFileDialog>
#include <QInputDialog>
#include <QLineEdit>
#include <QMessageBox>

namespace {

QString text(const std::string& utf8) { return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size())); }

// The text in the window's language, line by line: a message is often a sentence of its own
// followed by another ("... \r\nSaving the file is not possible"). Lines naming a file or a value
// stay as they are.
QString shown(const std::string& utf8)
{
    auto lines = text(utf8).split("\r\n");
    for (auto& line : lines)
        line = QCoreApplication::translate("Messages", line.toUtf8().constData());
    return lines.join("\r\n");
}

QMessageBox::StandardButton qtButton(Answer answer)
{
    switch (answer) {
    case Answer::Ok: return QMessageBox::Ok;
    case Answer::Yes: return QMessageBox::Yes;
    case Answer::No: return QMessageBox::No;
    case Answer::Cancel: return QMessageBox::Cancel;
    }
    return QMessageBox::Ok;
}

QMessageBox::StandardButtons qtButtons(Buttons buttons)
{
    switch (buttons) {
    case Buttons::Ok: return QMessageBox::Ok;
    case Buttons::YesNo: return QMessageBox::Yes | QMessageBox::No;
    case Buttons::YesNoCancel: return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    }
    return QMessageBox::Ok;
}

QMessageBox::Icon qtIcon(Icon icon)
{
    switch (icon) {
    case Icon::None: return QMessageBox::NoIcon;
    case Icon::Information: return QMessageBox::Information;
    case Icon::Question: return QMessageBox::Question;
    case Icon::Exclamation: return QMessageBox::Warning;
    case Icon::Critical: return QMessageBox::Critical;
    }
    return QMessageBox::NoIcon;
}

Answer answerOf(int button, Buttons buttons)
{
    switch (button) {
    case QMessageBox::Yes: return Answer::Yes;
    case QMessageBox::No: return Answer::No;
    case QMessageBox::Cancel: return Answer::Cancel;
    case QMessageBox::Ok: return Answer::Ok;
    default: return buttons == Buttons::YesNo ? Answer::No : buttons == Buttons::Ok ? Answer::Ok : Answer::Cancel;
    }
}

// Shows a dialog centred on the window it belongs to, wherever the window manager would put it:
// a box far from the window that caused it is easily missed. A window that the window manager
// places only after the box shows (at start-up) takes the box along. An input box shows its
// default text with the cursor at its end and nothing selected, so that typing adds to it.
class PlacedOnShow : public QObject {
public:
    PlacedOnShow(QDialog& dialog, QWidget* window) : QObject(&dialog), dialog_(dialog), window_(window)
    {
        dialog.installEventFilter(this);
        if (window != nullptr)
            window->installEventFilter(this);
    }
    ~PlacedOnShow() override
    {
        if (window_ != nullptr)
            window_->removeEventFilter(this);
    }
    PlacedOnShow(const PlacedOnShow&) = delete;
    PlacedOnShow& operator=(const PlacedOnShow&) = delete;

    bool eventFilter(QObject* watched, QEvent* event) override
    {
        const bool shown = watched == &dialog_ && event->type() == QEvent::Show;
        if (shown || (watched == window_ && event->type() == QEvent::Move && dialog_.isVisible()))
            centre();
        // The input box selects its text once it shows.
        if (auto* field = dialog_.findChild<QLineEdit*>(); shown && field != nullptr)
            QMetaObject::invokeMethod(
                field, [field] { field->end(false); }, Qt::QueuedConnection);
        return false;
    }

private:
    void centre()
    {
        if (window_ != nullptr)
            dialog_.move(window_->frameGeometry().center() - dialog_.rect().center());
    }

    QDialog& dialog_;
    QWidget* window_;
};

} // namespace

Answer QtDialogs::message(const MessageBox& box)
{
    QMessageBox dialog(qtIcon(box.icon), shown(box.title), shown(box.text), qtButtons(box.buttons), parent_);
    dialog.setDefaultButton(qtButton(box.defaultButton));
    new PlacedOnShow(dialog, parent_); // owned by the dialog
    return answerOf(dialog.exec(), box.buttons);
}

std::string QtDialogs::input(const std::string& prompt, const std::string& title, const std::string& defaultText)
{
    QInputDialog dialog(parent_);
    dialog.setWindowTitle(shown(title));
    dialog.setLabelText(shown(prompt));
    dialog.setTextValue(text(defaultText));
    new PlacedOnShow(dialog, parent_); // owned by the dialog
    return dialog.exec() == QDialog::Accepted ? dialog.textValue().toStdString() : std::string();
}

std::optional<std::string> QtDialogs::openFile(const OpenFileRequest& request)
{
    QFileDialog dialog(parent_, shown(request.title), text(request.startFolder), shown(request.filter));
    // Qt's own dialog works with every event loop and desktop.
    dialog.setOption(QFileDialog::DontUseNativeDialog);
    dialog.setFileMode(QFileDialog::ExistingFile);
    dialog.setAcceptMode(QFileDialog::AcceptOpen);
    dialog.setDefaultSuffix(text(request.defaultSuffix));
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    return QFile::encodeName(dialog.selectedFiles().first()).toStdString();
}
