// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>

class QTextBrowser;

// Help › Contents: the README's section about the window, with the table of keys.
class frmHelp : public QDialog {
    Q_OBJECT

public:
    explicit frmHelp(QWidget* parent = nullptr);

    // The section of the Markdown text that starts at its "## The window" heading, up to the next
    // section of that level.
    static QString windowSection(const QString& markdown);

private:
    QTextBrowser* txHelp;
};
