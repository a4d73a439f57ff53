#include "StringTable.h"

#include <algorithm>
#include <cstring>
#include <iterator>

namespace Pigmo {

namespace {

struct StringEntry {
    unsigned int id;
    const char* text;
};

// English (Canada).
constexpr StringEntry kStrings[] = {
    {IDS_PARAMS_ROLLOUT_TITLE, "Color Map Parameters"},
    {IDS_COLORBOOK_DIALOG_CAPTION, "Select Location of a ColorBook File"},
    {IDS_COLORBOOK_FILE_PATH, "ColorBook File Path"},
    {IDS_COLORBOOK_FILE_TYPES, "CxF 2.1 (*.cxf)|*.cxf|All (*.*)|*.*|"},
    {IDS_SELECTED_COLOR_INDEX, "Selected Color Index"},
    {IDS_COLORBOOK_INVALID, "Specified file is not a valid CXF ColorBook"},
    {IDS_COLORBOOK_VERSION, "Only version 2.1 of CXF ColorBooks is supported"},
    {IDS_CURRENT_COLOR_NAME, "Current Color Name"},
    {IDS_CURRENT_COLOR_CATEGORY, "Current Color Category"},
    {IDS_CURRENT_COLOR_SRGB, "Current Color sRGB"},
    {IDS_CURRENT_COLOR_LAB, "Current Color LAB"},
    {IDS_CURRENT_COLOR_REFLECTANCE, "Current Color Reflectance"},
    {IDS_NO_COLORS_PRESENT, "No Colors Present"},
    {IDS_COLORBOOK_MISSING, "ColorBook file '%s' doesn't exist"},
    {IDS_CURRENT_TAGS, "Current Tags"},
    {IDS_COLORBOOK_EMPTY, "ColorBook file is empty"},
    {IDS_CLASS_NAME, "Pigmo Kromalo Plug-in"},
    {IDS_CATEGORY, "Pigmo Plugins"},
    {IDS_CURRENT_COLOR_LINEAR_RGB, "Current Color Linear RGB"},
};

char sharedBuffer[kResourceStringCapacity];

}  // namespace

const char* FindResourceText(unsigned int id) {
    for (const StringEntry& entry : kStrings)
        if (entry.id == id) return entry.text;
    return nullptr;
}

const char* LoadResourceString(unsigned int id) {
    const char* text = FindResourceText(id);
    if (text == nullptr) return nullptr;
    const std::size_t length = std::min(std::strlen(text), std::size(sharedBuffer) - 1);
    std::memcpy(sharedBuffer, text, length);
    sharedBuffer[length] = 0;
    return sharedBuffer;
}

}  // namespace Pigmo
