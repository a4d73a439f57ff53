import math
import random
import subprocess
import sys

import numpy
import pytest

import pigmo

# Published and reference values also checked by the C tests.
CONVERSIONS = [
    (pigmo.lab_to_srgb, (100, 0, 0), (255.0, 252.27, 220.85), 5e-3),
    (pigmo.lab_to_srgb, (50, 0, 0), (128.20, 117.56, 102.04), 5e-3),
    (pigmo.lab_to_srgb, (0, 0, 0), (0, 0, 0), 1e-12),
    (pigmo.srgb_to_lab, (255, 255, 255), (100.0, -2.3829, -19.3737), 5e-5),
    (pigmo.linear_rgb_to_lab, (255, 255, 255), (100.0, -2.3829, -19.3737), 5e-5),
    (pigmo.lab_to_linear_rgb, (100, 0, 0), (1.17600, 0.97581, 0.72195), 5e-6),
    (pigmo.lab_to_lch, (50, 0, -10), (50, 10, 270), 1e-12),
    (pigmo.lch_to_lab, (50, 10, 90), (50, 0, 10), 1e-12),
    (pigmo.spectrum_to_lab, [1.0] * 36, (100, 0, 0), 1e-9),
    (pigmo.spectrum_to_linear_rgb, [1.0] * 36, (1 / 255,) * 3, 2e-5),
]


@pytest.mark.parametrize("convert, color, expected, tolerance", CONVERSIONS, ids=lambda v: getattr(v, "__name__", None))
def test_conversions_give_the_reference_values(convert, color, expected, tolerance):
    result = convert(color)
    assert isinstance(result, tuple)
    assert result == pytest.approx(expected, abs=tolerance)


CONVERTERS = sorted({c[0] for c in CONVERSIONS}, key=lambda f: f.__name__)


@pytest.mark.parametrize("convert", CONVERTERS, ids=lambda f: f.__name__)
def test_arrays_lists_and_single_colors_agree_exactly(convert):
    width = 36 if convert.__name__.startswith("spectrum") else 3
    rng = random.Random(convert.__name__)
    colors = [[rng.uniform(0, 100) if width == 3 else rng.uniform(0, 1) for _ in range(width)] for _ in range(50)]
    from_array = convert(numpy.array(colors))
    assert from_array.shape == (50, 3)
    assert [tuple(row) for row in from_array.tolist()] == convert(colors)
    assert convert(numpy.array(colors[7])).tolist() == list(convert(colors[7]))
    # Any real dtype and any memory layout.
    as_float32 = numpy.asfortranarray(numpy.array(colors, dtype=numpy.float32))
    assert [tuple(row) for row in convert(as_float32).tolist()] == convert(as_float32.astype(numpy.float64).tolist())


# Sharma, Wu & Dalal (2005), Table 1: pairs 1, 7, 17, 25 and 34.
SHARMA = [
    ((50.0, 2.6772, -79.7751), (50.0, 0.0, -82.7485), 2.0425),
    ((50.0, 0.0, 0.0), (50.0, -1.0, 2.0), 2.3669),
    ((50.0, 2.5, 0.0), (73.0, 25.0, -18.0), 27.1492),
    ((60.2574, -34.0099, 36.2677), (60.4626, -34.1751, 39.4387), 1.2644),
    ((2.0776, 0.0795, -1.1350), (0.9033, -0.0636, -0.5514), 0.9082),
]


def test_ciede2000_matches_the_published_pairs_singly_and_as_arrays():
    firsts, seconds, expected = zip(*SHARMA)
    for lab1, lab2, value in SHARMA:
        assert pigmo.delta_e(lab1, lab2) == pytest.approx(value, abs=5e-5)
        assert pigmo.delta_e(lab2, lab1, method="ciede2000") == pytest.approx(value, abs=5e-5)
    assert pigmo.delta_e(numpy.array(firsts), numpy.array(seconds)) == pytest.approx(expected, abs=5e-5)
    from_arrays = pigmo.delta_e(numpy.array(firsts), numpy.array(seconds))
    assert pigmo.delta_e(list(firsts), list(seconds)) == from_arrays.tolist()


