#include "toon/settings.h"

#include "platform/kernel.h"
#include "toon/toon_document.h"

#include <cstring>

LONG WalkingStyle = 1;
LONG WalkingStyleChoice = 0;
LONG Statements = 1;
LONG Backgrounds = 1;
DWORD PacesWalked = 0;
char Directory[DIRECTORY_SIZE];

static const char SETTINGS_FILE[] = "Dorbo95.ini";
static const char SETTINGS_SECTION[] = "Fenky Dorbo Screen Saver";
static const char WALKING_STYLE_KEY[] = "Walking Style";
static const char STATEMENTS_KEY[] = "Statements";
static const char BACKGROUNDS_KEY[] = "Backgrounds";
static const char PACES_WALKED_KEY[] = "Paces Walked";
static const char DIRECTORY_KEY[] = "Directory";

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
    CopyText(target, needed <= DIRECTORY_SIZE ? source : "", DIRECTORY_SIZE);
    EnsureTrailingBackslash(target);
}

static LONG ReadSwitch(const char* key, LONG otherwise) {
    return static_cast<LONG>(
        GetPrivateProfileIntA(SETTINGS_SECTION, key, otherwise, SETTINGS_FILE));
}

/// The current directory, for a settings file that names none.
static void ReadFallback(char* fallback) {
    char current[DIRECTORY_SIZE] = "";
    GetCurrentDirectoryA(sizeof current, current);
    CopyDirectory(fallback, current);
}

bool SettingsNameDirectory() {
    char value[2] = "";
    return GetPrivateProfileStringA(SETTINGS_SECTION, DIRECTORY_KEY, "", value, sizeof value,
                                    SETTINGS_FILE) != 0;
}

static void ReadDirectory(const char* fallback) {
    // Two bytes more than Directory has, so that a value that doesn't fit shows as one.
    char value[DIRECTORY_SIZE + 2] = "";
    GetPrivateProfileStringA(SETTINGS_SECTION, DIRECTORY_KEY, fallback, value, sizeof value,
                             SETTINGS_FILE);
    CopyDirectory(Directory, value);
}

void SettingsLoad() {
    char fallback[DIRECTORY_SIZE];
    ReadFallback(fallback);
    WalkingStyle = ReadSwitch(WALKING_STYLE_KEY, WalkingStyle);
    Statements = ReadSwitch(STATEMENTS_KEY, Statements);
    Backgrounds = ReadSwitch(BACKGROUNDS_KEY, Backgrounds);
    PacesWalked = GetPrivateProfileIntA(SETTINGS_SECTION, PACES_WALKED_KEY, 0, SETTINGS_FILE);
    ReadDirectory(fallback);
    WalkingStyleChoice = WalkingStyle;
}

void WriteIntSetting(const char* section, const char* key, DWORD value) {
    char text[40];
    wsprintfA(text, "%u", value);
    WritePrivateProfileStringA(section, key, text, SETTINGS_FILE);
}

void SettingsSave() {
    WriteIntSetting(SETTINGS_SECTION, WALKING_STYLE_KEY, static_cast<DWORD>(WalkingStyle));
    WriteIntSetting(SETTINGS_SECTION, STATEMENTS_KEY, static_cast<DWORD>(Statements));
    WriteIntSetting(SETTINGS_SECTION, BACKGROUNDS_KEY, static_cast<DWORD>(Backgrounds));
    WriteIntSetting(SETTINGS_SECTION, PACES_WALKED_KEY, PacesWalked);
    WritePrivateProfileStringA(SETTINGS_SECTION, DIRECTORY_KEY, Directory, SETTINGS_FILE);
}
