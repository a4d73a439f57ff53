// A program outside the tree that uses the installed engine headers and libpigmo.so.
#include <pigmo/engine/ColorTranslator.h>

#include <cstdio>

int main() {
    ColorSpaceStruct lab;
    ColorSpaceStruct rgb;
    lab.SetType(3);
    rgb.SetType(24);
    cColorTranslator translator;
    translator.SetSource(lab);
    translator.SetDestination(rgb);
    const double in[3] = {100.0, 0.0, 0.0};
    double out[3] = {};
    const int status = translator.Translate(in, out);
    std::printf("%d %.2f %.2f %.2f\n", status, out[0], out[1], out[2]);
    return status;
}
