// Windows, messages, timers, painting, pointer and metrics.
//
// One thread, one queue. A window has one picture in memory: drawing changes it at once, and what
// changed reaches the screen when the message that drew has been handled, or before a loop waits;
// the first picture of a window without a border, when its procedure has painted it.
// Unless it says otherwise, an operation with a stale or foreign handle does nothing and gives 0.
#pragma once

#include "platform/gdi.h"
#include "platform/types.h"

// ---- Messages ----------------------------------------------------------------------------------

constexpr UINT WM_CREATE = 0x0001;
constexpr UINT WM_DESTROY = 0x0002;
constexpr UINT WM_MOVE = 0x0003;
constexpr UINT WM_SIZE = 0x0005;
constexpr UINT WM_ACTIVATE = 0x0006;
constexpr UINT WM_SETFOCUS = 0x0007;
constexpr UINT WM_KILLFOCUS = 0x0008;
constexpr UINT WM_SETTEXT = 0x000C;
constexpr UINT WM_PAINT = 0x000F;
constexpr UINT WM_CLOSE = 0x0010;
constexpr UINT WM_QUIT = 0x0012;
constexpr UINT WM_ERASEBKGND = 0x0014;
constexpr UINT WM_ENDSESSION = 0x0016; // sent before the system ends the process
constexpr UINT WM_SHOWWINDOW = 0x0018;
constexpr UINT WM_ACTIVATEAPP = 0x001C; // wParam 0: another program has the keyboard now
constexpr UINT WM_SETCURSOR = 0x0020;
constexpr UINT WM_HELP = 0x0053;
constexpr UINT WM_CONTEXTMENU = 0x007B;
constexpr UINT WM_NCHITTEST = 0x0084;     // lParam: a point of the screen; what lies there?
constexpr UINT WM_NCLBUTTONDOWN = 0x00A1; // wParam: what WM_NCHITTEST gave
constexpr UINT WM_KEYDOWN = 0x0100;
constexpr UINT WM_KEYUP = 0x0101;
constexpr UINT WM_SYSKEYDOWN = 0x0104;
constexpr UINT WM_SYSKEYUP = 0x0105;
constexpr UINT WM_COMMAND = 0x0111;
constexpr UINT WM_SYSCOMMAND = 0x0112;
constexpr UINT WM_TIMER = 0x0113;
constexpr UINT WM_MOUSEMOVE = 0x0200;
constexpr UINT WM_LBUTTONDOWN = 0x0201;
constexpr UINT WM_LBUTTONUP = 0x0202;
constexpr UINT WM_RBUTTONDOWN = 0x0204;
constexpr UINT WM_RBUTTONUP = 0x0205;
constexpr UINT WM_MBUTTONDOWN = 0x0207;
constexpr UINT WM_MBUTTONUP = 0x0208;
constexpr UINT WM_MOUSEWHEEL = 0x020A;

// What WM_SYSCOMMAND asks for.
constexpr WPARAM SC_NEXTWINDOW = 0xF040;
constexpr WPARAM SC_PREVWINDOW = 0xF050;
constexpr WPARAM SC_CLOSE = 0xF060;
constexpr WPARAM SC_SCREENSAVE = 0xF140;

// The answers to WM_NCHITTEST. The mouse's messages reach a window where it gives HTCLIENT.
constexpr LRESULT HTNOWHERE = 0; // nothing comes of it
constexpr LRESULT HTCLIENT = 1;
constexpr LRESULT HTCAPTION = 2; // the left button drags the window

// wParam of WM_ACTIVATE. Its high word is other than 0 for a minimised window.
constexpr WPARAM WA_INACTIVE = 0;
constexpr WPARAM WA_ACTIVE = 1;
constexpr WPARAM WA_CLICKACTIVE = 2;

struct MSG {
    HWND hwnd;
    UINT message;
    WPARAM wParam;
    LPARAM lParam;
    DWORD time; // milliseconds of the seam's clock
};

