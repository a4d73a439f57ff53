"""Conversions between CIELAB, LCh, sRGB, linear sRGB and 36-band reflectance, and color differences.

Scales are those of the C interface: L* 0 to 100 with a D50 white (0.96422, 1.0, 0.82521); sRGB
gamma-encoded on 0 to 255; hue angles in degrees; reflectance as 36 factors from 380 to 730 nm by
10 nm. Each function takes one color (a sequence of numbers, answered with a tuple), a list of colors
(answered with a list of tuples) or a numpy array of shape (N, 3) or (N, 36) (answered with an
(N, 3) array, computed in one call of the library's array functions).
"""

from __future__ import annotations

import ctypes
from typing import Any

from . import _values
from ._native import lib
from ._values import Color, ColorInput


def _converter(name: str, width: int, doc: str):
    single = getattr(lib, name)
    array = getattr(lib, name + "Array")
    python_name = doc.split(":", 1)[0]

    def one(color: Any) -> Color:
        values = _values.doubles(color, width, python_name)
        out = (ctypes.c_double * 3)()
        if single(values, out) != 1:
            raise RuntimeError(f"{python_name}: the conversion failed")
        return (out[0], out[1], out[2])

    def many(colors: Any) -> Any:
        table = _values.rows(colors, width, python_name)
        out = _values.numpy.empty((table.shape[0], 3))
        if array(_values.pointer(table), _values.pointer(out), table.shape[0]) != 1:
            raise RuntimeError(f"{python_name}: the conversion failed")
        return out.reshape(3) if colors.ndim == 1 else out

    def convert(color: ColorInput) -> Any:
        return _values.per_color(color, one, many)

    convert.__name__ = convert.__qualname__ = python_name
    convert.__doc__ = doc.split(":", 1)[1].strip()
    return convert


lab_to_srgb = _converter(
    "BPConvertLab2sRGB", 3, "lab_to_srgb: L*, a*, b* to gamma-encoded sRGB on 0..255, clamped, not rounded."
)
srgb_to_lab = _converter("BPConvertsRGB2Lab", 3, "srgb_to_lab: Gamma-encoded sRGB on 0..255 to L*, a*, b*.")
lab_to_linear_rgb = _converter(
    "BPConvertLab2LinearsRGB", 3, "lab_to_linear_rgb: L*, a*, b* to linear sRGB on 0..1, not clamped."
)
linear_rgb_to_lab = _converter(
    "BPConvertsLinearRGB2Lab", 3, "linear_rgb_to_lab: Linear sRGB on 0..255 (not 0..1) to L*, a*, b*."
)
lab_to_lch = _converter("BPConvertLab2LCh", 3, "lab_to_lch: L*, a*, b* to L*, chroma, hue in degrees (0 to 360).")
lch_to_lab = _converter("BPConvertLCh2Lab", 3, "lch_to_lab: L*, chroma, hue in degrees to L*, a*, b*.")
spectrum_to_lab = _converter(
    "BPConvert36BandSpectral2LabD502",
    36,
    "spectrum_to_lab: 36 reflectance factors (380 to 730 nm by 10 nm) to L*, a*, b* under D50.",
)
spectrum_to_linear_rgb = _converter(
    "BPConvert36BandSpectral2LinearsRGB",
    36,
    "spectrum_to_linear_rgb: 36 reflectance factors to linear sRGB divided by 255 (a white reflector "
    "gives about 1/255), as the C function answers.",
)

# method: (single-pair function, array function, weight names, default weights)
_METHODS = {
    "ciede2000": (lib.BPCalculateDeltaE2000, lib.BPCalculateDeltaE2000Array, ("kl", "kc", "kh"), (1.0, 1.0, 1.0)),
    "cie94": (lib.BPCalculateDeltaE94, lib.BPCalculateDeltaE94Array, ("kl", "kc", "kh"), (1.0, 1.0, 1.0)),
    "cmc": (lib.BPCalculateDeltaECMC, lib.BPCalculateDeltaECMCArray, ("l", "c"), (2.0, 1.0)),
    "cie76": (lib.BPCalculateDeltaE, lib.BPCalculateDeltaEArray, (), ()),
}


def delta_e(lab1: ColorInput, lab2: ColorInput, method: str = "ciede2000", **weights: float) -> Any:
    """Color difference of lab2 from the reference lab1.

    method is "ciede2000" (default), "cie94", "cmc" or "cie76". Weights go by name: kl, kc, kh for
    CIEDE2000 and CIE94 (default 1 each), l and c for CMC (default 2 and 1); CIE94 and CMC weight by
    the reference, so the order matters. Two colors give a float, two lists of colors a list, and two
    numpy arrays of shape (N, 3) an array of N differences.
    """
    try:
        single, array, names, defaults = _METHODS[method]
    except KeyError:
        raise ValueError(f"delta_e: unknown method {method!r}; use one of {', '.join(_METHODS)}") from None
    unknown = set(weights) - set(names)
    if unknown:
        raise TypeError(f"delta_e: {method} takes the weights {names or 'none'}, not {', '.join(sorted(unknown))}")
    factors = [float(weights.get(name, default)) for name, default in zip(names, defaults)]
    # Each formula divides by its weights.
    if not all(factor > 0 for factor in factors):
        raise ValueError(f"delta_e: weights must be positive, got {dict(zip(names, factors))}")

    if _values.is_array(lab1) or _values.is_array(lab2):
        first = _values.rows(_values.numpy.asarray(lab1), 3, "delta_e")
        second = _values.rows(_values.numpy.asarray(lab2), 3, "delta_e")
        if first.shape != second.shape:
            raise ValueError(f"delta_e: the arrays hold {first.shape[0]} and {second.shape[0]} colors")
        out = _values.numpy.empty(first.shape[0])
        array(_values.pointer(first), _values.pointer(second), _values.pointer(out), first.shape[0], *factors)
        return float(out[0]) if _values.numpy.ndim(lab1) == 1 and _values.numpy.ndim(lab2) == 1 else out
    if _values.is_color_list(lab1) or _values.is_color_list(lab2):
        if len(lab1) != len(lab2):
            raise ValueError(f"delta_e: the lists hold {len(lab1)} and {len(lab2)} colors")
        return [delta_e(a, b, method, **weights) for a, b in zip(lab1, lab2)]
    return single(_values.doubles(lab1, 3, "delta_e"), _values.doubles(lab2, 3, "delta_e"), *factors)
