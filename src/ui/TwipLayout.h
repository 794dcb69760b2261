// SPDX-License-Identifier: MIT
#pragma once

#include <QWidget>
#include <initializer_list>
#include <variant>

// The windows were laid out in twips for an 8 pt dialog font at 96 dpi: 15 twips a pixel.
constexpr int Pixels(int twips) { return twips / 15; }

// How much larger than the design the window font is, by the height of its lines: 1 for the 8 pt
// design font at 96 dpi and anything smaller, 1.5 at 144 dpi, about 1.7 for a 14 pt font. The
// whole layout grows by it, so that captions fit and no control runs into another.
double LayoutScale(const QFont& font);

// Twips in pixels of a layout grown by scale; exactly Pixels(twips) at scale 1.
inline int Pixels(int twips, double scale) { return static_cast<int>(twips * scale / 15); }

// Places control at the given twips, grown by scale.
inline void PlaceAt(QWidget& control, int left, int top, int width, int height, double scale = 1)
{
    control.setGeometry(Pixels(left, scale), Pixels(top, scale), Pixels(width, scale), Pixels(height, scale));
}

// A new child of parent named name, placed at the given twips.
template <typename Widget>
Widget* PlaceChild(QWidget* parent, const char* name, int left, int top, int width, int height, double scale = 1)
{
    auto* widget = new Widget(parent);
    widget->setObjectName(name);
    PlaceAt(*widget, left, top, width, height, scale);
    return widget;
}

// Widens a label, button or check box whose twip width is too small for its caption in the
// window font, just enough to show it whole and never past its parent's right edge (or past
// rightEdge, where the parent may grow beyond its design); the other controls stay.
void WidenToShowCaption(QWidget& control, int rightEdge = -1);

// The same for a control that shows a caption (label, button, check box, frame).
template <typename Widget>
Widget* PlaceCaptioned(QWidget* parent, const char* name, const QString& caption, int left, int top, int width,
                       int height, double scale = 1)
{
    auto* widget = PlaceChild<Widget>(parent, name, left, top, width, height, scale);
    if constexpr (requires { widget->setTitle(caption); })
        widget->setTitle(caption);
    else
        widget->setText(caption);
    WidenToShowCaption(*widget);
    return widget;
}

// One control of a window's table: the member that holds it (its type says which control it
// is), its name, its caption (nullptr for controls without one; marked with QT_TR_NOOP, shown in
// the window's language) and its place in twips.
template <typename Window, typename... Widgets>
struct ControlRow {
    std::variant<Widgets * Window::*...> member;
    const char* name;
    const char* caption;
    int left, top, width, height;
};

// Builds every control of rows (ControlRows of Window) on parent, each into its member of window,
// laid out for the parent's font.
template <typename Window, typename Rows>
void BuildControls(Window& window, QWidget* parent, const Rows& rows)
{
    const double scale = LayoutScale(parent->font());
    for (const auto& row : rows)
        std::visit(
            [&](auto member) {
                using Widget = std::remove_pointer_t<std::remove_reference_t<decltype(window.*member)>>;
                constexpr bool captioned = requires(Widget * w) { w->setText(QString()); }
                || requires(Widget * w) { w->setTitle(QString()); };
                if constexpr (captioned) {
                    if (row.caption != nullptr) {
                        window.*member = PlaceCaptioned<Widget>(parent, row.name, Window::tr(row.caption), row.left,
                                                                row.top, row.width, row.height, scale);
                        return;
                    }
                }
                window.*member = PlaceChild<Widget>(parent, row.name, row.left, row.top, row.width, row.height, scale);
            },
            row.member);
}

// Places the controls that BuildControls built from rows again, grown by scale: for a window
// whose font changed after it was built. rightEdge as for WidenToShowCaption.
template <typename Window, typename Rows>
void LayOutControls(Window& window, const Rows& rows, double scale, int rightEdge = -1)
{
    for (const auto& row : rows)
        std::visit(
            [&](auto member) {
                QWidget& control = *(window.*member);
                PlaceAt(control, row.left, row.top, row.width, row.height, scale);
                if (row.caption != nullptr)
                    WidenToShowCaption(control, rightEdge);
            },
            row.member);
}

// A control's part of the room that a resizable window has beyond its design size: how far it
// moves right and down, and how much wider and taller it grows, each as a part of that room.
struct RoomShare {
    QWidget* control;
    double right, down, wider, taller;
};

// Moves and grows each control by its share of room, the extra width and height.
void ShareRoom(std::initializer_list<RoomShare> shares, QSize room);

// The order in which Tab moves through the controls.
inline void ChainTabOrder(std::initializer_list<QWidget*> order)
{
    const QWidget* previous = nullptr;
    for (QWidget* widget : order) {
        if (previous)
            QWidget::setTabOrder(const_cast<QWidget*>(previous), widget);
        previous = widget;
    }
}
