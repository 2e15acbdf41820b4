#include "stage/face.h"

#include "platform/trace.h"
#include "stage/character.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"

#include <cstring>

HBITMAP ExpressionSheet;
DWORD Talking;
LONG TalkTicks;
LONG TalkTicksTotal;
LONG LastMouthShape;

static constexpr LONG CELL = 10;
static constexpr LONG CELL_PITCH = 11; // with the gutter of the sheet
static constexpr int POSES = CHARACTER_PICTURES - ART_POSES;

// Where a pose's cells go, from the top left corner of its picture.
static constexpr POINT EyeOffsets[POSES] = {{53, 17}, {58, 14}, {56, 16}, {59, 14},
                                            {55, 15}, {63, 16}, {57, 17}, {64, 15}};
static constexpr POINT MouthOffsets[POSES] = {{57, 32}, {62, 34}, {56, 32}, {55, 34},
                                              {55, 32}, {59, 31}, {60, 32}, {64, 31}};

void LoadExpressionSheet(HINSTANCE instance) {
    FreeExpressionSheet();
    ExpressionSheet = LoadBitmapA(instance, "expresns");
}

void FreeExpressionSheet() {
    FreeBitmap(&ExpressionSheet);
}

const ToonFrame* FollowedFrame() {
    return RandomWalkActive != 0 ? &WalkFrame : &PlayFrame;
}

int ShowExpression(HWND stage, int expression) {
    const bool eyes = expression < EXPRESSION_MOUTH_FIRST;
    const ToonFrame* frame = FollowedFrame();
    if (eyes && frame->wink == 0) {
        return 0;
    }
    const int pose = ClampPose(frame->pose);
    const POINT offset = eyes ? EyeOffsets[pose] : MouthOffsets[pose];
    return StampFaceCell(stage, offset.x, offset.y, expression);
}

static void CopyCell(HWND stage, POINT source, POINT target) {
    const HDC dc = GetDC(stage);
    const HDC sheet = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(sheet, ExpressionSheet);
    SetMapMode(sheet, GetMapMode(dc));
    POINT size = {CELL, CELL};
    DPtoLP(dc, &target, 1);
    DPtoLP(dc, &size, 1);
    DPtoLP(sheet, &source, 1);
    BitBlt(dc, target.x, target.y, size.x, size.y, sheet, source.x, source.y, SRCCOPY);
    SelectObject(sheet, before);
    DeleteDC(sheet);
    ReleaseDC(stage, dc);
}

int StampFaceCell(HWND stage, LONG xOffset, LONG yOffset, int expression) {
    if (expression == 0) {
        return 0;
    }
    const POINT target = {WrapAdd(CharacterSprite.drawX, xOffset),
                          WrapAdd(CharacterSprite.drawY, yOffset)};
    const POINT source = {(expression - 1) * CELL_PITCH,
                          ClampPose(FollowedFrame()->pose) * CELL_PITCH};
    CopyCell(stage, source, target);
    Trace("face expr=%d src=[%d,%d] dst=[%d,%d]", expression, source.x, source.y, target.x,
          target.y);
    return 1;
}

int StartTalking(HWND stage) {
    constexpr LONG charactersPerTick = 4;
    if (Talking != 0) {
        return 0;
    }
    TalkTicks = 0;
    const auto length = static_cast<LONG>(std::strlen(FollowedFrame()->text));
    if (length == 0) {
        return 0;
    }
    TalkTicksTotal = (length - 1) / charactersPerTick;
    SetTimer(stage, TIMER_TALK, TALK_INTERVAL, nullptr);
    Talking = 1;
    Trace("talk_start total=%d", TalkTicksTotal);
    return 1;
}

void StopTalking(HWND stage) {
    if (Talking != 0) {
        KillTimer(stage, TIMER_TALK);
        Trace("talk_stop");
    }
    Talking = 0;
}

void TalkTick(HWND stage) {
    ++TalkTicks;
    if (TalkTicks == TalkTicksTotal) {
        ShowExpression(stage, EXPRESSION_MOUTH_CLOSED);
        StopTalking(stage);
        return;
    }
    LONG mouth = 0;
    do {
        mouth = RandomInt(EXPRESSION_MOUTH_FIRST, EXPRESSION_MOUTH_CLOSED);
    } while (mouth == LastMouthShape);
    ShowExpression(stage, mouth);
    LastMouthShape = mouth;
}
