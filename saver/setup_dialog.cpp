#include "saver/setup_dialog.h"

LRESULT SetupDialogProc(HWND /*dialog*/, UINT /*message*/, WPARAM /*wParam*/, LPARAM /*lParam*/) {
    return FALSE;
}
