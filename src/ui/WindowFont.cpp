// SPDX-License-Identifier: MIT
#include "WindowFont.h"

#include <QApplication>
#include <QFont>

void UseWindowFont()
{
    constexpr double DesignPoints = 8;
    constexpr double LargestUsualPoints = 12;
    QFont font = QApplication::font();
    if (font.pointSizeF() <= LargestUsualPoints) // a font sized in pixels has no points (-1)
        font.setPointSizeF(DesignPoints);
    QApplication::setFont(font);
}
