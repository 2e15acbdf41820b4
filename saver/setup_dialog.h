// The setup dialog.
#pragma once

#include "platform/user.h"

/// The procedure of the setup dialog. The resources hold no setup dialog yet, so that none is made
/// and nothing comes here.
LRESULT SetupDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);
