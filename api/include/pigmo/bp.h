/* Pigmo color-science interface: plain C, undecorated names. */
#ifndef PIGMO_BP_H
#define PIGMO_BP_H

/* Installed alone, so it carries its own export marker. */
#if defined(PIGMO_STATIC)
#define PIGMO_BP_API
#else
#define PIGMO_BP_API __attribute__((visibility("default")))
#endif

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Conversions: one color per call; 1 on success, 0 on failure (a null pointer included), when the
   output is untouched and the line "translate status: N" goes to standard output.
   Lab values are relative to the white 0.96422, 1.0, 0.82521 unless named otherwise.
   The functions may be called from several threads at once. */

/* 36 reflectance factors, 380 to 730 nm in 10-nm steps -> L*, a*, b* under D50. */
PIGMO_BP_API int BPConvert36BandSpectral2LabD502(const double* spectral, double* lab);
/* 36 reflectance factors -> linear sRGB divided by 255 (a white reflector gives about 1/255). */
PIGMO_BP_API int BPConvert36BandSpectral2LinearsRGB(const double* spectral, double* linearRGB);
/* Gamma-encoded sRGB on 0..255 -> L*, a*, b*. */
PIGMO_BP_API int BPConvertsRGB2Lab(const double* sRGB, double* lab);
/* L*, a*, b* -> gamma-encoded sRGB on 0..255, clamped, not rounded. */
PIGMO_BP_API int BPConvertLab2sRGB(const double* lab, double* sRGB);
/* Linear RGB on 0..255 -> L*, a*, b*. */
PIGMO_BP_API int BPConvertsLinearRGB2Lab(const double* linearRGB, double* lab);
/* L*, a*, b* -> linear RGB on 0..1, not clamped. */
PIGMO_BP_API int BPConvertLab2LinearsRGB(const double* lab, double* linearRGB);
/* L*, chroma, hue in degrees -> L*, a*, b*. */
PIGMO_BP_API int BPConvertLCh2Lab(const double* lch, double* lab);
/* L*, a*, b* -> L*, chroma, hue in degrees (0 to 360). */
PIGMO_BP_API int BPConvertLab2LCh(const double* lab, double* lch);

/* The same conversions over arrays of count colors, one after the other (36 doubles a color for
   the spectral ones, 3 for the others): 1 when every color converted, 0 otherwise (a null pointer
   included). Each result equals the single-color function's bit for bit. */

PIGMO_BP_API int BPConvert36BandSpectral2LabD502Array(const double* spectral, double* lab, size_t count);
PIGMO_BP_API int BPConvert36BandSpectral2LinearsRGBArray(const double* spectral, double* linearRGB,
                                                         size_t count);
PIGMO_BP_API int BPConvertsRGB2LabArray(const double* sRGB, double* lab, size_t count);
PIGMO_BP_API int BPConvertLab2sRGBArray(const double* lab, double* sRGB, size_t count);
PIGMO_BP_API int BPConvertsLinearRGB2LabArray(const double* linearRGB, double* lab, size_t count);
PIGMO_BP_API int BPConvertLab2LinearsRGBArray(const double* lab, double* linearRGB, size_t count);
PIGMO_BP_API int BPConvertLCh2LabArray(const double* lch, double* lab, size_t count);
PIGMO_BP_API int BPConvertLab2LChArray(const double* lab, double* lch, size_t count);

/* Color differences between two L*, a*, b* triples; -1.0 when either pointer is null.
   CMC and CIE94 weight by the first (reference) color, so the order matters. */

/* CIE76 (Euclidean distance). */
PIGMO_BP_API double BPCalculateDeltaE(const double* lab1, const double* lab2);
/* CMC l:c. */
PIGMO_BP_API double BPCalculateDeltaECMC(const double* lab1, const double* lab2, double l, double c);
/* CIE94 with the graphic-arts constants K1 = 0.045, K2 = 0.015. */
PIGMO_BP_API double BPCalculateDeltaE94(const double* lab1, const double* lab2, double kL, double kC,
                                        double kH);
/* CIEDE2000. */
PIGMO_BP_API double BPCalculateDeltaE2000(const double* lab1, const double* lab2, double kL, double kC,
                                          double kH);