@pytest.mark.parametrize(
    "method, weights, lab1, lab2, expected",
    [
        ("cie76", {}, (50, 0, 0), (50, 3, 4), 5.0),
        ("cmc", {}, (50, 20, -30), (55, 18, -25), 3.42184),
        ("cmc", {}, (55, 18, -25), (50, 20, -30), 3.50099),
        ("cmc", {"l": 1, "c": 1}, (50, 20, -30), (55, 18, -25), 5.24780),
        ("cie94", {}, (50, 20, -30), (55, 18, -25), 5.44188),
        ("cie94", {"kl": 2}, (40, 10, 10), (50, 10, 10), 5.0),
        ("ciede2000", {}, (50, 20, -30), (55, 18, -25), 5.50085),
    ],
)
def test_each_method_and_its_weights(method, weights, lab1, lab2, expected):
    single = pigmo.delta_e(lab1, lab2, method, **weights)
    assert single == pytest.approx(expected, abs=5e-6)
    many = pigmo.delta_e(numpy.array([lab1, lab2]), numpy.array([lab2, lab1]), method, **weights)
    assert many[0] == single
    assert many[1] == pigmo.delta_e(lab2, lab1, method, **weights)


@pytest.mark.parametrize(
    "call, error, words",
    [
        (lambda: pigmo.lab_to_srgb(numpy.zeros((4, 2))), ValueError, "shape (N, 3), got (4, 2)"),
        (lambda: pigmo.spectrum_to_lab(numpy.zeros((2, 3))), ValueError, "shape (N, 36), got (2, 3)"),
        (lambda: pigmo.lab_to_srgb(numpy.zeros((2, 3, 3))), ValueError, "got (2, 3, 3)"),
        (lambda: pigmo.lab_to_srgb(numpy.array([["a", "b", "c"]])), TypeError, "real numbers"),
        (lambda: pigmo.lab_to_srgb((1, 2)), ValueError, "expected 3 values, got 2"),
        (lambda: pigmo.lab_to_srgb("abc"), TypeError, "sequence of 3 numbers"),
        (lambda: pigmo.srgb_to_lab((1, "x", 3)), TypeError, "every value must be a number"),
        (lambda: pigmo.delta_e((50, 0, 0), (50, 0, 0), "cie2000"), ValueError, "unknown method 'cie2000'"),
        (lambda: pigmo.delta_e((50, 0, 0), (50, 0, 0), "cmc", kl=2), TypeError, "takes the weights"),
        (lambda: pigmo.delta_e((50, 0, 0), (50, 0, 0), "cie94", kc=0), ValueError, "positive"),
        (lambda: pigmo.delta_e(numpy.zeros((2, 3)), numpy.zeros((3, 3))), ValueError, "hold 2 and 3 colors"),
        (lambda: pigmo.harmony((50, 0, 0), "square"), ValueError, "unknown kind 'square'"),
        (lambda: pigmo.nearest_centroid((math.nan, 0, 0)), ValueError, "not a finite color"),
        (lambda: pigmo.centroid(268), IndexError, "from 1 to 267"),
    ],
)
def test_bad_input_raises_a_clear_error(call, error, words):
    with pytest.raises(error) as raised:
        call()
    assert words in str(raised.value)


def test_catalogue_and_harmonies():
    found = pigmo.nearest_centroid((50, 20, -30))
    assert (found.index, found.name, found.category) == (206, "Brilliant Violet", "Violet")
    assert pigmo.nearest_centroid(pigmo.centroid(1).lab).name == "Vivid Pink"
    # Triadic companions keep the lightness and turn the hue on the painter's wheel.
    companions = pigmo.harmony((60, 40 * math.cos(math.pi / 6), 40 * math.sin(math.pi / 6)), "triadic")
    assert [pigmo.lab_to_lch(lab)[2] for lab in companions] == pytest.approx([257.38, 97.61], abs=0.01)
    assert len(pigmo.harmony((50, 10, 10), "complement")) == 1


def test_sequences_work_without_numpy():
    code = "import sys; sys.modules['numpy'] = None; import pigmo; print(pigmo.lab_to_srgb([(50, 0, 0)])[0][0])"
    run = subprocess.run([sys.executable, "-c", code], capture_output=True, text=True, check=False)
    assert run.returncode == 0, run.stderr
    assert float(run.stdout) == pigmo.lab_to_srgb((50, 0, 0))[0]
