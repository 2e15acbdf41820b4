// The basic types of the platform: fixed-size numbers, handles, points and rectangles.
#pragma once

#include <cstddef>
#include <cstdint>

using BOOL = int;
using BYTE = std::uint8_t;
using WORD = std::uint16_t;
using DWORD = std::uint32_t;
using UINT = std::uint32_t;
using LONG = std::int32_t;
using COLORREF = DWORD; // 0x00bbggrr
using WPARAM = std::uintptr_t;
using LPARAM = std::intptr_t;
using LRESULT = std::intptr_t;
using UINT_PTR = std::uintptr_t;

constexpr BOOL FALSE = 0;
constexpr BOOL TRUE = 1;
constexpr int MAX_PATH = 260;

/// An opaque number that names an object of the seam; 0 names nothing. It carries the kind of the
/// object and a generation, so that a stale or foreign handle is refused and never followed.
template <class Kind>
struct Handle {
    DWORD number = 0;

    constexpr Handle() = default;

    constexpr Handle(std::nullptr_t) {}

    constexpr explicit Handle(DWORD value) : number(value) {}

    constexpr explicit operator bool() const {
        return number != 0;
    }

    friend constexpr bool operator==(Handle, Handle) = default;
};

/// A window. A number with its top three bits clear is the id of a window of another program on
/// the same display (X11 hands out no id above 0x1FFFFFFF); our own always have the top bit set.
using HWND = Handle<struct WindowKind>;
using HDC = Handle<struct DeviceContextKind>;
using HINSTANCE = Handle<struct ModuleKind>;
using HMODULE = HINSTANCE;
using HGLOBAL = Handle<struct MemoryKind>;
using HFILE = Handle<struct FileKind>;
using HRSRC = Handle<struct ResourceKind>;
using HCURSOR = Handle<struct CursorKind>;
using HICON = Handle<struct IconKind>;
using HMENU = Handle<struct MenuKind>;
using HPALETTE = Handle<struct PaletteKind>;
using HIMC = Handle<struct InputContextKind>;

/// What SelectObject and DeleteObject take: any of the four kinds below.
using HGDIOBJ = Handle<struct GdiKind>;

template <class Kind>
struct GdiHandle : HGDIOBJ {
    constexpr GdiHandle() = default;

    constexpr GdiHandle(std::nullptr_t) {}

    constexpr explicit GdiHandle(HGDIOBJ object) : HGDIOBJ(object) {}
};

using HBITMAP = GdiHandle<struct BitmapKind>;
using HPEN = GdiHandle<struct PenKind>;
using HBRUSH = GdiHandle<struct BrushKind>;
using HFONT = GdiHandle<struct FontKind>;

struct POINT {
    LONG x;
    LONG y;
};

struct SIZE {
    LONG cx;
    LONG cy;
};

/// right and bottom lie one past the last pixel.
struct RECT {
    LONG left;
    LONG top;
    LONG right;
    LONG bottom;
};

constexpr WORD LOWORD(DWORD value) {
    return static_cast<WORD>(value);
}

constexpr WORD HIWORD(DWORD value) {
    return static_cast<WORD>(value >> 16);
}

constexpr DWORD MAKELONG(LONG low, LONG high) {
    return static_cast<WORD>(low) | (static_cast<DWORD>(static_cast<WORD>(high)) << 16);
}

/// Names a resource, a resource type, a cursor or an icon: by a text, matched whatever its case,
/// or by a number from 1 to 65535.
struct ResourceName {
    const char* text = nullptr;
    WORD number = 0;

    constexpr ResourceName(const char* name) : text(name) {}

    constexpr ResourceName(int id) : number(static_cast<WORD>(id)) {}
};
