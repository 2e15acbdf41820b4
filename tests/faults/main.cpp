// The first picture of a process is one of the seam's own: it too may be refused its memory.
#include "platform/gdi.h"
#include "platform/harness.h"

#include <gmock/gmock.h>

TEST(FirstPicture, IsThereWithoutMemory) {
    // Done in main, before anything else has asked for one.
    EXPECT_TRUE(GetStockObject(BLACK_PEN));
    const HDC dc = CreateCompatibleDC(nullptr);
    EXPECT_TRUE(BitBlt(dc, 0, 0, 1, 1, dc, 0, 0, SRCCOPY));
    DeleteDC(dc);
}

int main(int argc, char** argv) {
    testing::InitGoogleMock(&argc, argv);
    seam::makeFault(seam::Operation::picture, 1);
    GetStockObject(BLACK_PEN);
    seam::endFaults();
    return RUN_ALL_TESTS();
}