/// Waits for the next message of any window and takes it. In this order: posted, quit, input,
/// paint, timers. 0 for the quit message, whose wParam is the value given to PostQuitMessage; the
/// innermost running loop takes it. The filters must be null and 0.
BOOL GetMessageA(MSG* message, HWND window, UINT lowest, UINT highest);

constexpr UINT PM_NOREMOVE = 0;
constexpr UINT PM_REMOVE = 1;
constexpr UINT PM_NOYIELD = 2;

/// Looks for a message without waiting, of one window (null: any) and from lowest to highest (both
/// 0: any); takes it if PM_REMOVE stands. FALSE if there is none. The quit message is found
/// whatever the window.
BOOL PeekMessageA(MSG* message, HWND window, UINT lowest, UINT highest, UINT remove);

/// Stands in every loop; gives FALSE: text is typed into controls, which translate for themselves.
BOOL TranslateMessage(const MSG* message);

/// Hands the message to the window's procedure and gives its result; 0 if the window has gone, and
/// for a WM_COMMAND to a window that a dialog has disabled since: it came from what the user did
/// before.
LRESULT DispatchMessageA(const MSG* message);

/// Runs the window's procedure on this stack and gives its result.
LRESULT SendMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// Queues a message behind those that wait. A WM_CLOSE is not queued behind one that waits for the
/// same window; while a box is up it waits for the answer. To the window of another program only
/// WM_CLOSE, WM_HELP and WM_CONTEXTMENU are taken, and they do nothing there.
BOOL PostMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// Asks the innermost loop to end: GetMessageA gives 0 once the posted messages are through.
void PostQuitMessage(int exitCode);

void Sleep(DWORD milliseconds); ///< 0 only gives way

// ---- Windows -----------------------------------------------------------------------------------

