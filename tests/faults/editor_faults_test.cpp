// The writing of a Toon where disk or memory fail.
#include "tests/editor/frame_fixture.h"
#include "tests/faults/each_fault.h"

namespace {

using seam::Fault;
using seam::Operation;

class EditorFaults : public FrameEditorTest {
  protected:
    /// A Toon whose second frame has been changed in the fields and not yet saved.
    void change() {
        putToons();
        edit("two.zkt");
        select(1);
        type(X_FIELD, "333");
        command(COMMIT);
        ASSERT_EQ(joined(places()), "200,333");
        ASSERT_EQ(ToonDirty, 1U);
    }
};

TEST_F(EditorFaults, ASaveThatFailsIsToldAndCanBeDoneAgain) {
    const std::pair<Operation, Outcomes> cases[] = {
        {Operation::open, {"saved", "Cannot write to two.zkt."}},
        {Operation::write, {"saved", "Error writing to two.zkt."}},
        {Operation::change, {"saved", "Cannot write to two.zkt."}},
    };
    for (const auto& [operation, outcomes] : cases) {
        const auto save = [this](const ChosenFault& fault) {
            change();
            fault.begin();
            command(ITEM_SAVE);
            seam::endFaults();
            EXPECT_LE(boxes.size(), 1U);
            const std::string told = boxes.empty() ? "saved" : boxes[0];
            EXPECT_EQ(ToonDirty, boxes.size());
            EXPECT_EQ(saveIsGrey(), boxes.empty());
            EXPECT_EQ(joined(places()), "200,333");
            command(ITEM_SAVE);
            EXPECT_EQ(joined(placesInFile("two.zkt")), "200,333");
            return told;
        };
        EXPECT_EQ(
            eachFault(operation, {Fault::error, Fault::lessened, Fault::cut, Fault::onwards}, save),
            outcomes)
            << static_cast<int>(operation);
    }
}

TEST_F(EditorFaults, FramesAreThereOrNotWhereMemoryIsShort) {
    const std::tuple<int, const char*, Outcomes> cases[] = {
        {ITEM_NEW_FRAME, "new", {"200,333,0", "200,333"}},
        {ITEM_INSERT_FRAME, "insert", {"200,0,333", "200,333"}},
        {ITEM_DELETE_FRAME, "delete", {"200"}},
    };
    for (const auto& [item, what, outcomes] : cases) {
        const auto run = [this, item = item](const ChosenFault& fault) {
            change();
            fault.begin();
            command(item);
            seam::endFaults();
            EXPECT_TRUE(boxes.empty());
            EXPECT_EQ(static_cast<const QComboBox&>(field(FRAME_LIST)).count(), FrameCount);
            return joined(places());
        };
        EXPECT_EQ(eachFault(Operation::block, {Fault::error, Fault::onwards}, run), outcomes)
            << what;
    }
}

TEST_F(EditorFaults, WhatIsWrittenFromTheFirstWindowOnIsOldOrNew) {
    const std::pair<Operation, Outcomes> cases[] = {
        {Operation::picture, {"200,300,375"}},
        {Operation::block, {"200,300", "200,300,375", "Not enough memory. 200,300"}},
    };
    for (const auto& [operation, outcomes] : cases) {
        const auto write = [this](const ChosenFault& fault) {
            close();
            putToons();
            boxes.clear();
            const seam::HandleCounts handles = seam::liveHandles();
            fault.begin();
            openAtRest();
            openToon("two.zkt");
            key(KEY_EDIT);
            if (EditorDialog && boxes.empty()) {
                for (const int item : {ITEM_NEW_FRAME, COMMIT, ITEM_SAVE}) {
                    command(item);
                }
            }
            seam::endFaults();
            close();
            EXPECT_EQ(seam::liveHandles(), handles);
            EXPECT_LE(boxes.size(), 1U);
            return (boxes.empty() ? "" : boxes[0] + " ") + joined(placesInFile("two.zkt"));
        };
        EXPECT_EQ(eachFault(operation, {Fault::error}, write), outcomes)
            << static_cast<int>(operation);
    }
}

} // namespace
