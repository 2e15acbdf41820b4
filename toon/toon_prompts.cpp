#include "toon/toon_prompts.h"

#include "toon/toon_document.h"

static constexpr std::size_t MESSAGE_SIZE = 512; // the question with the longest name in it

/// Has the user name a Toon that has no name yet; 0 if that was cancelled.
static int AskForName() {
    if (ToonFileName[0] == '\0') {
        ToonFileDialog.lpstrTitle = "Save Toon File";
        return GetSaveFileNameA(&ToonFileDialog);
    }
    return 1;
}

int ToonPromptSave(HWND owner) {
    if (ToonDirty == 0) {
        return 1;
    }
    char question[MESSAGE_SIZE];
    wsprintfA(question, "Save current changes? %s", ToonFileName);
    const int answer =
        MessageBoxA(owner, question, "Dorbo Toon Frame File", MB_YESNOCANCEL | MB_ICONEXCLAMATION);
    if (answer != IDYES) {
        return answer == IDNO ? 1 : 0;
    }
    if (AskForName() == 0) {
        return 0;
    }
    SendMessageA(owner, WM_COMMAND, COMMIT_FRAME_COMMAND, 0);
    return ToonSave(owner);
}

int ToonChoose(HWND owner) {
    if (ToonPromptSave(owner) == 0) {
        return 0;
    }
    ToonFileDialog.lpstrTitle = "Open Toon File";
    return GetOpenFileNameA(&ToonFileDialog) ? 1 : 0;
}

LONG ToonOpen(HWND owner) {
    return ToonChoose(owner) == 0 ? 0 : ToonLoad(owner);
}

int ToonNew(HWND owner) {
    if (ToonPromptSave(owner) == 0) {
        return 0;
    }
    ToonFileName[0] = '\0';
    return 1;
}

static int TellOpened(HWND mainWindow) {
    SendMessageA(mainWindow, TM_ENABLEPLAY, 1, 0);
    SendMessageA(mainWindow, TM_BACKGROUND, 0, 0);
    return 1;
}

int ToonOpenFromMenu(HWND mainWindow) {
    ToonFileName[0] = '\0';
    ToonFileSetup(mainWindow);
    const LONG count = ToonOpen(mainWindow);
    if (count == 0) {
        ToonFileName[0] = '\0'; // no later save may write over a file that failed to load
        return 0;
    }
    FrameCount = count;
    CurrentFrameIndex = 0;
    FrameGet(0, &EditFrame);
    return TellOpened(mainWindow);
}

int ToonOpenPath(HWND mainWindow, const char* path) {
    if (ToonOpenNamed(mainWindow, path) == 0) {
        ToonFileName[0] = '\0';
        return 0;
    }
    return TellOpened(mainWindow);
}
