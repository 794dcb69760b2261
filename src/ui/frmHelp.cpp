// SPDX-License-Identifier: MIT
#include "frmHelp.h"

#include <QFile>
#include <QPushButton>
#include <QTextBrowser>
#include <QVBoxLayout>

#include "TwipLayout.h"

frmHelp::frmHelp(QWidget* parent) : QDialog(parent)
{
    setObjectName("frmHelp");
    setWindowTitle(tr("Quillmark Help"));
    const double scale = LayoutScale(font());
    resize(Pixels(9240, scale), Pixels(8550, scale));
    txHelp = new QTextBrowser(this);
    txHelp->setObjectName("txHelp");
    txHelp->setOpenLinks(false); // the README's links lead to files beside it, not part of the help
    QFile readme(":/README.md");
    if (readme.open(QIODevice::ReadOnly))
        txHelp->setMarkdown(windowSection(QString::fromUtf8(readme.readAll())));
    auto* close = new QPushButton(tr("C&lose"), this);
    close->setObjectName("cmdClose");
    close->setDefault(true);
    connect(close, &QPushButton::clicked, this, &QDialog::accept);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(txHelp, 1);
    layout->addWidget(close, 0, Qt::AlignRight);
}

QString frmHelp::windowSection(const QString& markdown)
{
    const auto start = markdown.indexOf("\n## The window\n");
    if (start < 0)
        return {};
    const auto end = markdown.indexOf("\n## ", start + 1);
    return markdown.mid(start + 1, end < 0 ? -1 : end - start - 1);
}
