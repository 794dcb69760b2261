#include "WindowFont.h"

#include <QApplication>
#include <QFont>

void UseWindowFont()
{
    QFont font = QApplication::font();
    font.setPointSizeF(8);
    QApplication::setFont(font);
}
