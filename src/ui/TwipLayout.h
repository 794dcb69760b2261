#pragma once

#include <QWidget>

// The windows were laid out in twips; at 15 twips per pixel.
constexpr int Pixels(int twips) { return twips / 15; }

// A new child of parent named name, placed at the given twips.
template <typename Widget>
Widget* PlaceChild(QWidget* parent, const char* name, int left, int top, int width, int height)
{
    auto* widget = new Widget(parent);
    widget->setObjectName(name);
    widget->setGeometry(Pixels(left), Pixels(top), Pixels(width), Pixels(height));
    return widget;
}
