#include "platform/drawing_kit.h"

#include <cstdlib>

void DrawBevelEdge(HDC dc, int left, int top, int right, int bottom, HPEN first, HPEN second) {
    HGDIOBJ before = SelectObject(dc, first);
    MoveToEx(dc, left, bottom - 1, nullptr);
    LineTo(dc, left, top);
    LineTo(dc, right - 1, top);
    SelectObject(dc, before);

    before = SelectObject(dc, second);
    MoveToEx(dc, right - 1, top, nullptr);
    LineTo(dc, right - 1, bottom - 1);
    LineTo(dc, left + 1, bottom - 1);
    SelectObject(dc, before);
}

void DrawBevel(HDC dc, int left, int top, int right, int bottom, int width) {
    const bool sunken = width > 0;
    HPEN first = CreatePen(PS_SOLID, 1, GetSysColor(sunken ? COLOR_BTNSHADOW : COLOR_BTNHIGHLIGHT));
    HPEN second =
        CreatePen(PS_SOLID, 1, GetSysColor(sunken ? COLOR_BTNHIGHLIGHT : COLOR_BTNSHADOW));
    RECT ring{left, top, right, bottom};
    for (int i = 0; i < std::abs(width); ++i) {
        DrawBevelEdge(dc, ring.left, ring.top, ring.right, ring.bottom, first, second);
        InflateRect(&ring, -1, -1);
    }
    DeleteObject(first);
    DeleteObject(second);
}

BOOL DrawBevelBox(HDC dc, int left, int top, int right, int bottom, int width) {
    DrawBevel(dc, left, top, right, bottom, width);
    RECT inner{left, top, right, bottom};
    InflateRect(&inner, -std::abs(width), -std::abs(width));
    return Rectangle(dc, inner.left, inner.top, inner.right, inner.bottom);
}

void DrawShadowPasses(HDC dc, const char* text, int depth, int left, int top, int right, int bottom,
                      COLORREF first, COLORREF second) {
    RECT area{left, top, right, bottom};
    const COLORREF before = SetTextColor(dc, first);
    for (int i = 0; i < depth; ++i) {
        --area.left;
        --area.top;
        DrawTextA(dc, text, -1, &area, DT_CENTER);
    }
    area.left = left;
    area.top = top;
    SetTextColor(dc, second);
    for (int i = 0; i < depth; ++i) {
        ++area.left;
        ++area.top;
        DrawTextA(dc, text, -1, &area, DT_CENTER);
    }
    SetTextColor(dc, before);
}

int DrawShadowText(HDC dc, COLORREF colour, const char* text, int left, int top, int right,
                   int bottom, int depth) {
    const int mode = SetBkMode(dc, TRANSPARENT);
    const COLORREF light = GetSysColor(COLOR_BTNHIGHLIGHT);
    const COLORREF dark = GetSysColor(COLOR_BTNSHADOW);
    const bool raised = depth > 0;
    DrawShadowPasses(dc, text, std::abs(depth), left, top, right, bottom, raised ? light : dark,
                     raised ? dark : light);
    SetTextColor(dc, colour);
    RECT area{left, top, right, bottom};
    const int result = DrawTextA(dc, text, -1, &area, DT_CENTER);
    SetBkMode(dc, mode);
    return result;
}

HFONT MakeFont(int height, int weight, const char* face) {
    return CreateFontA(-height, 0, 0, 0, weight, 0, 0, 0, 0, 0, 0, 0, 0, face);
}

void BlitPicture(HDC dc, int left, int top, int right, int bottom, HBITMAP bitmap) {
    HDC memory = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(memory, bitmap);
    SetMapMode(memory, GetMapMode(dc));
    POINT size{right - left, bottom - top};
    DPtoLP(dc, &size, 1);
    POINT source{0, 0};
    DPtoLP(memory, &source, 1);
    BitBlt(dc, left, top, size.x, size.y, memory, source.x, source.y, SRCCOPY);
    SelectObject(memory, before);
    DeleteDC(memory);
}
