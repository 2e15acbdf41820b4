// What the seam offers by name to the saver's window: its input context, and the device that is
// told of passwords.
#include "platform/user/grabs.h"
#include "tests/user/test_window.h"

#include <QInputMethodQueryEvent>

namespace {

/// What an input method is told before it takes a key of the test's window.
bool inputMethodWelcome() {
    QInputMethodQueryEvent query(Qt::ImEnabled);
    for (QWindow* window : QGuiApplication::topLevelWindows()) {
        QCoreApplication::sendEvent(window, &query);
    }
    return query.value(Qt::ImEnabled).toBool();
}

TEST(InputContext, DecidesWhetherAnInputMethodTakesTheKeys) {
    test::handlers.clear();
    auto* const associate = reinterpret_cast<HIMC (*)(HWND, HIMC)>(
        GetProcAddress(GetModuleHandleA("imm32.dll"), "ImmAssociateContext"));
    ASSERT_NE(associate, nullptr);
    const HWND window = test::makeWindow();
    EXPECT_TRUE(inputMethodWelcome());

    const HIMC before = associate(window, nullptr);
    EXPECT_TRUE(before);
    EXPECT_FALSE(inputMethodWelcome());
    EXPECT_FALSE(associate(window, nullptr)) << "it has been taken off already";
    EXPECT_FALSE(associate(window, HIMC{77})) << "no context";
    EXPECT_FALSE(inputMethodWelcome());

    EXPECT_FALSE(associate(window, before));
    EXPECT_TRUE(inputMethodWelcome());
    EXPECT_EQ(associate(window, before), before);
    DestroyWindow(window);
    EXPECT_FALSE(associate(window, before));
}

TEST(RebootDevice, HoldsTheInputWhileAPasswordStands) {
    const std::tuple<DWORD, BOOL, bool> calls[] = {
        {1, TRUE, true}, {3, FALSE, true}, {2, TRUE, false}, {0, FALSE, false}};

    const HANDLE device =
        CreateFileA("\\\\.\\REBOOT", GENERIC_READ | GENERIC_WRITE,
                    FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr, OPEN_EXISTING, 0, nullptr);
    for (const auto& [code, taken, held] : calls) {
        EXPECT_EQ(DeviceIoControl(device, code, nullptr, 0, nullptr, 0, nullptr, nullptr), taken);
        EXPECT_EQ(seam::inputIsHeld(), held) << code;
    }
    EXPECT_TRUE(CloseHandle(device));
}

} // namespace