/* Square of the CIE76 difference, without the square root. */
PIGMO_BP_API double BPCalculateDistanceSquared(const double* lab1, const double* lab2);

/* The four differences over count pairs, row i of lab1 against row i of lab2 (three doubles a row),
   into out (count doubles), each equal to the single-pair function's result: 1 on success, 0 without
   writing anything when a pointer is null. */

PIGMO_BP_API int BPCalculateDeltaEArray(const double* lab1, const double* lab2, double* out, size_t count);
PIGMO_BP_API int BPCalculateDeltaECMCArray(const double* lab1, const double* lab2, double* out, size_t count,
                                           double l, double c);
PIGMO_BP_API int BPCalculateDeltaE94Array(const double* lab1, const double* lab2, double* out, size_t count,
                                          double kL, double kC, double kH);
PIGMO_BP_API int BPCalculateDeltaE2000Array(const double* lab1, const double* lab2, double* out, size_t count,
                                            double kL, double kC, double kH);

/* ISCC-NBS centroid catalogue and dominant colors */

/* 267 centroids (1-based), each in one of 19 hue categories (1-based). Index arguments are
   clamped: 0 or less gives the first entry, past the end the last. Returned texts and triples
   point into a static table; do not free or change them. */

PIGMO_BP_API int BPCentroidGetCount(void);
PIGMO_BP_API int BPCentroidGetCategoryCount(void);
/* Category id (1 to 19) of a centroid. */
PIGMO_BP_API int BPCentroidGetCategory(int centroid);
PIGMO_BP_API const char* BPCentroidGetCategoryName(int category);
PIGMO_BP_API const char* BPCentroidGetName(int centroid);
/* L*, a*, b* of a centroid (D50 white). */
PIGMO_BP_API const double* BPCentroidGetLab(int centroid);
/* Nearest centroid (squared CIE76, the lower index on ties) among those sharing the color's
   L* = 50, a* = 0, b* = 0 octant or lying near its borders; -1 for a null pointer or a
   component that is not finite. */
PIGMO_BP_API int BPCentroidGetForLab(const double* lab);
/* Dominant colors of an image of 4-byte pixels (byte 0 ignored, then red, green, blue), row
   after row, sampled every second pixel: writes colourCount L*, a*, b* triples (10 when
   colourCount < 1; the last repeats when fewer colors stand apart) to labOut, which must hold
   that many, and their number to countOut (if not null). A null image or labOut, or a width or
   height of 0 or less, gives a count of 0. */
PIGMO_BP_API void BPImageExtractLab(const unsigned char* pixels, int width, int height, int colourCount,
                                    double* labOut, int* countOut);
/* Dominant colors of a PNG, JPEG, BMP or TGA file, as BPImageExtractLab finds them in its pixels
   (transparency ignored), without the repeats: writes up to colourCount (at least 1) triples to labOut
   and their number to countOut (if not null). An image of more than maxPixels pixels is refused before
   it is decoded. 1 on success; 0 with countOut 0 and the reason, naming the file, in errorText (cut to
   errorTextSize bytes, terminator included; errorText may be null). */
PIGMO_BP_API int BPImageFileExtractLab(const char* path, long long maxPixels, int colourCount, double* labOut,
                                       int* countOut, char* errorText, size_t errorTextSize);

/* Harmonies: companions of one L*, a*, b* color, rotated on a twelve-sector color wheel.
   Each returns the status of its last LCh-to-Lab conversion (1 success, 0 failure), or 0
   without writing anything when lab is null. */

/* Same hue and chroma at two other lightnesses. */
PIGMO_BP_API int BPHarmonyGetMonochromatic(const double* lab, double* lab1, double* lab2);
/* Wheel angle -30 and +30 degrees. */
PIGMO_BP_API int BPHarmonyGetNearNeighbor(const double* lab, double* lab1, double* lab2);
/* Wheel angle -150 and +150 degrees. */
PIGMO_BP_API int BPHarmonyGetFarNeighbor(const double* lab, double* lab1, double* lab2);
/* Wheel angle -120 and +120 degrees. */
PIGMO_BP_API int BPHarmonyGetTriadic(const double* lab, double* lab1, double* lab2);
/* Wheel angle +180 degrees. */
PIGMO_BP_API int BPHarmonyGetComplement(const double* lab, double* labOut);

