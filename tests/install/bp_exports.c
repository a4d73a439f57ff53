/* An outside C program against the installed pigmo/bp.h: every conversion, difference, harmony,
   catalogue, color-book and palette export, checked against known values. Prints one line per failed check;
   exits 0 when all pass. */
#include <math.h>
#include <pigmo/bp.h>
#include <stdio.h>
#include <string.h>

static int failures = 0;

static void Check(const char* what, const double* got, const double* want, int count, double tolerance) {
    for (int i = 0; i < count; ++i) {
        if (!(fabs(got[i] - want[i]) <= tolerance)) {
            printf("FAIL %s[%d]: %.6f, expected %.6f\n", what, i, got[i], want[i]);
            ++failures;
        }
    }
}

static void CheckStatus(const char* what, int got, int want) {
    if (got != want) {
        printf("FAIL %s: status %d, expected %d\n", what, got, want);
        ++failures;
    }
}

static void CheckConversions(void) {
    double out[3];
    const double srgbWhite[3] = {255, 255, 255};
    const double labWhite[3] = {100, 0, 0};
    const double labBlue[3] = {50, 0, -10};
    const double lchYellow[3] = {50, 10, 90};
    double reflector[36];
    for (int i = 0; i < 36; ++i) reflector[i] = 1.0;

    CheckStatus("BPConvertsRGB2Lab", BPConvertsRGB2Lab(srgbWhite, out), 1);
    Check("BPConvertsRGB2Lab", out, (const double[]){100, -2.3829, -19.3737}, 3, 5e-5);
    CheckStatus("BPConvertsLinearRGB2Lab", BPConvertsLinearRGB2Lab(srgbWhite, out), 1);
    Check("BPConvertsLinearRGB2Lab", out, (const double[]){100, -2.3829, -19.3737}, 3, 5e-5);
    CheckStatus("BPConvertLab2sRGB", BPConvertLab2sRGB(labWhite, out), 1);
    Check("BPConvertLab2sRGB", out, (const double[]){255, 252.27, 220.85}, 3, 5e-3);
    CheckStatus("BPConvertLab2LinearsRGB", BPConvertLab2LinearsRGB(labWhite, out), 1);
    Check("BPConvertLab2LinearsRGB", out, (const double[]){1.17600, 0.97581, 0.72195}, 3, 5e-6);
    CheckStatus("BPConvertLab2LCh", BPConvertLab2LCh(labBlue, out), 1);
    Check("BPConvertLab2LCh", out, (const double[]){50, 10, 270}, 3, 1e-9);
    CheckStatus("BPConvertLCh2Lab", BPConvertLCh2Lab(lchYellow, out), 1);
    Check("BPConvertLCh2Lab", out, (const double[]){50, 0, 10}, 3, 1e-12);
    CheckStatus("BPConvert36BandSpectral2LabD502", BPConvert36BandSpectral2LabD502(reflector, out), 1);
    Check("BPConvert36BandSpectral2LabD502", out, (const double[]){100, 0, 0}, 3, 1e-6);
    CheckStatus("BPConvert36BandSpectral2LinearsRGB", BPConvert36BandSpectral2LinearsRGB(reflector, out), 1);
    Check("BPConvert36BandSpectral2LinearsRGB", out, (const double[]){1 / 255.0, 1 / 255.0, 1 / 255.0}, 3,
          2e-5);
    CheckStatus("BPConvertLab2sRGB(null)", BPConvertLab2sRGB(labWhite, NULL), 0);
}

typedef int (*Single)(const double*, double*);
typedef int (*Batch)(const double*, double*, size_t);

