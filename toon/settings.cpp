#include "toon/settings.h"

#include "platform/kernel.h"

#include <cstring>

LONG WalkingStyle = 1;
LONG WalkingStyleChoice = 0;
LONG Statements = 1;
LONG Backgrounds = 1;
DWORD PacesWalked = 0;
char Directory[DIRECTORY_SIZE];

static const char SettingsFile[] = "Dorbo95.ini";
static const char SettingsSection[] = "Fenky Dorbo Screen Saver";
static const char WalkingStyleKey[] = "Walking Style";
static const char StatementsKey[] = "Statements";
static const char BackgroundsKey[] = "Backgrounds";
static const char PacesWalkedKey[] = "Paces Walked";
static const char DirectoryKey[] = "Directory";

void EnsureTrailingBackslash(char* text) {
    const std::size_t length = std::strlen(text);
    if (length == 0 || text[length - 1] != '\\') {
        text[length] = '\\';
        text[length + 1] = '\0';
    }
}

/// Copies a directory into DIRECTORY_SIZE bytes with its backslash behind it. One that doesn't fit
/// isn't cut, which would name another place, but becomes the root of the current drive. Meant.
static void CopyDirectory(char* target, const char* source) {
    const std::size_t length = std::strlen(source);
    const bool closed = length > 0 && source[length - 1] == '\\';
    const std::size_t needed = length + (closed ? 1 : 2);
    std::strcpy(target, needed <= DIRECTORY_SIZE ? source : "");
    EnsureTrailingBackslash(target);
}

static LONG ReadSwitch(const char* key, LONG otherwise) {
    return static_cast<LONG>(GetPrivateProfileIntA(SettingsSection, key, otherwise, SettingsFile));
}

static void ReadDirectory() {
    char current[DIRECTORY_SIZE] = "";
    GetCurrentDirectoryA(sizeof current, current);
    char fallback[DIRECTORY_SIZE];
    CopyDirectory(fallback, current);

    // Two bytes more than Directory has, so that a value that doesn't fit shows as one.
    char value[DIRECTORY_SIZE + 2] = "";
    GetPrivateProfileStringA(SettingsSection, DirectoryKey, fallback, value, sizeof value,
                             SettingsFile);
    CopyDirectory(Directory, value);
}

void SettingsLoad() {
    WalkingStyle = ReadSwitch(WalkingStyleKey, WalkingStyle);
    Statements = ReadSwitch(StatementsKey, Statements);
    Backgrounds = ReadSwitch(BackgroundsKey, Backgrounds);
    PacesWalked = GetPrivateProfileIntA(SettingsSection, PacesWalkedKey, 0, SettingsFile);
    ReadDirectory();
    WalkingStyleChoice = WalkingStyle;
}

void WriteIntSetting(const char* section, const char* key, DWORD value) {
    char text[40];
    wsprintfA(text, "%u", value);
    WritePrivateProfileStringA(section, key, text, SettingsFile);
}

void SettingsSave() {
    WriteIntSetting(SettingsSection, WalkingStyleKey, static_cast<DWORD>(WalkingStyle));
    WriteIntSetting(SettingsSection, StatementsKey, static_cast<DWORD>(Statements));
    WriteIntSetting(SettingsSection, BackgroundsKey, static_cast<DWORD>(Backgrounds));
    WriteIntSetting(SettingsSection, PacesWalkedKey, PacesWalked);
    WritePrivateProfileStringA(SettingsSection, DirectoryKey, Directory, SettingsFile);
}
