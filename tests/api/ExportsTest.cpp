#include <cxxabi.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <vector>

namespace {

struct ExportedSymbol {
    char type;
    std::string name;
};

// Dynamic symbols the library defines, as `nm -D --defined-only` lists them.
std::vector<ExportedSymbol> DefinedDynamicSymbols(const std::string& library) {
    const std::string command = "nm -D --defined-only '" + library + "'";
    std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), pclose);
    std::vector<ExportedSymbol> symbols;
    if (!pipe) return symbols;
    char line[4096];
    while (std::fgets(line, sizeof line, pipe.get()) != nullptr) {
        std::istringstream fields(line);
        std::string address, type, name;
        if (!(fields >> address >> type >> name)) continue;
        name = name.substr(0, name.find('@'));  // drop the version node
        symbols.push_back({type[0], name});
    }
    return symbols;
}

std::string Demangled(const std::string& name) {
    int status = 0;
    std::unique_ptr<char, void (*)(void*)> text(abi::__cxa_demangle(name.c_str(), nullptr, nullptr, &status),
                                                std::free);
    return status == 0 ? std::string(text.get()) : name;
}

// The public surface: C functions, plug-in entry points, engine classes with their vtables and typeinfo.
bool IsAllowed(const ExportedSymbol& symbol) {
    static const std::set<std::string> entryPoints = {"LibDescription", "LibNumberClasses", "LibClassDesc",
                                                      "LibVersion", "CanAutoDefer"};
    if (symbol.type == 'A') return true;  // version node
    if (entryPoints.count(symbol.name) != 0) return true;
    if (symbol.name.rfind("BP", 0) == 0) return true;
    static const std::regex engineClass(
        "^((vtable|typeinfo|typeinfo name|VTT|construction vtable) for |(non-)?virtual thunk to )?"
        "(cColor\\w*|cMatrixDC|cDataCollection|cMathEngine|cDeltaEBase|cCIE\\w*|cCMC\\w*|ChromaticAdaptation|"
        "[A-Z]\\w*Struct)"
        "(<.*>)?(::|$)|^theMathEngine$");
    return std::regex_search(Demangled(symbol.name), engineClass);
}

TEST(Exports, OnlyThePublicSurfaceLeavesTheLibrary) {
    const std::vector<ExportedSymbol> symbols = DefinedDynamicSymbols(PIGMO_LIBRARY);
    ASSERT_FALSE(symbols.empty()) << "nm found no symbols in " << PIGMO_LIBRARY;
    for (const ExportedSymbol& symbol : symbols) {
        EXPECT_TRUE(IsAllowed(symbol)) << "unexpected export: " << Demangled(symbol.name);
    }
}

TEST(Exports, EveryCFunctionIsExportedUnmangled) {
    std::set<std::string> names;
    for (const ExportedSymbol& symbol : DefinedDynamicSymbols(PIGMO_LIBRARY)) names.insert(symbol.name);
    std::istringstream expected(
        "BPConvert36BandSpectral2LabD502 BPConvert36BandSpectral2LinearsRGB BPConvertsRGB2Lab "
        "BPConvertLab2sRGB BPConvertsLinearRGB2Lab BPConvertLab2LinearsRGB BPConvertLCh2Lab BPConvertLab2LCh "
        "BPCalculateDeltaE BPCalculateDeltaECMC BPCalculateDeltaE94 BPCalculateDeltaE2000 "
        "BPCalculateDistanceSquared "
        "BPHarmonyGetMonochromatic BPHarmonyGetNearNeighbor BPHarmonyGetFarNeighbor BPHarmonyGetTriadic "
        "BPHarmonyGetComplement BPCentroidGetCount BPCentroidGetCategoryCount BPCentroidGetCategory "
        "BPCentroidGetCategoryName BPCentroidGetName BPCentroidGetLab BPCentroidGetForLab BPImageExtractLab "
        "BPCalculateDeltaEArray BPCalculateDeltaECMCArray BPCalculateDeltaE94Array "
        "BPCalculateDeltaE2000Array "
        "BPImageFileExtractLab BPGetHtmlColorCode BPColorBookOpen BPColorBookClose BPColorBookGetName "
        "BPColorBookGetColorCount "
        "BPColorBookGetColorName BPColorBookGetColorCategory BPColorBookGetColorLab BPColorBookGetColorSRGB "
        "BPColorBookGetColorLinearRGB BPColorBookGetColorTagCount BPColorBookGetColorTag "
        "BPColorBookGetColorReflectanceCount BPColorBookGetColorReflectance BPPaletteListFind "
        "BPPaletteListFree "
        "BPPaletteListGetCount BPPaletteListGetName BPPaletteListGetPath BPPaletteListIsUser");
    for (std::string name; expected >> name;) EXPECT_EQ(names.count(name), 1u) << name;
}

}  // namespace
