#include "editor/frame_editor.h"

#include "editor/button_states.h"
#include "editor/command_ids.h"
#include "editor/configuration.h"
#include "editor/editor_shell.h"
#include "editor/frame_fields.h"
#include "editor/pose_picker.h"
#include "toon/toon_prompts.h"

#include <algorithm>

HWND EditorDialog;

// ---- Open and close -----------------------------------------------------------------------------

void OpenFrameEditor(HWND mainWindow, HINSTANCE instance) {
    if (EditorDialog) {
        return;
    }
    EditorDialog = CreateDialogParamA(instance, "Framedit", mainWindow, FrameEditorProc, 0);
    SetClassLongA(EditorStage, GCL_HCURSOR, static_cast<LONG>(TargetCursor.number));
}

/// A Toon of one frame of zeros, without a name.
static void BeginUntitledToon() {
    EndShow();
    CurrentFrameIndex = 0;
    FrameCount = 1;
    FrameStoreAlloc(1);
    ToonNewDefaults();
    EditPose = 0;
    BackgroundIndex = 1;
}

int StartFrameEditor(HWND dialog) {
    if (ToonFileName[0] == '\0') {
        BeginUntitledToon();
    }
    // A Toon that was read anew has lost the frames that weren't saved.
    CurrentFrameIndex = std::clamp<LONG>(CurrentFrameIndex, 0, std::max<LONG>(FrameCount - 1, 0));
    FillFrameList(dialog);
    FrameGet(CurrentFrameIndex, &EditFrame);
    SendMessageA(GetParent(dialog), TM_ENABLEPLAY, 0, 0);
    return ShowFrameFields(dialog, &EditFrame);
}

int ExitFrameEditor(HWND dialog) {
    return ToonPromptSave(dialog) == 0 ? 0 : CloseFrameEditor(dialog);
}

int CloseFrameEditor(HWND dialog) {
    const HWND owner = GetParent(dialog);
    if (ToonDirty != 0 && ToonReload(dialog) == 0) { // the user wants none of the changes
        ToonFileName[0] = '\0'; // the file has failed: no later save may write over it
    }
    DestroyWindow(dialog);
    EditorDialog = nullptr;
    SendMessageA(owner, TM_EDITORCLOSED, 0, 0);
    if (ToonFileName[0] != '\0') {
        SendMessageA(owner, TM_BACKGROUND, 0, 0);
        SendMessageA(owner, TM_ENABLEPLAY, 1, 0);
    }
    return 1;
}

// ---- Frames -------------------------------------------------------------------------------------

static int RefuseFrame(HWND dialog) {
    MessageBeep(0);
    MessageBoxA(dialog, "No More Toon Frames Allowed", "Error", MB_ICONEXCLAMATION);
    return 0;
}

int NewFrame(HWND dialog) {
    if (FrameCount >= TOON_FRAME_LIMIT) {
        return RefuseFrame(dialog);
    }
    EndShow();
    ++FrameCount;
    if (FrameStoreGrow() == 0) {
        return 0;
    }
    EditPose = 0;
    AddFrameListItem(dialog, FrameCount);
    CurrentFrameIndex = FrameCount - 1;
    SelectListedFrame(dialog, CurrentFrameIndex);
    if (FrameGet(CurrentFrameIndex, &EditFrame) == 0) {
        return 0;
    }
    ToonSetDirty(dialog, 1);
    return ShowFrameFields(dialog, &EditFrame);
}

/// The numbers behind the place have moved.
static int ShowFramesAnew(HWND dialog, LONG current) {
    CurrentFrameIndex = current;
    FillFrameList(dialog);
    ToonSetDirty(dialog, 1);
    return ShowCurrentFrame(dialog);
}

int InsertFrame(HWND dialog) {
    if (FrameCount >= TOON_FRAME_LIMIT) {
        return RefuseFrame(dialog);
    }
    const LONG selected = FrameListSelection(dialog);
    if (FrameStoreInsert(selected) == 0) {
        return 0;
    }
    EndShow();
    return ShowFramesAnew(dialog, selected);
}

int DeleteFrame(HWND dialog) {
    const LONG selected = FrameListSelection(dialog);
    if (FrameStoreDelete(selected) == 0) {
        return 0;
    }
    EndShow();
    return ShowFramesAnew(dialog, std::min(selected, FrameCount - 1));
}

void ChoosePose(HINSTANCE instance, HWND dialog) {
    EditPose = RunPosePicker(instance, dialog, EditPose);
    ShowPoseLabel(dialog, EditPose);
    ToonSetDirty(dialog, 1);
}

// ---- Files --------------------------------------------------------------------------------------

int SaveToonAs(HWND dialog) {
    ToonFileDialog.lpstrTitle = "Save Toon File";
    if (!GetSaveFileNameA(&ToonFileDialog)) {
        return 0;
    }
    ShowEditorTitle(dialog);
    return ToonSave(dialog);
}