/* Each array function against its single-color sibling, over random colors and edge values. */
static void CheckArrays(void) {
    const struct {
        const char* name;
        Single single;
        Batch batch;
        int width;
        double low, high;
    } cases[] = {
        {"BPConvert36BandSpectral2LabD502Array", BPConvert36BandSpectral2LabD502,
         BPConvert36BandSpectral2LabD502Array, 36, -0.1, 1.1},
        {"BPConvert36BandSpectral2LinearsRGBArray", BPConvert36BandSpectral2LinearsRGB,
         BPConvert36BandSpectral2LinearsRGBArray, 36, -0.1, 1.1},
        {"BPConvertsRGB2LabArray", BPConvertsRGB2Lab, BPConvertsRGB2LabArray, 3, -10, 265},
        {"BPConvertLab2sRGBArray", BPConvertLab2sRGB, BPConvertLab2sRGBArray, 3, -130, 130},
        {"BPConvertsLinearRGB2LabArray", BPConvertsLinearRGB2Lab, BPConvertsLinearRGB2LabArray, 3, -10, 265},
        {"BPConvertLab2LinearsRGBArray", BPConvertLab2LinearsRGB, BPConvertLab2LinearsRGBArray, 3, -130, 130},
        {"BPConvertLCh2LabArray", BPConvertLCh2Lab, BPConvertLCh2LabArray, 3, -10, 370},
        {"BPConvertLab2LChArray", BPConvertLab2LCh, BPConvertLab2LChArray, 3, -130, 130},
    };
    enum { kColors = 300 };
    static double in[kColors * 36], out[kColors * 3];
    unsigned state = 12345u;
    for (size_t c = 0; c < sizeof cases / sizeof cases[0]; ++c) {
        const int width = cases[c].width;
        for (int i = 0; i < kColors * width; ++i) {
            state = state * 1103515245u + 12345u;
            in[i] = cases[c].low + (cases[c].high - cases[c].low) * (state >> 8) / 16777216.0;
        }
        /* Zeros, a hue of 90 and a perfect white among the random colors. */
        for (int i = 0; i < width; ++i) in[i] = 0.0;
        for (int i = width; i < 2 * width; ++i) in[i] = i == 2 * width - 1 ? 90.0 : 50.0;
        CheckStatus(cases[c].name, cases[c].batch(in, out, kColors), 1);
        for (int k = 0; k < kColors; ++k) {
            double single[3];
            cases[c].single(in + k * width, single);
            if (memcmp(single, out + 3 * k, sizeof single) != 0) {
                printf("FAIL %s: color %d differs from the single-color result\n", cases[c].name, k);
                ++failures;
                break;
            }
        }
        /* Nothing to convert is success; a missing array is a failure that writes nothing. */
        CheckStatus(cases[c].name, cases[c].batch(in, out, 0), 1);
        out[0] = -7.0;
        CheckStatus(cases[c].name, cases[c].batch(NULL, out, kColors), 0);
        CheckStatus(cases[c].name, cases[c].batch(in, NULL, kColors), 0);
        Check(cases[c].name, out, (const double[]){-7.0}, 1, 0.0);
    }
}

static void CheckDifferences(void) {
    const double reference[3] = {50, 20, -30}, sample[3] = {55, 18, -25};
    const double grey[3] = {50, 0, 0}, tinted[3] = {50, 3, 4};
    const double blue1[3] = {50, 2.6772, -79.7751}, blue2[3] = {50, 0, -82.7485};
    const double got[] = {
        BPCalculateDeltaE(grey, tinted),
        BPCalculateDistanceSquared(grey, tinted),
        BPCalculateDeltaECMC(reference, sample, 2, 1),
        BPCalculateDeltaECMC(sample, reference, 2, 1),
        BPCalculateDeltaE94(reference, sample, 1, 1, 1),
        BPCalculateDeltaE94(sample, reference, 1, 1, 1),
        BPCalculateDeltaE2000(reference, sample, 1, 1, 1),
        BPCalculateDeltaE2000(blue1, blue2, 1, 1, 1),
        BPCalculateDeltaE(NULL, sample),
        BPCalculateDeltaE2000(reference, NULL, 1, 1, 1),
    };
    const double want[] = {5.0, 25.0, 3.42184, 3.50099, 5.44188, 5.52394, 5.50085, 2.0425, -1.0, -1.0};
    Check("differences", got, want, (int)(sizeof want / sizeof want[0]), 5e-5);
}

static void CheckHarmonies(void) {
    const double pi = 3.14159265358979323846;
    const double hue30[3] = {60, 40 * cos(pi / 6), 40 * sin(pi / 6)};
    const double hue25[3] = {60, 40 * cos(pi * 25 / 180), 40 * sin(pi * 25 / 180)};
    const double mid[3] = {50, 10, 10};
    double out1[3], out2[3], lch[3];

    CheckStatus("BPHarmonyGetComplement", BPHarmonyGetComplement(hue30, out1), 1);
    BPConvertLab2LCh(out1, lch);
    Check("BPHarmonyGetComplement hue", &lch[2], (const double[]){160.11}, 1, 0.01);

    const struct {
        const char* name;
        int (*harmony)(const double*, double*, double*);
        const double* lab;
        double hue1, hue2;
    } pairs[] = {
        {"BPHarmonyGetNearNeighbor", BPHarmonyGetNearNeighbor, hue30, 8.31, 42.93},
        {"BPHarmonyGetTriadic", BPHarmonyGetTriadic, hue30, 257.38, 97.61},
        {"BPHarmonyGetFarNeighbor", BPHarmonyGetFarNeighbor, hue25, 190, 120},
    };
    for (int i = 0; i < 3; ++i) {
        CheckStatus(pairs[i].name, pairs[i].harmony(pairs[i].lab, out1, out2), 1);
        double hues[2];
        BPConvertLab2LCh(out1, lch);
        hues[0] = lch[2];
        BPConvertLab2LCh(out2, lch);
        hues[1] = lch[2];
        Check(pairs[i].name, hues, (const double[]){pairs[i].hue1, pairs[i].hue2}, 2, 0.01);
    }

    CheckStatus("BPHarmonyGetMonochromatic", BPHarmonyGetMonochromatic(mid, out1, out2), 1);
    Check("BPHarmonyGetMonochromatic", (const double[]){out1[0], out2[0]}, (const double[]){17, 83}, 2, 1e-9);
}

