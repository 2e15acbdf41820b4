// The editor with its frame editor open, and a user who types in its fields.
#pragma once

#include "tests/editor/editor_fixture.h"

#include "editor/frame_editor.h"
#include "editor/frame_fields.h"
#include "platform/menus.h"

#include <QComboBox>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTest>

#include <fstream>

class FrameEditorTest : public EditorTest {
  protected:
    static constexpr int COMMIT = 1012;

    /// An editor at rest, a Toon in it, "" for none, and the frame editor over it.
    void edit(const std::string& toon) {
        close();
        openAtRest();
        if (!toon.empty()) {
            openToon(toon);
        }
        key(KEY_EDIT);
        ASSERT_TRUE(EditorDialog);
        filesAsked = 0;
        boxes.clear();
    }

    static void command(int id) {
        PostMessageA(EditorDialog, WM_COMMAND, static_cast<WPARAM>(id), 0);
        pass(0);
    }

    static QWidget& field(int id) {
        return widgetOf(GetDlgItem(EditorDialog, id));
    }

    /// In place of what stands there, a line break by Enter.
    static void type(int id, const std::string& text) {
        QWidget& target = field(id);
        QTest::keyClick(&target, Qt::Key_A, Qt::ControlModifier);
        QTest::keyClick(&target, Qt::Key_Delete);
        for (const char letter : text) {
            letter == '\n' ? QTest::keyClick(&target, Qt::Key_Return)
                           : QTest::keyClick(&target, letter);
        }
        pass(0);
    }

    static std::string textOf(HWND dialog, int id) {
        char text[200];
        GetDlgItemTextA(dialog, id, text, sizeof text);
        return text;
    }

    static std::string shown(int id) {
        return textOf(EditorDialog, id);
    }

    /// "x,y,pause text pose", and whether he winks.
    static std::string fields() {
        return shown(X_FIELD) + ',' + shown(Y_FIELD) + ',' + shown(PAUSE_FIELD) + ' ' +
               shown(TEXT_FIELD) + ' ' + shown(POSE_BUTTON) +
               (IsDlgButtonChecked(EditorDialog, WINK_CHECK) != 0 ? " winks" : "");
    }

    /// The Toon's name in it.
    static std::string title() {
        const std::string all = widgetOf(EditorDialog).windowTitle().toStdString();
        EXPECT_TRUE(all.starts_with("File: [") && all.ends_with("]")) << all;
        return all.substr(7, all.size() - 8);
    }

    static bool saveIsGrey() {
        const HMENU menu = GetMenu(EditorDialog);
        const BOOL before = EnableMenuItem(menu, ITEM_SAVE, MF_GRAYED);
        EnableMenuItem(menu, ITEM_SAVE, static_cast<UINT>(before));
        return before == MF_GRAYED;
    }

    static ToonFrame frame(LONG index) {
        ToonFrame found{};
        EXPECT_EQ(FrameGet(index, &found), 1) << index;
        return found;
    }

    /// Where the frames in memory stand, by their x.
    static std::vector<LONG> places() {
        std::vector<LONG> found;
        for (LONG i = 0; i < FrameCount; ++i) {
            found.push_back(frame(i).x);
        }
        return found;
    }

    static std::string joined(const std::vector<LONG>& numbers) {
        std::string text;
        for (const LONG number : numbers) {
            text += (text.empty() ? "" : ",") + std::to_string(number);
        }
        return text;
    }

    static std::vector<LONG> placesInFile(const std::string& name) {
        std::ifstream in(name, std::ios::binary);
        in.ignore(sizeof(ToonHeader));
        std::vector<LONG> found;
        for (ToonFrame one{}; in.read(reinterpret_cast<char*>(&one), sizeof one);) {
            found.push_back(one.x);
        }
        return found;
    }

    /// A Toon of so many frames, whose places are their numbers.
    void editFrames(LONG count) {
        std::vector<ToonFrame> frames(static_cast<std::size_t>(count));
        for (LONG i = 0; i < count; ++i) {
            frames[static_cast<std::size_t>(i)] = {i + 1, 1, 1, 1, 1, "text", 0};
        }
        putToon("long.zkt", frames);
        edit("long.zkt");
    }

    static void select(LONG index) {
        SelectListedFrame(EditorDialog, index);
        command(FRAME_LIST); // as any notification of the list
    }

    /// What always holds while it is open.
    static void expectInOrder(const std::string& when) {
        const auto& list = static_cast<const QComboBox&>(field(FRAME_LIST));
        EXPECT_EQ(list.count(), FrameCount) << when;
        EXPECT_EQ(list.itemText(list.count() - 1).toInt(), FrameCount) << when;
        EXPECT_EQ(FrameListSelection(EditorDialog), CurrentFrameIndex) << when;
        ToonFrame current = frame(CurrentFrameIndex);
        EXPECT_EQ(FramePut(FrameCount, &current), 0) << when << ": the store has more frames";
        EXPECT_EQ(saveIsGrey(), ToonDirty == 0) << when;
        EXPECT_EQ(shown(POSE_BUTTON), "Frame P&ose = " + std::to_string(EditPose + 1)) << when;
    }
};
