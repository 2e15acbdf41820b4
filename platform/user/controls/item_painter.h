// Items and buttons that the program draws itself.
#pragma once

#include "platform/dialogs.h"

#include <QPainter>
#include <QRect>

namespace seam {

/// What is asked of the program: one part of a control in its state.
struct DrawnItem {
    HWND control;
    UINT kind = 0;
    UINT item = 0;
    UINT state = 0;
    std::uintptr_t data = 0;
};

/// Has the control's parent draw the item by WM_DRAWITEM, on ground of the given colour, and puts
/// it at a place of the widget that is being painted.
void paintItem(QPainter& painter, const QRect& place, const QColor& ground, const DrawnItem& item);

} // namespace seam
