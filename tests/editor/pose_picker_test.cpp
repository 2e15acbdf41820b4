// The pose picker: what is chosen by mouse and keys, and how its window goes.
#include "tests/editor/frame_fixture.h"

#include "editor/pose_picker.h"

namespace {

HWND picker() {
    return FindWindowA("PoseWndClass", nullptr);
}

bool pickerStands() {
    return picker() != HWND{};
}

/// At a point of its client area, which lies behind its border.
void mouse(QEvent::Type type, int x, int y) {
    sendMouse(picker(), type, QPoint(x + 1, y + 1));
}

void sendKey(int code) {
    SendMessageA(picker(), WM_KEYDOWN, static_cast<WPARAM>(code), 0);
}

/// The numbers of the cells that are drawn as pressed, from 1.
std::string sunkenCells() {
    constexpr DWORD shadow = 0x808080;
    const seam::Picture picture = seam::windowPicture(picker());
    std::string sunken;
    for (int i = 0; i < 8; ++i) {
        const int left = 5 + i % 4 * 140;
        const int top = i < 4 ? 5 : 146;
        const auto at = static_cast<std::size_t>((top + 60) * picture.width + left);
        sunken += picture.pixels.at(at) == shadow ? std::to_string(i + 1) : "";
    }
    return sunken;
}

class Picker : public FrameEditorTest {
  protected:
    void SetUp() override {
        FrameEditorTest::SetUp();
        edit("two.zkt");
    }

    /// Opens it by the button with a pose, and acts once it stands. Gives the pose that the button
    /// then shows; the Toon has changed whatever came of it.
    static std::string pick(LONG current, const std::function<void()>& act) {
        EditPose = current;
        ToonSetDirty(EditorDialog, 0);
        once(pickerStands, act);
        PostMessageA(EditorDialog, WM_COMMAND, POSE_BUTTON, 0);
        pass(0);
        EXPECT_FALSE(pickerStands());
        EXPECT_FALSE(saveIsGrey());
        const std::string label = shown(POSE_BUTTON);
        EXPECT_EQ(label, "Frame P&ose = " + std::to_string(EditPose + 1));
        return label.substr(14);
    }
};

TEST_F(Picker, StandsInTheMiddleWithTheCurrentPosePressed) {
    for (const auto& [current, pressed] : {std::pair(2, "3"), {-4, "1"}, {99, "8"}}) {
        const std::string taken = pick(current, [pressed = pressed] {
            RECT place{};
            GetWindowRect(picker(), &place);
            EXPECT_EQ(joined({place.left, place.top, place.right, place.bottom}),
                      "115,255,685,545");
            EXPECT_EQ(sunkenCells(), pressed);
            PostMessageA(picker(), WM_CLOSE, 0, 0);
        });
        EXPECT_EQ(taken, pressed) << "closed without a choice";
    }
}

TEST_F(Picker, APressChoosesAndAReleaseAnywhereCloses) {
    const std::tuple<int, int, const char*> cases[] = {
        {5, 5, "1"},     {142, 142, "1"}, {143, 5, ""}, // beside all cells: the first pose
        {145, 5, "2"},   {282, 142, "2"}, {283, 142, ""},  {282, 143, ""},
        {562, 5, "4"},   {563, 5, ""},    {5, 145, ""},    {145, 146, "6"},
        {145, 283, "6"}, {145, 284, ""},  {562, 283, "8"},
    };
    for (const auto& [x, y, pressed] : cases) {
        const std::string taken = pick(6, [x = x, y = y, pressed = pressed] {
            mouse(QEvent::MouseButtonPress, x, y);
            once([] { return sunkenCells() != "7"; },
                 [pressed] {
                     EXPECT_EQ(sunkenCells(), pressed);
                     mouse(QEvent::MouseButtonRelease, 300, 200);
                 });
        });
        EXPECT_EQ(taken, *pressed == '\0' ? "1" : pressed) << x << ' ' << y;
    }
    EXPECT_EQ(pick(4, [] { SendMessageA(picker(), WM_LBUTTONUP, 0, 0); }), "5") << "no press";
}

TEST_F(Picker, TheDigitsOneToEightChooseAndOtherKeysDoNothing) {
    for (int number = 1; number <= 8; ++number) {
        EXPECT_EQ(pick(2, [number] { sendKey('0' + number); }), std::to_string(number));
    }
    const std::string taken = pick(2, [] {
        EXPECT_EQ(RunPosePicker(GetModuleHandleA(nullptr), EditorDialog, 5), 5)
            << "there is one at a time";
        constexpr int numericPad = 0x60;
        for (const int other : {int{'0'}, int{'9'}, int{'A'}, 0x1B, 0x0D, numericPad + 1}) {
            sendKey(other);
            EXPECT_TRUE(pickerStands()) << other;
        }
        PostMessageA(picker(), WM_CLOSE, 0, 0);
    });
    EXPECT_EQ(taken, "3");
}

TEST_F(Picker, GoesWithItsOwnersAndLeavesNoQuitBehind) {
    for (HWND* owner : {&EditorDialog, &EditorMainWindow}) {
        edit("two.zkt");
        once(pickerStands, [owner] { PostMessageA(*owner, WM_CLOSE, 0, 0); });
        command(POSE_BUTTON);
        EXPECT_FALSE(pickerStands());
        EXPECT_FALSE(EditorDialog);
        MSG message{};
        EXPECT_EQ(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE), FALSE);
    }
}

TEST_F(Picker, LeavesTheListOfFramesToTheUser) {
    struct Case {
        int frame;
        WORD code;
        const char* x; // that is shown then
    };

    const Case cases[] = {{0, CBN_SETFOCUS, "111"},  {0, CBN_KILLFOCUS, "111"},
                          {0, CBN_SELCHANGE, "111"}, {1, CBN_DROPDOWN, "300"},
                          {1, CBN_SELCHANGE, "300"}, {1, CBN_CLOSEUP, "300"}};
    for (const auto& [index, code, x] : cases) {
        edit("two.zkt");
        type(X_FIELD, "111");
        const std::string taken = pick(6, [index = index, code = code] {
            SelectListedFrame(EditorDialog, index);
            const auto told = static_cast<WPARAM>(MAKELONG(FRAME_LIST, code));
            const MSG message{EditorDialog, WM_COMMAND, told, 0, 0};
            DispatchMessageA(&message);
            sendKey('4');
        });
        EXPECT_EQ(taken, "4") << index << ' ' << code;
        EXPECT_EQ(shown(X_FIELD), x) << index << ' ' << code;
        EXPECT_EQ(joined({frame(0).pose, frame(1).pose}), "1,2") << "nothing is committed";
    }
}

} // namespace
