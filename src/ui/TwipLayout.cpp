// SPDX-License-Identifier: MIT
#include "TwipLayout.h"

#include <QAbstractButton>
#include <QFontMetricsF>
#include <QImage>
#include <QLabel>
#include <QPushButton>
#include <QStyle>
#include <algorithm>

namespace {

// The width the caption needs, with what the style draws around it.
int widthForCaption(const QWidget& control)
{
    if (const auto* button = qobject_cast<const QPushButton*>(&control)) {
        // A push button's size hint has a floor of its own that the small twip buttons are below.
        const auto shown = QString(button->text()).remove('&');
        return button->fontMetrics().horizontalAdvance(shown) +
               2 * button->style()->pixelMetric(QStyle::PM_ButtonMargin, nullptr, button);
    }
    if (qobject_cast<const QLabel*>(&control) || qobject_cast<const QAbstractButton*>(&control))
        return control.sizeHint().width();
    return 0;
}

} // namespace

double LayoutScale(const QFont& font)
{
    QFont design(font);
    design.setPointSizeF(8);
    QImage at96Dpi(1, 1, QImage::Format_RGB32);
    const int dotsPerMeter = 3780; // 96 dpi
    at96Dpi.setDotsPerMeterX(dotsPerMeter);
    at96Dpi.setDotsPerMeterY(dotsPerMeter);
    const double scale = QFontMetricsF(font).height() / QFontMetricsF(design, &at96Dpi).height();
    return std::max(scale, 1.0);
}

void WidenToShowCaption(QWidget& control, int rightEdge)
{
    const int needed = widthForCaption(control);
    if (needed <= control.width())
        return;
    // It grows to the right, but where that would pass its window's edge, to the left instead.
    int left = control.x();
    if (const auto* parent = control.parentWidget(); parent != nullptr && rightEdge < 0)
        rightEdge = parent->width();
    if (rightEdge >= 0)
        left = std::max(0, std::min(left, rightEdge - needed));
    control.setGeometry(left, control.y(), needed, control.height());
}

void ShareRoom(std::initializer_list<RoomShare> shares, QSize room)
{
    const auto part = [](double share, int extra) { return static_cast<int>(share * extra); };
    for (const auto& share : shares) {
        const QRect place = share.control->geometry();
        share.control->setGeometry(
            place.x() + part(share.right, room.width()), place.y() + part(share.down, room.height()),
            place.width() + part(share.wider, room.width()), place.height() + part(share.taller, room.height()));
    }
}