/* The "#RRGGBB" code of gamma-encoded sRGB on 0..255: each channel truncated after adding 0.01 (the
   error of a round trip through CIELAB), clamped to 0..255, red first. Writes at most codeSize bytes,
   terminator included (8 hold the whole code); 1 on success, 0 for a null pointer or a codeSize of 0. */
PIGMO_BP_API int BPGetHtmlColorCode(const double* sRGB, char* code, size_t codeSize);

/* Color books: CxF 2.1 files read whole into a handle. A handle is never changed after it opens,
   so several threads may read one at once; close it once, when no thread uses it any more. Texts
   returned live as long as the handle. Every function takes a null handle or an index out of range
   without harm: texts are then null, counts 0 and copies return 0. */

typedef struct BPColorBook BPColorBook;

/* Opens the book at path, or returns null and writes why into errorText (at most errorTextSize bytes,
   terminator included; the text is cut to fit): the reader's message with the path and, where the
   message hides it, the cause, e.g. "b.cxf: Specified file is not a valid CXF ColorBook (is a
   directory)". errorText may be null. */
PIGMO_BP_API BPColorBook* BPColorBookOpen(const char* path, char* errorText, size_t errorTextSize);
PIGMO_BP_API void BPColorBookClose(BPColorBook* book);
/* The first palette's "PaletteName", empty when the book has none. */
PIGMO_BP_API const char* BPColorBookGetName(const BPColorBook* book);
PIGMO_BP_API int BPColorBookGetColorCount(const BPColorBook* book);
/* Fields of color index (0-based), with the values the book leaves out derived. */
PIGMO_BP_API const char* BPColorBookGetColorName(const BPColorBook* book, int index);
PIGMO_BP_API const char* BPColorBookGetColorCategory(const BPColorBook* book, int index);
/* Copy three values: L*, a*, b* (D50); sRGB on 0..255; linear sRGB on 0..1 (what the map renders).
   1 on success. */
PIGMO_BP_API int BPColorBookGetColorLab(const BPColorBook* book, int index, double* lab);
PIGMO_BP_API int BPColorBookGetColorSRGB(const BPColorBook* book, int index, double* sRGB);
PIGMO_BP_API int BPColorBookGetColorLinearRGB(const BPColorBook* book, int index, double* linearRGB);
PIGMO_BP_API int BPColorBookGetColorTagCount(const BPColorBook* book, int index);
PIGMO_BP_API const char* BPColorBookGetColorTag(const BPColorBook* book, int index, int tag);
/* Reflectance values in the book's order (36 are the bands 380 to 730 nm by 10 nm). The copy writes
   at most capacity values and returns how many it wrote. */
PIGMO_BP_API int BPColorBookGetColorReflectanceCount(const BPColorBook* book, int index);
PIGMO_BP_API int BPColorBookGetColorReflectance(const BPColorBook* book, int index, double* values,
                                                int capacity);

/* Palettes found on this machine, as the palette list shows them: the system palettes, then the
   user's, each in name order. The list is a snapshot taken when it is made; like a book it may be
   read from several threads and is freed once. */

typedef struct BPPaletteList BPPaletteList;

/* Null only when memory runs out. */
PIGMO_BP_API BPPaletteList* BPPaletteListFind(void);
PIGMO_BP_API void BPPaletteListFree(BPPaletteList* list);
PIGMO_BP_API int BPPaletteListGetCount(const BPPaletteList* list);
/* The palette's "PaletteName"; empty when the file cannot be read as a book. */
PIGMO_BP_API const char* BPPaletteListGetName(const BPPaletteList* list, int index);
/* The file's full path. */
PIGMO_BP_API const char* BPPaletteListGetPath(const BPPaletteList* list, int index);
/* 1 for a user palette, 0 for a system palette, -1 for a null list or an index out of range. */
PIGMO_BP_API int BPPaletteListIsUser(const BPPaletteList* list, int index);

#ifdef __cplusplus
}
#endif

#endif /* PIGMO_BP_H */
