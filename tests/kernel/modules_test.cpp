// Modules and devices of the seam, with some of the test's own.
#include "platform/harness.h"
#include "platform/kernel/modules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

namespace {

using seam::DeviceRegistration;
using seam::ModuleRegistration;
using Kind = ModuleRegistration::Kind;

void entry() {}

seam::HandleCounts live() {
    seam::HandleCounts counts;
    seam::countKernelHandles(counts);
    return counts;
}

TEST(Modules, AreInTheProcessAsLongAsSomebodyHasThemLoaded) {
    const ModuleRegistration resident("TESTIMM.DLL", {"Entry", entry}, Kind::resident);
    const ModuleRegistration loadable("TEST.CPL", {"Entry", entry}, Kind::loadable);
    const seam::HandleCounts before = live();

    EXPECT_TRUE(GetModuleHandleA("testimm.dll"));
    EXPECT_EQ(GetProcAddress(GetModuleHandleA("testimm.dll"), "Entry"), entry);
    EXPECT_FALSE(GetModuleHandleA("TEST.CPL"));
    EXPECT_EQ(GetProcAddress(loadable.handle, "Entry"), nullptr);

    const HMODULE module = LoadLibraryA("Test.cpl");
    EXPECT_EQ(LoadLibraryA("TEST.CPL"), module);
    EXPECT_EQ(GetModuleHandleA("test.CPL"), module);
    EXPECT_EQ(GetProcAddress(module, "Entry"), entry);
    EXPECT_EQ(GetProcAddress(module, "entry"), nullptr);
    EXPECT_EQ(GetProcAddress(module, nullptr), nullptr);
    EXPECT_EQ(live().modules, before.modules + 2);

    EXPECT_TRUE(FreeLibrary(module));
    EXPECT_TRUE(GetModuleHandleA("TEST.CPL"));
    EXPECT_TRUE(FreeLibrary(module));
    EXPECT_FALSE(GetModuleHandleA("TEST.CPL"));
    EXPECT_FALSE(FreeLibrary(module));
    EXPECT_EQ(live(), before);
}

TEST(Modules, OfOtherNamesArentThere) {
    for (const char* name : {"libc.so.6", "/lib/TEST.CPL", "TEST", ""}) {
        EXPECT_FALSE(LoadLibraryA(name)) << name;
        EXPECT_FALSE(GetModuleHandleA(name)) << name;
    }
    EXPECT_TRUE(GetModuleHandleA(nullptr));
    EXPECT_FALSE(FreeLibrary(GetModuleHandleA(nullptr)));
}

std::vector<DWORD> codes;

bool takeCode(DWORD code) {
    codes.push_back(code);
    return code != 3;
}

HANDLE openDevice(const char* name, DWORD disposition = OPEN_EXISTING) {
    return CreateFileA(name, GENERIC_READ | GENERIC_WRITE, FILE_SHARE_READ | FILE_SHARE_WRITE,
                       nullptr, disposition, 0, nullptr);
}

BOOL call(HANDLE device, DWORD code) {
    return DeviceIoControl(device, code, nullptr, 0, nullptr, 0, nullptr, nullptr);
}

TEST(Devices, TakeCodesWhileTheyAreOpen) {
    const DeviceRegistration older("\\\\.\\TEST", [](DWORD) { return false; });
    const DeviceRegistration device("\\\\.\\TEST", takeCode);
    const seam::HandleCounts before = live();
    const HANDLE open = openDevice("\\\\.\\test");
    EXPECT_TRUE(call(open, 1));
    EXPECT_FALSE(call(open, 3));
    EXPECT_EQ(live().devices, before.devices + 1);
    EXPECT_FALSE(FindClose(open)) << "no search";
    EXPECT_TRUE(CloseHandle(open));
    EXPECT_FALSE(CloseHandle(open));
    EXPECT_FALSE(call(open, 2));
    EXPECT_THAT(codes, testing::ElementsAre(1, 3));
    EXPECT_EQ(live(), before);
    for (const char* name : {"\\\\.\\GONE", "TEST", "/etc/passwd", ""}) {
        EXPECT_EQ(openDevice(name), INVALID_HANDLE_VALUE) << name;
    }
    EXPECT_EQ(openDevice("\\\\.\\TEST", 2), INVALID_HANDLE_VALUE) << "can't be made";
}

} // namespace
