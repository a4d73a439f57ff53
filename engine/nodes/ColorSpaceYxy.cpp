#include "ColorSpaceYxy.h"

cColorSpaceYxy::cColorSpaceYxy(const ColorSpaceStruct& description) {
    const double* white = description.EffectiveWhite();
    const double sum = white[0] + white[1] + white[2];
    if (sum == 0.0) {
        xw_ = yw_ = 0.3333333333333333;
    } else {
        xw_ = white[0] / sum;
        yw_ = white[1] / sum;
    }
}

void cColorSpaceYxy::ToXYZ(const double* in, double* out) {
    const double luminance = in[0];
    const double x = in[1];
    const double y = in[2];
    if (y == 0.0) {
        out[0] = out[1] = out[2] = 0.0;
        return;
    }
    out[0] = luminance * x / y;
    out[1] = luminance;
    out[2] = (1.0 - x - y) * luminance / y;
}

void cColorSpaceYxy::FromXYZ(const double* in, double* out) {
    const double sum = in[0] + in[1] + in[2];
    const double luminance = in[1];
    if (sum == 0.0) {
        out[1] = xw_;
        out[2] = yw_;
    } else {
        out[1] = in[0] / sum;
        out[2] = luminance / sum;
    }
    out[0] = luminance;
}
