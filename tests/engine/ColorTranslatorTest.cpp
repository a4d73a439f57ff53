#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "ColorTranslator.h"

namespace {

using Triple = std::array<double, 3>;

const Triple kD50{0.96422, 1.0, 0.82521};
const Triple kD65{0.95047, 1.0, 1.08883};

ColorSpaceStruct OfType(int32_t code, const Triple& white = kD50) {
    ColorSpaceStruct d;
    d.SetType(code);
    std::copy(white.begin(), white.end(), d.whitePoint);
    return d;
}

Triple Convert(const ColorSpaceStruct& source, const ColorSpaceStruct& destination, const Triple& in,
               AdaptationMethod adaptation = AdaptationMethod::None) {
    cColorTranslator engine;
    engine.SetAdaptation(adaptation);
    engine.SetSource(source);
    EXPECT_EQ(engine.SetDestination(destination), 0);
    Triple out{};
    EXPECT_EQ(engine.Translate(in.data(), out.data()), 0);
    return out;
}

void ExpectNear(const Triple& actual, const Triple& expected, double tolerance) {
    for (int i = 0; i < 3; ++i) EXPECT_NEAR(actual[i], expected[i], tolerance) << "channel " << i;
}

TEST(ColorTranslator, ClampAtTheAdaptationStepIsForLabSourcesOnly) {
    const Triple lab{10, 0, 100};
    cColorTranslator engine;
    engine.SetClampLabSource(false);
    engine.SetSource(OfType(3));
    engine.SetDestination(OfType(6));
    Triple unclamped{};
    engine.Translate(lab.data(), unclamped.data());
    EXPECT_LT(unclamped[2], 0.0);
    EXPECT_EQ(Convert(OfType(3), OfType(6), lab)[2], 0.0);
    // An XYZ source keeps its negative Z: x = X / (X + Y + Z) = 1.
    EXPECT_EQ(Convert(OfType(6), OfType(8), {0.1, 0.1, -0.1})[1], 1.0);
}

TEST(ColorTranslator, NodeSelection) {
    struct Case {
        int32_t source, destination;
        Triple destinationWhite;
        std::vector<int32_t> operations;
    };
    const std::vector<int32_t> direct{cColorTranslator::kConvert};
    const std::vector<int32_t> viaXYZ{cColorTranslator::kToXYZ, cColorTranslator::kFromXYZ};
    const Case cases[] = {{3, 4, kD50, direct},   {4, 3, kD50, direct}, {3, 4, kD65, viaXYZ},
                          {4, 3, kD65, viaXYZ},   {3, 3, kD65, viaXYZ}, {24, 25, kD50, viaXYZ},
                          {26, 27, kD50, viaXYZ}, {8, 6, kD50, viaXYZ}};
    for (const Case& c : cases) {
        cColorTranslator engine;
        engine.SetSource(OfType(c.source));
        engine.SetDestination(OfType(c.destination, c.destinationWhite));
        EXPECT_FALSE(engine.IsFailed());
        ASSERT_EQ(engine.NodeCount(), static_cast<int32_t>(c.operations.size()))
            << c.source << "->" << c.destination;
        for (int32_t k = 0; k < engine.NodeCount(); ++k) EXPECT_EQ(engine.NodeOperation(k), c.operations[k]);
    }
}

TEST(ColorTranslator, RefusedAndFailedPairs) {
    struct Case {
        int32_t source, destination, build, translate;
    };
    constexpr int32_t kNo = kTranslatorRefused;
    // A space converts to itself by copying, even without a node (5, 60, 1).
    const Case cases[] = {{0, 3, 0, 1},   {3, 0, 0, 1},   {5, 3, 0, 1},  {7, 3, 0, 1},   {27, 3, 0, 1},
                          {60, 3, 0, 1},  {3, 5, 0, 1},   {3, 7, 0, 1},  {3, 60, 0, 1},  {9, 3, 0, 1},
                          {22, 3, 0, 1},  {3, 23, 0, 1},  {40, 3, 0, 1}, {84, 3, 0, 1},  {10, 6, 0, 0},
                          {5, 5, 0, 0},   {60, 60, 0, 0}, {1, 1, 0, 0},  {3, 1, kNo, 1}, {1, 3, kNo, 1},
                          {3, 2, kNo, 1}, {6, 2, kNo, 1}};
    for (const Case& c : cases) {
        SCOPED_TRACE(testing::Message() << c.source << "->" << c.destination);
        cColorTranslator engine;
        engine.SetSource(OfType(c.source));
        EXPECT_EQ(engine.SetDestination(OfType(c.destination)), c.build);
        std::array<double, 16> in{};
        std::array<double, 16> out;
        out.fill(-7.0);
        EXPECT_EQ(engine.Translate(in.data(), out.data()), c.translate);
        // Whatever cannot be converted says why.
        EXPECT_EQ(engine.FailureReason().empty(), c.translate == 0) << engine.FailureReason();
        if (c.translate != 0) {
            EXPECT_EQ(out[0], -7.0);
        }
    }
}

TEST(ColorTranslator, ARefusedPairReplacesTheOldChain) {
    cColorTranslator engine;
    engine.SetSource(OfType(3));
    engine.SetDestination(OfType(24));
    ColorSpaceStruct tenDegree = OfType(3);
    tenDegree.observer = 1;
    EXPECT_EQ(engine.SetDestination(tenDegree), kTranslatorRefused);
    EXPECT_EQ(engine.NodeCount(), 0);
    Triple out{-1, -1, -1};
    EXPECT_EQ(engine.Translate(Triple{50, 0, 0}.data(), out.data()), 1);
    EXPECT_EQ(out, (Triple{-1, -1, -1}));
    EXPECT_EQ(engine.SetDestination(OfType(24)), 0);
    EXPECT_EQ(engine.Translate(Triple{50, 0, 0}.data(), out.data()), 0);
}

TEST(ColorTranslator, RangeMapping) {
    // Same space, other ranges: rescaling only.
    ColorSpaceStruct bytes = OfType(6);
    for (int i = 0; i < 3; ++i) bytes.SetMaximum(i, 255.0);
    cColorTranslator engine;
    engine.SetSource(bytes);
    engine.SetDestination(OfType(6));
    EXPECT_TRUE(engine.IsIdentity());
    Triple out{};
    engine.Translate(Triple{255, 51, 0}.data(), out.data());
    ExpectNear(out, {1.0, 0.2, 0.0}, 1e-15);

    // A unit-scale linear sRGB destination scales its 0..255 defaults by 1/255.
    ColorSpaceStruct unitLinear = OfType(25);
    for (int i = 0; i < 3; ++i) unitLinear.SetMaximum(i, 1.0);
    const Triple viaDefault = Convert(OfType(24), OfType(25), {200, 100, 50});
    const Triple viaUnit = Convert(OfType(24), unitLinear, {200, 100, 50});
    for (int i = 0; i < 3; ++i) EXPECT_NEAR(viaUnit[i], viaDefault[i] / 255.0, 1e-15);

    // a* declared as 0..256 maps onto -128..128 and back.
    ColorSpaceStruct shiftedLab = OfType(3);
    shiftedLab.SetMinimum(1, 0.0);
    shiftedLab.SetMaximum(1, 256.0);
    ExpectNear(Convert(shiftedLab, OfType(3), {50, 138, 0}), {50, 10, 0}, 1e-12);
    ExpectNear(Convert(OfType(3), shiftedLab, {50, 10, 0}), {50, 138, 0}, 1e-12);
}

TEST(ColorTranslator, AdaptationMatricesMatchPublishedD65ToD50) {
    struct Case {
        AdaptationMethod method;
        Triple source, destination;
        std::array<double, 9> matrix;
        double tolerance;
    };
    // Bradford: Lindbloom's matrix; CAT02: colour-science's for the whites of the chromaticities
    // (0.3127, 0.3290) and (0.3457, 0.3585). Both use the four-decimal cone matrices.
    const Triple d65xy{0.3127 / 0.3290, 1.0, (1.0 - 0.3127 - 0.3290) / 0.3290};
    const Triple d50xy{0.3457 / 0.3585, 1.0, (1.0 - 0.3457 - 0.3585) / 0.3585};
    // clang-format off
    const Case cases[] = {
        {AdaptationMethod::Bradford, kD65, kD50, {1.0478112, 0.0228866, -0.0501270, 0.0295424, 0.9904844, -0.0170491,
                         -0.0092345, 0.0150436, 0.7521316}, 1e-7},
        {AdaptationMethod::CAT02, d65xy, d50xy, {1.0425738, 0.0308910, -0.0528125, 0.0221934, 1.0018566, -0.0210737,
                           -0.0011648, -0.0034205, 0.7617890}, 2e-7},
        {AdaptationMethod::XYZScaling, kD65, kD50, {0.96422 / 0.95047, 0, 0, 0, 1, 0, 0, 0, 0.82521 / 1.08883}, 1e-15},
    };
    // clang-format on
    for (const Case& c : cases) {
        cColorTranslator engine;
        engine.SetAdaptation(c.method);
        engine.SetSource(OfType(6, c.source));
        engine.SetDestination(OfType(6, c.destination));
        ASSERT_NE(engine.Adaptation(), nullptr);
        for (int i = 0; i < 9; ++i)
            EXPECT_NEAR(engine.Adaptation()->Matrix()[i], c.matrix[i], c.tolerance) << i;
        Triple white{};
        engine.Translate(c.source.data(), white.data());
        ExpectNear(white, c.destination, 1e-12);
    }
    // Sharp and CMCCAT2000 also carry the sRGB white onto a neutral D50 Lab.
    for (AdaptationMethod method : {AdaptationMethod::Sharp, AdaptationMethod::CMCCAT2000}) {
        ExpectNear(Convert(OfType(24, {0.9505, 1.0, 1.089}), OfType(3), {255, 255, 255}, method), {100, 0, 0},
                   1e-9);
    }
}

TEST(ColorTranslator, RoundTripsThroughTheEngine) {
    const ColorSpaceStruct lab = OfType(3);
    const Triple color{62, -18, 33};
    // LCh of another white takes the XYZ chain; RIMM's rounded matrices make its trip only close.
    const std::pair<ColorSpaceStruct, double> cases[] = {
        {OfType(6), 1e-9}, {OfType(8), 1e-9}, {OfType(4), 1e-9}, {OfType(4, kD65), 1e-9}, {OfType(26), 1e-2}};
    for (const auto& [other, tolerance] : cases) {
        SCOPED_TRACE(other.type);
        ExpectNear(Convert(other, lab, Convert(lab, other, color)), color, tolerance);
    }
}

TEST(ColorTranslator, TranslateCollection) {
    cMatrixDC in(2, 3);
    in.At(0, 0) = 100.0;
    in.At(1, 0) = 50.0;
    in.At(1, 1) = 20.0;
    const ColorSpaceStruct lab = OfType(3);
    const ColorSpaceStruct lch = OfType(4);
    in.SetDescription(&lab);
    cMatrixDC out;
    out.SetDescription(&lch);
    cColorTranslator engine;
    EXPECT_EQ(engine.TranslateCollection(in, out), 0);
    ASSERT_EQ(out.Rows(), 2);
    ASSERT_EQ(out.Columns(), 3);
    EXPECT_EQ(out.At(0, 0), 100.0);
    EXPECT_NEAR(out.At(1, 1), 20.0, 1e-12);

    cMatrixDC bare(1, 3);
    EXPECT_EQ(cColorTranslator().TranslateCollection(bare, out), 1);
    cMatrixDC narrow(1, 2);  // rows shorter than the source's channels
    EXPECT_EQ(engine.TranslateCollection(narrow, out), 1);
    const ColorSpaceStruct undefined = OfType(5);
    in.SetDescription(&undefined);
    EXPECT_EQ(engine.TranslateCollection(in, out), 1);
}

}  // namespace
