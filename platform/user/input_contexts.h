// Input contexts: whether an input method may take the keys of a window.
#pragma once

#include "platform/types.h"

class QInputMethodQueryEvent;

namespace seam {

/// The one that every window of ours starts with.
constexpr HIMC defaultInputContext{1};

/// Tells the toolkit whether an input method may take the keys that reach this window.
void answerInputMethod(HWND window, QInputMethodQueryEvent& query);

} // namespace seam
