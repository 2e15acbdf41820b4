#include "platform/registry.h"

#include "platform/handle_table.h"
#include "platform/kernel.h"
#include "platform/kernel/config_directory.h"
#include "platform/kernel/counts.h"
#include "platform/kernel/profile_text.h"
#include "platform/kernel/registry.h"
#include "platform/kernel/transfer.h"

#include <algorithm>
#include <charconv>
#include <cstring>
#include <optional>
#include <string>

namespace {

constexpr const char* registryFile = "registry.ini";

struct OpenKey {
    std::string path;
};

seam::HandleTable<OpenKey> openKeys(seam::HandleKind::key);

std::string registryText() {
    constexpr std::size_t largestRegistry = 1 << 20;
    return seam::readWholeFile(seam::configDirectory() + "/" + registryFile, largestRegistry).text;
}

struct Value {
    DWORD type;
    std::string bytes;
};

Value valueOf(const std::string& text) {
    DWORD number = 0;
    const char* end = text.data() + text.size();
    const std::from_chars_result read = std::from_chars(text.data(), end, number);
    if (read.ec != std::errc() || read.ptr != end) {
        return {REG_SZ, text + '\0'};
    }
    std::string bytes(sizeof number, '\0');
    std::memcpy(bytes.data(), &number, sizeof number);
    return {REG_DWORD, bytes};
}

LONG copyValue(const std::string& bytes, BYTE* data, DWORD* size) {
    if (size == nullptr) {
        return data == nullptr ? ERROR_SUCCESS : ERROR_MORE_DATA;
    }
    const DWORD room = *size;
    *size = static_cast<DWORD>(bytes.size());
    if (data == nullptr) {
        return ERROR_SUCCESS;
    }
    if (room < bytes.size()) {
        return ERROR_MORE_DATA;
    }
    std::copy(bytes.begin(), bytes.end(), data);
    return ERROR_SUCCESS;
}

} // namespace

LONG RegOpenKeyA(HKEY key, const char* path, HKEY* result) {
    *result = nullptr;
    if (key != HKEY_CURRENT_USER) {
        return ERROR_INVALID_HANDLE;
    }
    if (path == nullptr || !seam::profileHasSection(registryText(), path)) {
        return ERROR_FILE_NOT_FOUND;
    }
    *result = HKEY{openKeys.add(std::make_unique<OpenKey>(OpenKey{path}))};
    return *result ? ERROR_SUCCESS : ERROR_FILE_NOT_FOUND;
}

LONG RegQueryValueExA(HKEY key, const char* name, DWORD* /*reserved*/, DWORD* type, BYTE* data,
                      DWORD* size) {
    const OpenKey* open = openKeys.find(key.number);
    if (open == nullptr) {
        return ERROR_INVALID_HANDLE;
    }
    const std::optional<std::string> text =
        name == nullptr ? std::nullopt : seam::profileValue(registryText(), open->path, name);
    if (!text) {
        return ERROR_FILE_NOT_FOUND;
    }
    const Value value = valueOf(*text);
    if (type != nullptr) {
        *type = value.type;
    }
    return copyValue(value.bytes, data, size);
}

LONG RegCloseKey(HKEY key) {
    return openKeys.take(key.number) ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
}

bool seam::setRegistryNumber(const char* path, const char* name, DWORD number) {
    return WritePrivateProfileStringA(path, name, std::to_string(number).c_str(), registryFile) !=
           FALSE;
}

std::size_t seam::liveKeys() {
    return openKeys.live();
}
