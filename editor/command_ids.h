// The numbers by which the editor's keys, menus and controls send their commands. They are those of
// the resources: accelerators/buttons.txt and dialogs/framedit.txt.
#pragma once

// Keys of the main window, while the frame editor is closed.
constexpr int KEY_FILE = 122;
constexpr int KEY_PLAY = 123;
constexpr int KEY_CONTINUE = 124;
constexpr int KEY_STOP = 125;
constexpr int KEY_OPEN = 126;
constexpr int KEY_EDIT = 127;
constexpr int KEY_WALK = 135;

// The same keys, and more of the table, while it is open. Ctrl+G has its menu item's number.
constexpr int KEY_TO_PAUSE = KEY_STOP;
constexpr int KEY_LEAVE = KEY_EDIT;
constexpr int KEY_TO_LIST = 128;
constexpr int KEY_TO_TEXT = 129;
constexpr int KEY_TO_X = 130;
constexpr int KEY_TO_Y = 131;
constexpr int KEY_SAVE = 134;

// The menu of the File button.
constexpr int POPUP_OPEN = 5000;
constexpr int POPUP_EDIT = 5001;
constexpr int POPUP_PLAY = 5002;
constexpr int POPUP_ABOUT = 5003;
constexpr int POPUP_EXIT = 5004;

// The frame editor's menu.
constexpr int ITEM_NEW = 104;
constexpr int ITEM_OPEN = 105;
constexpr int ITEM_SAVE_AS = 106;
constexpr int ITEM_CONFIGURE = 108;
constexpr int ITEM_EXIT = 109;
constexpr int ITEM_NEW_FRAME = 110;
constexpr int ITEM_INSERT_FRAME = 111;
constexpr int ITEM_DELETE_FRAME = 112;
constexpr int ITEM_SAVE = 113;
constexpr int ITEM_SAVE_FRAME = 114;

// Its controls. That of its Save button, COMMIT_FRAME_COMMAND, stands in toon/toon_prompts.h.
constexpr int NEW_FRAME_BUTTON = 1015;
constexpr int FRAME_LIST = 1016;
constexpr int TEXT_FIELD = 1017;
constexpr int X_FIELD = 1018;
constexpr int Y_FIELD = 1019;
constexpr int PAUSE_FIELD = 1020;
constexpr int POSE_BUTTON = 1021;
constexpr int WINK_CHECK = 1046;