using WNDPROC = LRESULT (*)(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

constexpr UINT CS_VREDRAW = 0x0001;
constexpr UINT CS_HREDRAW = 0x0002;
constexpr UINT CS_DBLCLKS = 0x0008;
constexpr UINT CS_OWNDC = 0x0020;

struct WNDCLASSA {
    UINT style;
    WNDPROC lpfnWndProc;
    int cbClsExtra;
    int cbWndExtra;
    HINSTANCE hInstance;
    HICON hIcon;
    HCURSOR hCursor;
    HBRUSH hbrBackground;
    const char* lpszMenuName;
    const char* lpszClassName;
};

/// Sets a class up under its name; 0 if the name is taken or empty. A class lasts as long as the
/// process.
WORD RegisterClassA(const WNDCLASSA* windowClass);

constexpr DWORD WS_POPUP = 0x80000000;
constexpr DWORD WS_CHILD = 0x40000000;
constexpr DWORD WS_VISIBLE = 0x10000000;
constexpr DWORD WS_CLIPSIBLINGS = 0x04000000;
constexpr DWORD WS_CLIPCHILDREN =
    0x02000000; // what is invalidated in it doesn't reach its children
constexpr DWORD WS_BORDER =
    0x00800000; // a black line round it; of a child of a native window: none
constexpr DWORD WS_DISABLED = 0x08000000; // of a child in another program's window: no input at all
constexpr DWORD WS_EX_TOPMOST = 0x00000008;

struct CREATESTRUCTA {
    void* lpCreateParams;
    HINSTANCE hInstance;
    HMENU hMenu;
    HWND hwndParent;
    int cy;
    int cx;
    int y;
    int x;
    LONG style;
    const char* lpszName;
    const char* lpszClass;
    DWORD dwExStyle;
};

/// Makes a window and runs its WM_CREATE, WM_SIZE and WM_MOVE before it returns, and shows it if
/// WS_VISIBLE stands. With WS_CHILD it lies in `parent`, a window of this program or, by its id,
/// of another. A top-level window with WS_BORDER gives a pixel on each side to that line, and can
/// hold children of the class "button", which are controls (platform/dialogs.h). A WS_EX_TOPMOST
/// window that fills the primary monitor goes on filling it when that changes, stays above windows
/// that appear later, and turns the other monitors black; input there is input to it. A child in
/// another program's window follows that window's size and closes when it goes. If it has
/// WS_DISABLED too, keys, mouse and pointer pass through it, as if it weren't there, to the window
/// that it lies in; on the desktop it lies below all other windows. Null if the class is unknown,
/// the parent is no window, WM_CREATE gave -1, or there is no display.
HWND CreateWindowExA(DWORD exStyle, const char* className, const char* title, DWORD style, int x,
                     int y, int width, int height, HWND parent, HMENU menu, HINSTANCE instance,
                     void* parameter);

/// Sends WM_DESTROY to the window and to what it owns, ends their timers and drops what is queued
/// for them.
BOOL DestroyWindow(HWND window);

/// The platform's own answer: WM_CLOSE destroys the window and so does WM_ENDSESSION, which the
/// signals that ask a process to end bring; the SC_CLOSE of WM_SYSCOMMAND sends WM_CLOSE. WM_PAINT
/// validates, WM_ERASEBKGND fills with the class's brush, WM_SETCURSOR sets the class's cursor over
/// the client area and else the arrow, WM_SETTEXT the title. WM_NCHITTEST is HTCLIENT, and
/// WM_NCLBUTTONDOWN on HTCAPTION lets the user drag a top-level window.
LRESULT DefWindowProcA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

BOOL IsWindow(HWND window);  ///< also true of a window of another program on the same display
BOOL IsIconic(HWND window);  ///< of a child: its top-level window's state
HWND GetParent(HWND window); ///< of a top-level window: its owner

/// The top-level window with this class and title, of this process or of another one of this
/// program that the same user runs on the same display; null if there is none.
HWND FindWindowA(const char* className, const char* title);

constexpr int SW_HIDE = 0;
constexpr int SW_SHOWNORMAL = 1;
constexpr int SW_MINIMIZE = 6; // nothing where no window manager could bring the window back
BOOL ShowWindow(HWND window, int command); ///< whether it was visible before

BOOL MoveWindow(HWND window, int x, int y, int width, int height, BOOL repaint);

constexpr HWND HWND_TOP{};
constexpr UINT SWP_NOSIZE = 0x0001;
constexpr UINT SWP_NOMOVE = 0x0002;
constexpr UINT SWP_NOZORDER = 0x0004;
BOOL SetWindowPos(HWND window, HWND after, int x, int y, int width, int height, UINT flags);

constexpr int GWL_HINSTANCE = -6;
LONG GetWindowLongA(HWND window, int index); ///< the instance as a number; 0 for any other index

/// The instance of a window, as GetWindowLongA gives it, with its type.
inline HINSTANCE WindowInstance(HWND window) {
    return HINSTANCE{static_cast<DWORD>(GetWindowLongA(window, GWL_HINSTANCE))};
}

constexpr int GCL_HCURSOR = -12;
DWORD SetClassLongA(HWND window, int index, LONG value); ///< the value before

/// Its place on the screen, for a window of the window manager's without the frame.
BOOL GetWindowRect(HWND window, RECT* place);

BOOL GetClientRect(HWND window, RECT* area); ///< left and top are 0; also of another's window

BOOL ScreenToClient(HWND window, POINT* point);     ///< from the screen's pixels to the window's
BOOL SetWindowTextA(HWND window, const char* text); ///< sends WM_SETTEXT

/// Says which window takes the keys that reach its top-level window; gives the one that had them,
/// null if none of this program.
HWND SetFocus(HWND window);

/// The window with the keyboard, of this program or another; null if there is none.
HWND GetForegroundWindow();

/// The window that all others lie in: the display's root window, or the one that a window manager
/// has put in its place. Null if there is no display.
HWND GetDesktopWindow();

/// Raises a top-level window and gives it the keyboard; also one that FindWindowA found in another
/// process of this program.
BOOL SetForegroundWindow(HWND window);

// ---- Painting ----------------------------------------------------------------------------------

struct PAINTSTRUCT {
    HDC hdc;
    BOOL fErase;
    RECT rcPaint;
};

/// A context clipped to the bounds of what is to be painted; the window counts as painted from
/// here on. WM_ERASEBKGND comes first if an erase was asked for. Of a stale window the context is
/// null, and nothing is to be painted. EndPaint ends the context, also that of a window that has
/// gone meanwhile, and gives TRUE.
HDC BeginPaint(HWND window, PAINTSTRUCT* paint);
BOOL EndPaint(HWND window, const PAINTSTRUCT* paint);

/// Adds a rectangle (null: all) to what WM_PAINT has to paint.
BOOL InvalidateRect(HWND window, const RECT* area, BOOL erase);
BOOL UpdateWindow(HWND window); ///< paints now what has to be painted

HDC GetDC(HWND window);             ///< draws at once; its state is a fresh one each time
int ReleaseDC(HWND window, HDC dc); ///< 1; 0 if there is no such context. The window may have gone

// ---- Timers ------------------------------------------------------------------------------------

using TIMERPROC = void (*)(HWND window, UINT message, UINT_PTR timer, DWORD time);

/// Starts a timer of the window that repeats until it is killed, or starts it anew; it arrives as
/// WM_TIMER with its id as wParam, through the loop. 1 to 0x7FFFFFFF ms; less counts as 1. With
/// equal due times the timer set first comes first; one that is late comes once. 0 on failure.
/// `procedure` must be null.
UINT_PTR SetTimer(HWND window, UINT_PTR timer, UINT milliseconds, TIMERPROC procedure);
BOOL KillTimer(HWND window, UINT_PTR timer); ///< TRUE if it ran; a tick that waits is dropped

// ---- Pointer, screen, boxes --------------------------------------------------------------------

constexpr ResourceName IDC_ARROW{32512};
constexpr ResourceName IDC_WAIT{32514};
HCURSOR LoadCursorA(HINSTANCE instance, ResourceName name); ///< null instance: the system's own
BOOL DestroyCursor(HCURSOR cursor); ///< TRUE if there is such a cursor; it lasts with the program
constexpr ResourceName IDI_APPLICATION{32512};
HICON LoadIconA(HINSTANCE instance, ResourceName name); ///< of the program; null if none
HCURSOR SetCursor(HCURSOR cursor);                      ///< null: none; gives the one before
int ShowCursor(BOOL show); ///< the display count after it; the pointer shows from 0 up
BOOL GetCursorPos(POINT* point);
/// A window of this program that has that place gets a WM_MOUSEMOVE, and so sets its cursor anew.
BOOL SetCursorPos(int x, int y);

/// Keeps the pointer within a part of the screen, until it is called with null. Meanwhile no other
/// program can hold it. FALSE if the pointer isn't kept yet: while another program holds it, until
/// a window of this one sees it move after that; or off X11, where it never is. It is free again
/// when the program ends, however it does.
BOOL ClipCursor(const RECT* area);

constexpr int SM_CXSCREEN = 0; // of the primary monitor, in pixels
constexpr int SM_CYSCREEN = 1;
constexpr int SM_CXBORDER = 5; // of the line that WS_BORDER draws
constexpr int SM_CYBORDER = 6;
int GetSystemMetrics(int index); ///< 0 for any other index

char* CharLowerA(char* text); ///< A to Z become a to z, in place; gives the text
BOOL MessageBeep(UINT type);

constexpr UINT MB_OK = 0x00;
constexpr UINT MB_YESNOCANCEL = 0x03;
constexpr UINT MB_ICONHAND = 0x10;
constexpr UINT MB_ICONEXCLAMATION = 0x30;
constexpr int IDOK = 1;
constexpr int IDCANCEL = 2;
constexpr int IDYES = 6;
constexpr int IDNO = 7;

/// Shows a box over `owner` and waits for its answer; the owner takes no input meanwhile, timers
/// and paints go on, and the pointer shows. A null caption is the platform's "Error". Bytes that
/// are valid UTF-8, as in names of files, are shown as that. 0 if it can't be shown. Over a child
/// in another program's window none is shown, for nobody could answer it: its text goes to stderr,
/// and it is cancelled.
int MessageBoxA(HWND owner, const char* text, const char* caption, UINT type);

/// Runs `body` and gives its result; on an exception that nobody caught runs `handler` and gives
/// its result.
int RunGuarded(int (*body)(), int (*handler)());
