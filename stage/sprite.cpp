#include "stage/sprite.h"

#include "platform/user.h"
#include "stage/stage.h"

static constexpr COLORREF SEE_THROUGH = RGB(0, 0, 0);

/// A memory context with a bitmap in it, and what it held before.
struct BitmapContext {
    HDC dc;
    HBITMAP bitmap;
    HGDIOBJ before;
};

static BitmapContext OpenBitmap(HDC compatible, HBITMAP bitmap) {
    HDC dc = CreateCompatibleDC(compatible);
    return {dc, bitmap, SelectObject(dc, bitmap)};
}

static void CloseBitmap(const BitmapContext& context) {
    SelectObject(context.dc, context.before);
    DeleteDC(context.dc);
}

/// A new bitmap of the Sprite's size and of the display's form.
static BitmapContext OpenPicture(HDC display, const Sprite* sprite) {
    return OpenBitmap(display, CreateCompatibleBitmap(display, sprite->cx, sprite->cy));
}

/// A new monochrome bitmap of the Sprite's size: a fresh memory context holds a monochrome one, and
/// what is compatible with it is monochrome too.
static BitmapContext OpenMask(HDC display, const Sprite* sprite) {
    HDC dc = CreateCompatibleDC(display);
    const HBITMAP mask = CreateCompatibleBitmap(dc, sprite->cx, sprite->cy);
    return {dc, mask, SelectObject(dc, mask)};
}

static void DiscardBitmap(const BitmapContext& context) {
    CloseBitmap(context);
    DeleteObject(context.bitmap);
}

/// Copies a whole picture of the Sprite's size.
static void CopyPicture(const Sprite* sprite, HDC target, LONG x, LONG y, HDC source,
                        DWORD operation) {
    BitBlt(target, x, y, sprite->cx, sprite->cy, source, 0, 0, operation);
}

/// Copies what a stage shows at the draw place to the target's corner.
static void ReadStage(const Sprite* sprite, HDC target, HDC stage) {
    BitBlt(target, 0, 0, sprite->cx, sprite->cy, stage, sprite->drawX, sprite->drawY, SRCCOPY);
}

void SpriteStamp(HDC dc, HBITMAP bitmap, Sprite* sprite) {
    BITMAP size{};
    GetObjectA(bitmap, sizeof(size), &size);
    sprite->drawX = sprite->x;
    sprite->drawY = sprite->y;
    sprite->cx = size.bmWidth;
    sprite->cy = size.bmHeight;
    if (sprite->image) {
        DeleteObject(sprite->image);
    }
    sprite->image = CreateCompatibleBitmap(dc, sprite->cx, sprite->cy);
    const BitmapContext image = OpenBitmap(dc, sprite->image);
    const BitmapContext source = OpenBitmap(dc, bitmap);
    SetStretchBltMode(image.dc, BLACKONWHITE);
    StretchBlt(image.dc, 0, 0, sprite->cx, sprite->cy, source.dc, 0, 0, sprite->cx, sprite->cy,
               SRCCOPY);
    CloseBitmap(source);
    CloseBitmap(image);
}

void SpriteSaveUnder(HDC dc, Sprite* sprite) {
    if (sprite->savedUnder) {
        DeleteObject(sprite->savedUnder);
    }
    sprite->savedUnder = CreateCompatibleBitmap(dc, sprite->cx, sprite->cy);
    const BitmapContext under = OpenBitmap(dc, sprite->savedUnder);
    ReadStage(sprite, under.dc, dc);
    CloseBitmap(under);
}

void SpriteRestoreUnder(HDC dc, const Sprite* sprite) {
    if (!sprite->savedUnder) {
        return; // a context without a bitmap of ours still has one pixel to copy
    }
    const BitmapContext under = OpenBitmap(dc, sprite->savedUnder);
    CopyPicture(sprite, dc, sprite->drawX, sprite->drawY, under.dc, SRCCOPY);
    CloseBitmap(under);
}

void SpriteDraw(HDC dc, const Sprite* sprite) {
    const BitmapContext image = OpenBitmap(dc, sprite->image);
    const BitmapContext work = OpenPicture(dc, sprite);
    const BitmapContext mask = OpenMask(dc, sprite);
    const COLORREF background = SetBkColor(image.dc, SEE_THROUGH);

    CopyPicture(sprite, mask.dc, 0, 0, image.dc, SRCCOPY); // white where the image is black
    ReadStage(sprite, work.dc, dc);
    CopyPicture(sprite, work.dc, 0, 0, mask.dc, SRCAND); // the figure's shape cut out in black
    CopyPicture(sprite, work.dc, 0, 0, image.dc, SRCPAINT);
    CopyPicture(sprite, dc, sprite->drawX, sprite->drawY, work.dc, SRCCOPY);

    SetBkColor(image.dc, background);
    DiscardBitmap(mask);
    DiscardBitmap(work);
    CloseBitmap(image);
}

