#pragma once

#include <QWidget>
#include <initializer_list>
#include <variant>

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

// Widens a label, button or check box whose twip width is too small for its caption in the
// window font, just enough to show it whole and never past its parent's right edge; the other
// controls stay.
void WidenToShowCaption(QWidget& control);

// The same for a control that shows a caption (label, button, check box, frame).
template <typename Widget>
Widget* PlaceCaptioned(QWidget* parent, const char* name, const char* caption, int left, int top, int width, int height)
{
    auto* widget = PlaceChild<Widget>(parent, name, left, top, width, height);
    if constexpr (requires { widget->setTitle(caption); })
        widget->setTitle(caption);
    else
        widget->setText(caption);
    WidenToShowCaption(*widget);
    return widget;
}

// One control of a window's table: the member that holds it (its type says which control it
// is), its name, its caption (nullptr for controls without one) and its place in twips.
template <typename Window, typename... Widgets>
struct ControlRow {
    std::variant<Widgets * Window::*...> member;
    const char* name;
    const char* caption;
    int left, top, width, height;
};

// Builds every control of rows (ControlRows of Window) on parent, each into its member of window.
template <typename Window, typename Rows>
void BuildControls(Window& window, QWidget* parent, const Rows& rows)
{
    for (const auto& row : rows)
        std::visit(
            [&](auto member) {
                using Widget = std::remove_pointer_t<std::remove_reference_t<decltype(window.*member)>>;
                constexpr bool captioned = requires(Widget * w) { w->setText(QString()); }
                || requires(Widget * w) { w->setTitle(QString()); };
                if constexpr (captioned) {
                    if (row.caption != nullptr) {
                        window.*member = PlaceCaptioned<Widget>(parent, row.name, row.caption, row.left, row.top,
                                                                row.width, row.height);
                        return;
                    }
                }
                window.*member = PlaceChild<Widget>(parent, row.name, row.left, row.top, row.width, row.height);
            },
            row.member);
}

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
