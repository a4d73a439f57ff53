#pragma once

#include <string>

#include "TempFolder.h"

// A temporary folder per test with small CxF books written into it.
class BookFolder : public TempFolder {
protected:
    // A version-2 book around the given palette content.
    static std::string Book(const std::string& paletteContent, const std::string& paletteAttributes = "") {
        return "<?xml version=\"1.0\"?>\n<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">"
               "<CxF:Palette" +
               paletteAttributes + ">" + paletteContent + "</CxF:Palette></CxF:CxF>";
    }
    static std::string ColorSet(const std::string& colors) {
        return "<CxF:ColorSet>" + colors + "</CxF:ColorSet>";
    }
};
