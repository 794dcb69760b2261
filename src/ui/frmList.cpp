// SPDX-License-Identifier: MIT
#include "frmList.h"

#include <QGroupBox>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QResizeEvent>

#include "FileText.h"
#include "TwipLayout.h"

frmList::frmList(ListKind kind, const StringList& entries, const std::string& programFolder, Dialogs& dialogs,
                 QWidget* parent)
    : QDialog(parent), editor_(kind, entries, programFolder, dialogs)
{
    setObjectName("frmList");
    setWindowTitle(tr("List") + tr(InfoOf(kind).captionSuffix));
    setModal(true);
    const double scale = LayoutScale(font());
    setMinimumSize(Pixels(6645, scale), Pixels(4155, scale));
    resize(minimumSize());
    using Row = ControlRow<frmList, QGroupBox, QListWidget, QPushButton, QLineEdit>;
    static const Row rows[] = {
        {&frmList::Frame1, "Frame1", QT_TR_NOOP("Current Values"), 120, 840, 4935, 3255},
        {&frmList::lsValues, "lsValues", nullptr, 120, 240, 4695, 2790}, // inside Frame1
        {&frmList::cmdChange, "cmdChange", QT_TR_NOOP("Update"), 5160, 480, 1335, 375},
        {&frmList::cmdAdd, "cmdAdd", QT_TR_NOOP("Add"), 5160, 1200, 1335, 375},
        {&frmList::cmdClose, "cmdClose", QT_TR_NOOP("Close"), 5160, 2160, 1335, 375},
        {&frmList::txUpdate, "txUpdate", nullptr, 240, 480, 4695, 285},
        {&frmList::cmdDelete, "cmdDelete", QT_TR_NOOP("Delete"), 5160, 1680, 1335, 375},
    };
    BuildControls(*this, this, rows);
    lsValues->setParent(Frame1); // its place is inside the frame
    cmdClose->setDefault(true);
    ChainTabOrder({Frame1, lsValues, cmdChange, cmdAdd, cmdClose, txUpdate, cmdDelete});

    // Choosing an entry, by mouse or keyboard, copies its text into txUpdate.
    connect(lsValues, &QListWidget::itemSelectionChanged, this, [this] {
        const auto chosen = lsValues->selectedItems();
        editor_.select(chosen.isEmpty() ? std::nullopt : std::optional<std::size_t>(lsValues->row(chosen.first())));
        txUpdate->setText(ListEntryToWidget(editor_.updateText()));
    });
    connect(txUpdate, &QLineEdit::textEdited, this,
            [this](const QString& text) { editor_.setUpdateText(text.toStdString()); });
    connect(cmdAdd, &QPushButton::clicked, this, [this] {
        editor_.add();
        showEntries();
    });
    connect(cmdDelete, &QPushButton::clicked, this, [this] {
        editor_.deleteSelected();
        showEntries();
    });
    connect(cmdChange, &QPushButton::clicked, this, [this] {
        editor_.updateSelected();
        showEntries();
    });
    connect(cmdClose, &QPushButton::clicked, this, &frmList::cmdClose_Click);
    showEntries();
}

void frmList::showEntries()
{
    const QSignalBlocker quiet(lsValues);
    lsValues->clear();
    for (const auto& entry : editor_.entries())
        lsValues->addItem(ListEntryToWidget(entry));
    if (const auto row = editor_.selected())
        lsValues->setCurrentRow(static_cast<int>(*row));
    else
        lsValues->setCurrentRow(-1);
    txUpdate->setText(ListEntryToWidget(editor_.updateText()));
}

void frmList::cmdClose_Click()
{
    if (editor_.close())
        accept();
}

void frmList::keyPressEvent(QKeyEvent* event)
{
    // Escape presses Close, which asks about unsaved changes; the window's own close box does not.
    if (event->key() == Qt::Key_Escape) {
        cmdClose->click();
        return;
    }
    QDialog::keyPressEvent(event);
}

// The list takes the room beyond the design size; the buttons keep to its right.
void frmList::resizeEvent(QResizeEvent* event)
{
    QDialog::resizeEvent(event);
    if (!event->oldSize().isValid())
        return; // the first size is the design's
    ShareRoom({{Frame1, 0, 0, 1, 1},
               {lsValues, 0, 0, 1, 1},
               {txUpdate, 0, 0, 1, 0},
               {cmdChange, 1, 0, 0, 0},
               {cmdAdd, 1, 0, 0, 0},
               {cmdDelete, 1, 0, 0, 0},
               {cmdClose, 1, 0, 0, 0}},
              event->size() - event->oldSize());
}