/// The five memory contexts of a move.
struct MoveContexts {
    BitmapContext image;
    BitmapContext mask;
    BitmapContext composition; // becomes what the new place shows
    BitmapContext newUnder;    // becomes the clean background of the new place
    BitmapContext oldUnder;    // savedUnder; becomes what the old place shows
};

/// Composes both places in memory and writes each to the stage once, the new one first. (dx, dy) is
/// the old place as seen from the new one, which is the draw place by now.
static void ComposeMove(const Sprite* sprite, HDC stage, const MoveContexts& move, LONG dx,
                        LONG dy) {
    HDC image = move.image.dc;
    HDC mask = move.mask.dc;
    HDC composition = move.composition.dc;
    HDC newUnder = move.newUnder.dc;
    HDC oldUnder = move.oldUnder.dc;
    const LONG backX = WrapSubtract(0, dx);
    const LONG backY = WrapSubtract(0, dy);

    CopyPicture(sprite, mask, 0, 0, image, SRCCOPY); // white where the image is black
    ReadStage(sprite, newUnder, stage);
    CopyPicture(sprite, newUnder, dx, dy, oldUnder, SRCCOPY); // the old picture is gone from here
    CopyPicture(sprite, oldUnder, backX, backY, mask, SRCAND);
    CopyPicture(sprite, oldUnder, backX, backY, image, SRCPAINT);
    CopyPicture(sprite, composition, 0, 0, newUnder, SRCCOPY);
    CopyPicture(sprite, composition, 0, 0, mask, SRCAND);
    CopyPicture(sprite, composition, 0, 0, image, SRCPAINT);
    CopyPicture(sprite, stage, sprite->drawX, sprite->drawY, composition, SRCCOPY);
    CopyPicture(sprite, stage, WrapAdd(sprite->drawX, dx), WrapAdd(sprite->drawY, dy), oldUnder,
                SRCCOPY);
}

void SpriteMove(HWND window, Sprite* sprite, LONG x, LONG y) {
    const LONG dx = WrapSubtract(sprite->x, x);
    const LONG dy = WrapSubtract(sprite->y, y);
    sprite->x = x;
    sprite->y = y;
    sprite->drawX = WrapSubtract(sprite->drawX, dx);
    sprite->drawY = WrapSubtract(sprite->drawY, dy);

    HDC stage = GetDC(window);
    const MoveContexts move{OpenBitmap(stage, sprite->image), OpenMask(stage, sprite),
                            OpenPicture(stage, sprite), OpenPicture(stage, sprite),
                            OpenBitmap(stage, sprite->savedUnder)};
    const COLORREF background = SetBkColor(move.image.dc, SEE_THROUGH);
    ComposeMove(sprite, stage, move, dx, dy);
    SetBkColor(move.image.dc, background);
    CloseBitmap(move.image);
    CloseBitmap(move.newUnder);
    DiscardBitmap(move.mask);
    DiscardBitmap(move.composition);
    DiscardBitmap(move.oldUnder);
    sprite->savedUnder = move.newUnder.bitmap;
    ReleaseDC(window, stage);
}

BOOL SpriteHitTest(const Sprite* sprite, POINT point) {
    const RECT area{sprite->drawX, sprite->drawY, WrapAdd(sprite->drawX, sprite->cx),
                    WrapAdd(sprite->drawY, sprite->cy)};
    return PtInRect(&area, point);
}

void FreeBitmap(HBITMAP* bitmap) {
    if (*bitmap) {
        DeleteObject(*bitmap);
    }
    *bitmap = nullptr;
}

void SpriteFree(Sprite* sprite) {
    sprite->frameBitmap = nullptr;
    FreeBitmap(&sprite->image);
    FreeBitmap(&sprite->savedUnder);
}

void SpriteStampOnce(HDC dc, HBITMAP bitmap, LONG x, LONG y) {
    Sprite sprite{};
    sprite.frameBitmap = bitmap;
    sprite.x = x;
    sprite.y = y;
    SpriteStamp(dc, bitmap, &sprite);
    SpriteSaveUnder(dc, &sprite);
    SpriteDraw(dc, &sprite);
    SpriteFree(&sprite);
}
