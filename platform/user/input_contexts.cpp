#include "platform/user/input_contexts.h"

#include "platform/kernel/modules.h"
#include "platform/user/window.h"

#include <QGuiApplication>
#include <QInputMethod>
#include <QInputMethodQueryEvent>

namespace seam {

namespace {

/// Gives the window this context, or none, and returns the one that it had: null for a window that
/// isn't ours. There is but one context; any other is refused, and the window keeps its own.
HIMC ImmAssociateContext(HWND handle, HIMC context) {
    Window* window = findWindow(handle);
    if (window == nullptr || (context && context != defaultInputContext)) {
        return nullptr;
    }
    const HIMC before = window->inputContext;
    window->inputContext = context;
    if (before != context) {
        QGuiApplication::inputMethod()->update(Qt::ImEnabled);
    }
    return before;
}

const ModuleRegistration
    imm("IMM32.DLL", {"ImmAssociateContext", reinterpret_cast<FARPROC>(ImmAssociateContext)},
        ModuleRegistration::Kind::resident);

} // namespace

void answerInputMethod(HWND window, QInputMethodQueryEvent& query) {
    const Window* found = findWindow(keyTarget(window));
    if ((query.queries() & Qt::ImEnabled) != 0) {
        query.setValue(Qt::ImEnabled, found != nullptr && static_cast<bool>(found->inputContext));
    }
    query.accept();
}

} // namespace seam
