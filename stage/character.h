// The character's pictures, and the step that takes him off the stage.
#pragma once

#include "stage/sprite.h"

constexpr int CHARACTER_PICTURES = 28;

// Slots of CharacterArt.
constexpr int ART_WALK_RIGHT = 0;  // eight steps from left to right
constexpr int ART_WALK_LEFT = 8;   // eight steps from right to left
constexpr int ART_TURN_RIGHT = 16; // two turns of a walk from left to right
constexpr int ART_TURN_LEFT = 18;  // two turns of a walk from right to left
constexpr int ART_POSES = 20;      // eight poses

/// The pictures, each 130 x 130, black outside the figure; null while not loaded. Owned here.
extern HBITMAP CharacterArt[CHARACTER_PICTURES];

/// 1 from the end of LoadCharacterArt until FreeCharacterArt. Written here.
extern DWORD CharacterArtLoaded;

/// The character on the stage. frameBitmap is borrowed from CharacterArt. Moved by walks, placed by
/// whoever brings him on.
extern Sprite CharacterSprite;

/// The pose of a frame, which a Toon file may have beyond its range, held to 0..7.
int ClampPose(LONG pose);

/// The resource name of one of the pictures, "none" for any other bitmap.
const char* CharacterArtName(HBITMAP bitmap);

/// Loads all pictures, those of the bubble included, and parks the character. A second load frees
/// the first. A missing picture leaves its slot null. Always 1.
int LoadCharacterArt(HWND stage, HINSTANCE instance);

/// Frees all that LoadCharacterArt loaded, and sets BubbleHidden. Nothing loaded: only the flags.
void FreeCharacterArt();

/// Takes the character off the screen and parks him off the stage on the left, at half its height,
/// with his first picture. What lies under him there isn't saved. Always 1.
int ResetCharacter(HWND stage);

/// Parks the character, as ResetCharacter, and then places him unseen at (x, y), where he is to
/// come in.
void PlaceCharacterOffStage(HWND stage, LONG x, LONG y);

/// The last step of a stage: frees the pictures and what the character owns. Always 0.
int ReleaseStageArt();
