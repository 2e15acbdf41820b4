#include "stage/bubble.h"

#include "platform/trace.h"
#include "stage/character.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "toon/toon_document.h"

#include <cstring>

Sprite BubbleSprite;
LONG BubbleSide;
DWORD BubbleHidden = 1;

static HBITMAP BubbleRightBitmap; // tail at the right edge: stands left of him
static HBITMAP BubbleLeftBitmap;  // tail at the left edge
static bool BubbleStands;         // drawn and not yet taken off: HideBubble has something to do

static constexpr LONG ANCHOR_X = 65; // the middle of his picture, at the height of his mouth
static constexpr LONG ANCHOR_Y = 35;
static constexpr LONG BUBBLE_GAP = 15;  // between anchor and tail
static constexpr LONG TAIL_HEIGHT = 50; // rows above the tail's tip

void LoadBubbleArt(HWND stage, HINSTANCE instance) {
    BubbleRightBitmap = LoadBitmapA(instance, "bubright");
    BubbleLeftBitmap = LoadBitmapA(instance, "bubleft");
    PositionBubble(stage, 0, 0);
}

void FreeBubbleArt() {
    FreeBitmap(&BubbleRightBitmap);
    FreeBitmap(&BubbleLeftBitmap);
    SpriteFree(&BubbleSprite);
    BubbleStands = false;
}

void PlaceBubble(HWND stage) {
    const LONG anchorX = WrapAdd(CharacterSprite.drawX, ANCHOR_X);
    const LONG anchorY = WrapAdd(CharacterSprite.drawY, ANCHOR_Y);
    ChooseBubbleSide(stage, anchorX, anchorY, WalkDirection);
    Trace("bubble_place side=%d corner=[%d,%d] anchor=[%d,%d] bitmap=%s", BubbleSide,
          BubbleSprite.drawX, BubbleSprite.drawY, anchorX, anchorY,
          BubbleSide == BUBBLE_RIGHT ? "bubleft" : "bubright");
}

void ChooseBubbleSide(HWND stage, LONG anchorX, LONG anchorY, LONG direction) {
    RECT client = {};
    GetClientRect(stage, &client);
    const LONG width = client.right - client.left;
    const LONG quarter = width / 4;
    LONG side = direction;
    if (direction == WALK_TO_RIGHT && anchorX > 3 * quarter) {
        side = BUBBLE_LEFT;
    } else if (direction != WALK_TO_RIGHT && anchorX < quarter) {
        side = BUBBLE_RIGHT;
    }
    // The edge rule comes once: on a stage where neither side fits, the second one stands.
    if (side == BUBBLE_RIGHT && WrapAdd(anchorX, BubbleSprite.cx) > width) {
        side = BUBBLE_LEFT;
    } else if (side != BUBBLE_RIGHT && WrapSubtract(anchorX, BubbleSprite.cx) < 0) {
        side = BUBBLE_RIGHT;
    }
    BubbleSide = side;
    PositionBubble(stage, anchorX, anchorY);
}

void PositionBubble(HWND stage, LONG anchorX, LONG anchorY) {
    LONG left = 0;
    if (BubbleSide == BUBBLE_RIGHT) {
        BubbleSprite.frameBitmap = BubbleLeftBitmap;
        left = WrapAdd(anchorX, BUBBLE_GAP);
    } else {
        BubbleSprite.frameBitmap = BubbleRightBitmap;
        left = WrapSubtract(anchorX, WrapAdd(BubbleSprite.cx, BUBBLE_GAP));
    }
    BubbleSprite.x = left;
    BubbleSprite.drawX = left;
    BubbleSprite.y = WrapSubtract(anchorY, TAIL_HEIGHT);
    BubbleSprite.drawY = BubbleSprite.y;
    const HDC dc = GetDC(stage);
    SpriteStamp(dc, BubbleSprite.frameBitmap, &BubbleSprite);
    ReleaseDC(stage, dc);
}

/// The body of the balloon, away from its tail: 120 x 71 pixels.
static RECT TextRectangle() {
    constexpr LONG awayFromTail = 10;
    constexpr LONG downIntoBody = 14;
    constexpr LONG marginAcross = 20;
    constexpr LONG marginAbove = 12;
    BITMAP bitmap = {};
    GetObjectA(BubbleSprite.frameBitmap, sizeof(bitmap), &bitmap);
    RECT area = {};
    area.left =
        WrapAdd(BubbleSprite.drawX, BubbleSide == BUBBLE_RIGHT ? awayFromTail : -awayFromTail);
    area.top = WrapAdd(BubbleSprite.drawY, downIntoBody);
    area.right = WrapAdd(area.left, bitmap.bmWidth);
    area.bottom = WrapAdd(area.top, bitmap.bmHeight);
    InflateRect(&area, -marginAcross, -marginAbove);
    return area;
}

/// The text with each carriage return written as two characters.
static void EscapeReturns(const char* text, char* escaped) {
    for (; *text != '\0'; ++text) {
        if (*text == '\r') {
            *escaped++ = '\\';
            *escaped++ = 'r';
        } else {
            *escaped++ = *text;
        }
    }
    *escaped = '\0';
}

static void TraceBubble(const char* text) {
    char escaped[2 * TOON_TEXT_SIZE] = {};
    EscapeReturns(text, escaped);
    const RECT area = TextRectangle();
    Trace("bubble_show rect=[%d,%d,%d,%d] text_rect=[%d,%d,%d,%d] text=%s", BubbleSprite.drawX,
          BubbleSprite.drawY, WrapAdd(BubbleSprite.drawX, BubbleSprite.cx),
          WrapAdd(BubbleSprite.drawY, BubbleSprite.cy), area.left, area.top, area.right,
          area.bottom, escaped);
}

void ShowBubble(HWND stage, const char* text) {
    const HDC dc = GetDC(stage);
    SpriteSaveUnder(dc, &BubbleSprite);
    SpriteDraw(dc, &BubbleSprite);
    ReleaseDC(stage, dc);
    BubbleStands = true;
    DrawBubbleText(stage, text);
    BubbleHidden = 0;
    if (TraceSink != nullptr) {
        TraceBubble(text);
    }
}

int DrawBubbleText(HWND stage, const char* text) {
    constexpr int characterHeight = 14;
    RECT area = TextRectangle();
    const HDC dc = GetDC(stage);
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HFONT font =
        CreateFontA(-characterHeight, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
    const HGDIOBJ fontBefore = SelectObject(dc, font);
    const int height = DrawTextA(dc, text, static_cast<int>(std::strlen(text)), &area,
                                 DT_CENTER | DT_WORDBREAK | DT_NOPREFIX);
    SetMapMode(dc, mapMode);
    SelectObject(dc, fontBefore);
    DeleteObject(font);
    ReleaseDC(stage, dc);
    return height;
}

void SaveUnderBubble(HDC dc) {
    if (BubbleStands) {
        SpriteSaveUnder(dc, &BubbleSprite);
    }
}

void HideBubble(HWND stage) {
    if (BubbleStands) {
        const HDC dc = GetDC(stage);
        SpriteRestoreUnder(dc, &BubbleSprite);
        ReleaseDC(stage, dc);
    }
    Trace("bubble_hide rect=[%d,%d,%d,%d] shown=%d", BubbleSprite.drawX, BubbleSprite.drawY,
          WrapAdd(BubbleSprite.drawX, BubbleSprite.cx),
          WrapAdd(BubbleSprite.drawY, BubbleSprite.cy), BubbleStands ? 1 : 0);
    BubbleStands = false;
    BubbleHidden = 1;
}