static void CheckText(const char* what, const char* got, const char* want) {
    if (got == NULL || strcmp(got, want) != 0) {
        printf("FAIL %s: \"%s\", expected \"%s\"\n", what, got ? got : "(null)", want);
        ++failures;
    }
}

static void CheckCatalogue(void) {
    CheckStatus("BPCentroidGetCount", BPCentroidGetCount(), 267);
    CheckStatus("BPCentroidGetCategoryCount", BPCentroidGetCategoryCount(), 19);
    CheckStatus("BPCentroidGetCategory", BPCentroidGetCategory(263), 19);
    CheckText("BPCentroidGetName(1)", BPCentroidGetName(1), "Vivid Pink");
    CheckText("BPCentroidGetName(268)", BPCentroidGetName(268), "Black");
    CheckText("BPCentroidGetCategoryName(20)", BPCentroidGetCategoryName(20), "White/Gray/Black");
    Check("BPCentroidGetLab", BPCentroidGetLab(1), (const double[]){80.656948, 27.535981, 8.233154}, 3, 1e-9);
    CheckStatus("BPCentroidGetForLab", BPCentroidGetForLab(BPCentroidGetLab(1)), 1);

    /* A white 2 x 2 image: one group, repeated for every requested colour. */
    unsigned char white[16];
    for (int i = 0; i < 16; ++i) white[i] = 255;
    double lab[9];
    int count = -1;
    BPImageExtractLab(white, 2, 2, 3, lab, &count);
    CheckStatus("BPImageExtractLab count", count, 3);
    Check("BPImageExtractLab", lab + 6, (const double[]){100, -2.3829, -19.3737}, 3, 5e-5);
    BPImageExtractLab(white, 0, 2, 3, lab, &count);
    CheckStatus("BPImageExtractLab empty", count, 0);
}

/* The installed copy finds its own centroid book and reads it. */
static void CheckBooks(void) {
    BPPaletteList* list = BPPaletteListFind();
    const char* path = NULL;
    for (int i = 0; i < BPPaletteListGetCount(list); ++i)
        if (strcmp(BPPaletteListGetName(list, i), "ISCC-NBS Centroid Colors") == 0 &&
            !BPPaletteListIsUser(list, i))
            path = BPPaletteListGetPath(list, i);
    if (path == NULL) {
        printf("FAIL BPPaletteListFind: no system palette \"ISCC-NBS Centroid Colors\"\n");
        ++failures;
        BPPaletteListFree(list);
        return;
    }
    char error[256] = "";
    BPColorBook* book = BPColorBookOpen(path, error, sizeof error);
    BPPaletteListFree(list);
    CheckStatus("BPColorBookGetColorCount", BPColorBookGetColorCount(book), 267);
    CheckText("BPColorBookGetColorName", BPColorBookGetColorName(book, 0), "Vivid Pink");
    double lab[3], srgb[3];
    CheckStatus("BPColorBookGetColorLab", BPColorBookGetColorLab(book, 0, lab), 1);
    Check("BPColorBookGetColorLab", lab, BPCentroidGetLab(1), 3, 1e-4);
    CheckStatus("BPColorBookGetColorSRGB", BPColorBookGetColorSRGB(book, 0, srgb), 1);
    char code[8];
    CheckStatus("BPGetHtmlColorCode", BPGetHtmlColorCode(srgb, code, sizeof code), 1);
    CheckText("BPGetHtmlColorCode", code, "#FFB2A0");
    BPColorBookClose(book);

    CheckStatus("BPColorBookOpen(missing)", BPColorBookOpen("/nowhere/book.cxf", error, sizeof error) == NULL,
                1);
    CheckText("BPColorBookOpen(missing)", error, "ColorBook file '/nowhere/book.cxf' doesn't exist");
}

int main(void) {
    CheckConversions();
    CheckArrays();
    CheckDifferences();
    CheckHarmonies();
    CheckCatalogue();
    CheckBooks();
    if (failures == 0) printf("bp exports ok\n");
    return failures == 0 ? 0 : 1;
}
