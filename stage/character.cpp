#include "stage/character.h"

#include "platform/trace.h"
#include "stage/bubble.h"
#include "stage/stage.h"

#include <algorithm>
#include <iterator>

HBITMAP CharacterArt[CHARACTER_PICTURES];
DWORD CharacterArtLoaded;
Sprite CharacterSprite;

static const char* const PictureNames[CHARACTER_PICTURES] = {
    "fdl2r1", "fdl2r2", "fdl2r3", "fdl2r4", "fdl2r5", "fdl2r6", "fdl2r7",
    "fdl2r8", "fdr2l1", "fdr2l2", "fdr2l3", "fdr2l4", "fdr2l5", "fdr2l6",
    "fdr2l7", "fdr2l8", "fdltn1", "fdltn2", "fdrtn1", "fdrtn2", "pose01",
    "pose02", "pose03", "pose04", "pose05", "pose06", "pose07", "pose08"};

int ClampPose(LONG pose) {
    return static_cast<int>(std::clamp<LONG>(pose, 0, CHARACTER_PICTURES - ART_POSES - 1));
}

const char* CharacterArtName(HBITMAP bitmap) {
    const HBITMAP* slot = std::find(std::begin(CharacterArt), std::end(CharacterArt), bitmap);
    if (!bitmap || slot == std::end(CharacterArt)) {
        return "none";
    }
    return PictureNames[slot - std::begin(CharacterArt)];
}

int LoadCharacterArt(HWND stage, HINSTANCE instance) {
    FreeCharacterArt();
    for (int slot = 0; slot < CHARACTER_PICTURES; ++slot) {
        CharacterArt[slot] = LoadBitmapA(instance, PictureNames[slot]);
    }
    LoadBubbleArt(stage, instance);
    CharacterArtLoaded = static_cast<DWORD>(ResetCharacter(stage));
    return 1;
}

void FreeCharacterArt() {
    FreeBubbleArt();
    BubbleHidden = 1;
    for (HBITMAP& picture : CharacterArt) {
        FreeBitmap(&picture);
    }
    CharacterArtLoaded = 0;
}

int ResetCharacter(HWND stage) {
    CharacterSprite.frameBitmap = CharacterArt[ART_WALK_RIGHT];
    const HDC dc = GetDC(stage);
    SpriteRestoreUnder(dc, &CharacterSprite);
    RECT client = {};
    GetClientRect(stage, &client);
    CharacterSprite.x = OFF_LEFT_X;
    CharacterSprite.y = client.bottom / 2;
    SpriteStamp(dc, CharacterSprite.frameBitmap, &CharacterSprite);
    ReleaseDC(stage, dc);
    Trace("reset_character draw=[%d,%d]", CharacterSprite.drawX, CharacterSprite.drawY);
    return 1;
}

void PlaceCharacterOffStage(HWND stage, LONG x, LONG y) {
    ResetCharacter(stage);
    CharacterSprite.x = x;
    CharacterSprite.drawX = x;
    CharacterSprite.y = y;
    CharacterSprite.drawY = y;
    Trace("enter draw=[%d,%d] side=%s", x, y, x == OFF_LEFT_X ? "left" : "right");
}

int ReleaseStageArt() {
    FreeCharacterArt();
    SpriteFree(&CharacterSprite);
    return 0;
}