int SaveToonCommand(HWND dialog) {
    if (ToonFileName[0] == '\0') {
        return SaveToonAs(dialog);
    }
    return ToonDirty != 0 ? ToonSave(dialog) : 0;
}

/// The fields stay as they were, and with them the pose.
static int ForgetFailedToon(HWND dialog) {
    const LONG pose = EditPose;
    ToonFileName[0] = '\0';
    BeginUntitledToon();
    EditPose = pose;
    FillFrameList(dialog);
    ShowEditorTitle(dialog);
    ToonSetDirty(dialog, 0);
    SendMessageA(EditorMainWindow, TM_BACKGROUND, 0, 0);
    SendMessageA(EditorMainWindow, TM_ENABLEPLAY, 0, 0); // its frame would hold a show for ever
    return 0;
}

int OpenToonInEditor(HWND dialog) {
    if (ToonChoose(dialog) == 0) {
        return 0;
    }
    EndShow();
    const LONG count = ToonLoad(dialog);
    if (!EditorDialog) {
        return 0; // the editor was closed behind a message
    }
    if (count == 0) {
        return ForgetFailedToon(dialog);
    }
    FrameCount = count;
    CurrentFrameIndex = 0;
    FillFrameList(dialog);
    ShowCurrentFrame(dialog);
    ToonSetDirty(dialog, 0);
    SendMessageA(EditorMainWindow, TM_BACKGROUND, 0, 0);
    SendMessageA(EditorMainWindow, TM_ENABLEPLAY, 1, 0);
    return 1;
}

int NewToonInEditor(HWND dialog) {
    if (ToonNew(dialog) == 0) {
        return 1;
    }
    ToonNewDefaults();
    StartFrameEditor(dialog);
    ToonSetDirty(dialog, 0);
    SendMessageA(EditorMainWindow, TM_BACKGROUND, 0, 0);
    return 1;
}

// ---- The dialog ---------------------------------------------------------------------------------

static int RunCommand(HWND dialog, HINSTANCE instance, int command) {
    switch (command) {
    case ITEM_NEW:
        return NewToonInEditor(dialog);
    case ITEM_OPEN:
        return OpenToonInEditor(dialog);
    case ITEM_SAVE:
        return SaveToonCommand(dialog);
    case ITEM_SAVE_AS:
        return SaveToonAs(dialog);
    case ITEM_CONFIGURE:
        return ConfigureToon(instance, dialog);
    case ITEM_EXIT:
        return ExitFrameEditor(dialog);
    case ITEM_NEW_FRAME:
    case NEW_FRAME_BUTTON:
        return NewFrame(dialog);
    case ITEM_INSERT_FRAME:
        return InsertFrame(dialog);
    case ITEM_DELETE_FRAME:
        return DeleteFrame(dialog);
    case ITEM_SAVE_FRAME:
    case COMMIT_FRAME_COMMAND:
        return CommitFrame(dialog);
    case FRAME_LIST:
        return FrameSelectionChanged(dialog); // whatever the list tells
    case POSE_BUTTON:
        ChoosePose(instance, dialog);
        return 0;
    case WINK_CHECK:
        ToonSetDirty(dialog, 1);
        return 0;
    default:
        return 0; // meant: Enter and Escape too
    }
}

LRESULT FrameEditorProc(HWND dialog, UINT message, WPARAM wParam, LPARAM /*lParam*/) {
    switch (message) {
    case WM_INITDIALOG:
        CentreDialog(dialog);
        ToonFileSetup(dialog);
        return StartFrameEditor(dialog);
    case WM_CLOSE:
        ExitFrameEditor(dialog);
        return 0;
    case WM_COMMAND:
        return RunCommand(dialog, WindowInstance(dialog), LOWORD(static_cast<DWORD>(wParam)));
    default:
        return 0;
    }
}

static int FocusField(int field) {
    SetFocus(GetDlgItem(EditorDialog, field));
    return 1;
}

int FrameEditorAccelerator(HINSTANCE instance, int id) {
    switch (id) {
    case ITEM_CONFIGURE:
        ConfigureToon(instance, EditorDialog);
        return 1;
    case KEY_OPEN:
        OpenToonInEditor(EditorDialog);
        return 1;
    case KEY_LEAVE:
        ExitFrameEditor(EditorDialog);
        return 1;
    case KEY_SAVE:
        SaveToonCommand(EditorDialog);
        return 1;
    case KEY_TO_PAUSE:
        return FocusField(PAUSE_FIELD);
    case KEY_TO_LIST:
        return FocusField(FRAME_LIST);
    case KEY_TO_TEXT:
        return FocusField(TEXT_FIELD);
    case KEY_TO_X:
        return FocusField(X_FIELD);
    case KEY_TO_Y:
        return FocusField(Y_FIELD);
    default:
        return 0;
    }
}
