#include "stage/walk.h"

#include "platform/trace.h"
#include "stage/character.h"
#include "stage/stage.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

PathStep WalkPath[WALK_PATH_ENTRIES];
LONG WalkStepIndex;
LONG WalkLastIndex;
LONG WalkInterval;
DWORD WalkTimerRunning;
LONG WalkDirection;

static UINT WalkNotifyMessage;
static Sprite* WalkedSprite;

static constexpr LONG STRIDE_GROUP = 8; // a walk's strides are a multiple of this
static constexpr LONG FIRST_CYCLE = 8;  // all eight walking pictures
static constexpr LONG NEXT_CYCLE = 7;   // picture 0 isn't shown again

std::int64_t StridesWanted(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG stepLength) {
    const double x = static_cast<double>(fromX) - toX;
    const double y = static_cast<double>(fromY) - toY;
    const auto distance = static_cast<std::int64_t>(std::max(std::sqrt(x * x + y * y), 1.0));
    const std::int64_t strides = distance / std::max<LONG>(stepLength, 1);
    const std::int64_t grouped = (strides + STRIDE_GROUP - 1) / STRIDE_GROUP * STRIDE_GROUP;
    return std::max<std::int64_t>(grouped, 1);
}

static LONG CyclePicture(LONG entry) {
    return entry < FIRST_CYCLE ? entry : 1 + (entry - FIRST_CYCLE) % NEXT_CYCLE;
}

static void FillPictures(LONG strides, bool toRight, const HBITMAP* art, LONG pose) {
    const HBITMAP* walking = art + (toRight ? ART_WALK_RIGHT : ART_WALK_LEFT);
    const HBITMAP* turns = art + (toRight ? ART_TURN_RIGHT : ART_TURN_LEFT);
    for (LONG entry = 0; entry <= strides; ++entry) {
        WalkPath[entry].bitmap = walking[CyclePicture(entry)];
    }
    WalkPath[0].bitmap = turns[0];
    WalkPath[1].bitmap = turns[1];
    WalkPath[strides - 1].bitmap = turns[0];
    WalkPath[strides].bitmap = turns[1];
    WalkPath[strides + 1].bitmap = art[ART_POSES + ClampPose(pose)];
}

LONG BuildWalkPath(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG stepLength, Sprite* sprite,
                   const HBITMAP* art, LONG pose) {
    if (WalkTimerRunning != 0) {
        return 0;
    }
    WalkedSprite = sprite;
    // Two places of a Toon file can lie further apart than 32 bits hold.
    const std::int64_t dx = static_cast<std::int64_t>(fromX) - toX;
    const std::int64_t dy = static_cast<std::int64_t>(fromY) - toY;
    // Meant: a walk that would need more than the table holds takes all that it holds, each longer.
    const auto strides = static_cast<LONG>(std::min<std::int64_t>(
        StridesWanted(fromX, fromY, toX, toY, stepLength), WALK_MOST_STRIDES));
    for (LONG entry = 0; entry <= strides; ++entry) {
        WalkPath[entry].x = static_cast<LONG>(fromX - entry * (dx / strides));
        WalkPath[entry].y = static_cast<LONG>(fromY - entry * (dy / strides));
    }
    WalkPath[strides + 1] = WalkPath[strides];
    FillPictures(strides, dx < 0, art, pose);
    WalkLastIndex = strides + 1;
    WalkStepIndex = 0;
    return WalkLastIndex;
}

static void TraceWalk(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG pose) {
    Trace("walk from=[%d,%d] to=[%d,%d] n=%d step=[%d,%d] last=%d dir=%d pose=%d interval=%d "
          "paces=%u",
          fromX, fromY, toX, toY, WalkLastIndex - 1, WrapSubtract(WalkPath[1].x, WalkPath[0].x),
          WrapSubtract(WalkPath[1].y, WalkPath[0].y), WalkLastIndex, WalkDirection, ClampPose(pose),
          WalkInterval, PacesWalked);
}

UINT_PTR WalkTo(HWND stage, LONG fromX, LONG fromY, LONG toX, LONG toY, LONG pose) {
    if (BuildWalkPath(fromX, fromY, toX, toY, WALK_STRIDE, &CharacterSprite, CharacterArt, pose) ==
        0) {
        Trace("walk_refused to=[%d,%d]", toX, toY);
        return 0;
    }
    constexpr LONG entriesPerPace = 4;
    PacesWalked += static_cast<DWORD>(WalkLastIndex / entriesPerPace);
    WalkDirection = toX > fromX ? WALK_TO_RIGHT : WALK_TO_LEFT;
    const UINT_PTR started = StartWalkTimer(stage, TM_WALKDONE, ToonSpeed);
    TraceWalk(fromX, fromY, toX, toY, pose);
    return started;
}

static UINT_PTR SetWalkTimer(HWND stage) {
    const UINT_PTR timer = SetTimer(stage, TIMER_WALK, static_cast<UINT>(WalkInterval), nullptr);
    WalkTimerRunning = static_cast<DWORD>(timer);
    return timer;
}

UINT_PTR StartWalkTimer(HWND stage, UINT notifyMessage, LONG speed) {
    constexpr LONG slowest = 1;
    constexpr LONG fastest = 5;
    constexpr LONG standingStill = 210; // ms of a speed of 0, which nobody has
    constexpr LONG perSpeed = 20;
    if (WalkTimerRunning != 0) {
        return 0;
    }
    WalkNotifyMessage = notifyMessage;
    WalkInterval = standingStill - perSpeed * std::clamp(speed, slowest, fastest);
    return SetWalkTimer(stage);
}

int StopWalkTimer(HWND stage) {
    if (WalkTimerRunning != 0) {
        KillTimer(stage, TIMER_WALK);
        WalkTimerRunning = 0;
    }
    return 0;
}

UINT_PTR ResumeWalkTimer(HWND stage) {
    return WalkTimerRunning != 0 ? 0 : SetWalkTimer(stage);
}

void WalkStep(HWND stage) {
    if (IsIconic(stage)) {
        return;
    }
    if (WalkTimerRunning == 0) {
        WalkStepIndex = WalkLastIndex;
    }
    ++WalkStepIndex;
    if (WalkStepIndex <= WalkLastIndex) {
        ShowWalkStep(stage, WalkedSprite, WalkPath, WalkStepIndex);
        return;
    }
    // Meant: the pose has stood for one interval. The walk is over before the message goes out: its
    // handler may plan the next one.
    WalkStepIndex = 0;
    WalkTimerRunning = 0;
    KillTimer(stage, TIMER_WALK);
    Trace("walk_done");
    SendMessageA(stage, WalkNotifyMessage, 0, 0);
}

void ShowWalkStep(HWND stage, Sprite* sprite, const PathStep* table, LONG index) {
    const PathStep& entry = table[index];
    const PathStep& before = table[index - 1];
    sprite->frameBitmap = entry.bitmap;
    const HDC dc = GetDC(stage);
    SpriteStamp(dc, entry.bitmap, sprite);
    ReleaseDC(stage, dc);
    sprite->x = before.x;
    sprite->y = before.y;
    SpriteMove(stage, sprite, entry.x, entry.y);
    sprite->x = sprite->drawX;
    sprite->y = sprite->drawY;
    if (TraceSink != nullptr) {
        Trace("draw i=%d bitmap=%s at=[%d,%d]", index, CharacterArtName(entry.bitmap),
              sprite->drawX, sprite->drawY);
    }
}
