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

#ifdef __cplusplus
}
#endif

#endif /* PIGMO_BP_H */
