// The controls of a dialog, by their ids.
#include "platform/dialogs.h"
#include "platform/kernel/text.h"
#include "platform/user/controls/control.h"
#include "platform/user/dialog.h"
#include "platform/user/native_window.h"
#include "platform/user/window.h"

#include <charconv>
#include <cstdio>

using namespace seam;

static Window* findItem(HWND dialog, int id) {
    return findWindow(GetDlgItem(dialog, id));
}

HWND GetDlgItem(HWND dialog, int id) {
    HWND result;
    forEachWindow([&](const Window& window) {
        if (!result && window.parent == dialog && window.control && window.id == id) {
            result = window.handle;
        }
    });
    return result;
}

LRESULT SendDlgItemMessageA(HWND dialog, int id, UINT message, WPARAM wParam, LPARAM lParam) {
    return SendMessageA(GetDlgItem(dialog, id), message, wParam, lParam);
}

BOOL SetDlgItemTextA(HWND dialog, int id, const char* text) {
    return SendDlgItemMessageA(dialog, id, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(text)) != 0
               ? TRUE
               : FALSE;
}

UINT GetDlgItemTextA(HWND dialog, int id, char* buffer, int size) {
    const Window* item = findItem(dialog, id);
    if (size <= 0) {
        return 0;
    }
    const std::string text = item == nullptr ? std::string() : item->control->text();
    copyCut(text, buffer, static_cast<std::size_t>(size));
    return static_cast<UINT>(std::min(text.size(), static_cast<std::size_t>(size) - 1));
}

BOOL SetDlgItemInt(HWND dialog, int id, UINT value, BOOL isSigned) {
    const std::string text =
        isSigned != FALSE ? std::to_string(static_cast<int>(value)) : std::to_string(value);
    return SetDlgItemTextA(dialog, id, text.c_str());
}

/// The digits at the start of a text as a number; nothing if there are none or too many.
static std::optional<std::int64_t> leadingNumber(std::string_view text, bool isSigned) {
    text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    const bool minus = isSigned && text.starts_with('-');
    if (minus || text.starts_with('+')) {
        text.remove_prefix(1);
    }
    UINT value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    const std::int64_t number = minus ? -std::int64_t{value} : std::int64_t{value};
    const bool fits = !isSigned || (number >= INT32_MIN && number <= INT32_MAX);
    return error == std::errc() && fits ? std::optional(number) : std::nullopt;
}

UINT GetDlgItemInt(HWND dialog, int id, BOOL* read, BOOL isSigned) {
    const Window* item = findItem(dialog, id);
    const auto number =
        item == nullptr ? std::nullopt : leadingNumber(item->control->text(), isSigned != FALSE);
    if (read != nullptr) {
        *read = number ? TRUE : FALSE;
    }
    return static_cast<UINT>(number.value_or(0));
}

BOOL CheckDlgButton(HWND dialog, int id, UINT check) {
    Window* item = findItem(dialog, id);
    if (item == nullptr) {
        return FALSE;
    }
    item->control->check(check != 0);
    return TRUE;
}

UINT IsDlgButtonChecked(HWND dialog, int id) {
    const Window* item = findItem(dialog, id);
    return item != nullptr && item->control->checked() ? 1 : 0;
}

BOOL EnableWindow(HWND window, BOOL enable) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    const bool before = found->enabled;
    found->enabled = enable != FALSE;
    if (found->control) {
        found->control->widget().setEnabled(found->enabled);
    }
    return before ? FALSE : TRUE;
}

BOOL IsWindowEnabled(HWND window) {
    const Window* found = findWindow(window);
    return found != nullptr && found->enabled ? TRUE : FALSE;
}
