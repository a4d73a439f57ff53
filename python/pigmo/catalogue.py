"""The ISCC-NBS centroid catalogue, color harmonies and the dominant colors of an image."""

import ctypes
import os
from typing import Any, NamedTuple, Union

from . import _values
from ._native import lib
from ._values import Color


class Centroid(NamedTuple):
    """One of the 267 ISCC-NBS centroid colors."""

    index: int  #: 1 to 267
    name: str  #: e.g. "Vivid Pink"
    category: str  #: one of the 19 hue categories, e.g. "Red/Pink"
    lab: Color  #: L*, a*, b* (D50 white)


def centroid(index: int) -> Centroid:
    """The centroid with this index, 1 to 267."""
    if not 1 <= index <= lib.BPCentroidGetCount():
        raise IndexError(f"centroid: index {index} is not from 1 to {lib.BPCentroidGetCount()}")
    lab = lib.BPCentroidGetLab(index)
    return Centroid(
        index,
        lib.BPCentroidGetName(index).decode(),
        lib.BPCentroidGetCategoryName(lib.BPCentroidGetCategory(index)).decode(),
        (lab[0], lab[1], lab[2]),
    )


def nearest_centroid(lab: Any) -> Centroid:
    """The ISCC-NBS centroid nearest to an L*, a*, b* color (CIE76 distance)."""
    index = lib.BPCentroidGetForLab(_values.doubles(lab, 3, "nearest_centroid"))
    if index < 1:
        raise ValueError(f"nearest_centroid: {list(lab)} is not a finite color")
    return centroid(index)


_HARMONIES = {
    "monochromatic": (lib.BPHarmonyGetMonochromatic, 2),
    "near": (lib.BPHarmonyGetNearNeighbor, 2),
    "far": (lib.BPHarmonyGetFarNeighbor, 2),
    "triadic": (lib.BPHarmonyGetTriadic, 2),
    "complement": (lib.BPHarmonyGetComplement, 1),
}


def harmony(lab: Any, kind: str) -> list[Color]:
    """Companions of an L*, a*, b* color on a twelve-sector painter's wheel.

    kind is "monochromatic" (the same hue at two other lightnesses), "near" (30 degrees either way),
    "far" (150), "triadic" (120) or "complement" (180, one color).
    """
    try:
        function, count = _HARMONIES[kind]
    except KeyError:
        raise ValueError(f"harmony: unknown kind {kind!r}; use one of {', '.join(_HARMONIES)}") from None
    outs = [(ctypes.c_double * 3)() for _ in range(count)]
    if function(_values.doubles(lab, 3, "harmony"), *outs) != 1:
        raise RuntimeError(f"harmony: the {kind} colors of {list(lab)} could not be converted")
    return [(out[0], out[1], out[2]) for out in outs]


def dominant_colors(
    image: Union[str, os.PathLike, _values.Array], count: int = 10, max_pixels: int = 100_000_000
) -> list[Color]:
    """The dominant colors of an image as L*, a*, b* triples, the largest group first.

    image is a PNG, JPEG, BMP or TGA file, or a numpy array of 8-bit RGB or RGBA pixels of shape
    (height, width, 3 or 4); transparency is ignored. At most count colors (1 to 267) come back, fewer
    when fewer groups stand apart. A file of more than max_pixels pixels is refused before decoding.
    """
    total = lib.BPCentroidGetCount()
    if not 1 <= count <= total:
        raise ValueError(f"dominant_colors: count {count} is not from 1 to {total}")
    lab = (ctypes.c_double * (3 * count))()
    found = ctypes.c_int(0)
    if _values.is_array(image):
        if image.ndim != 3 or image.shape[2] not in (3, 4):
            raise ValueError(f"dominant_colors: expected pixels of shape (height, width, 3 or 4), got {image.shape}")
        if image.dtype != _values.numpy.uint8:
            raise TypeError(f"dominant_colors: expected 8-bit pixels (uint8), got dtype {image.dtype}")
        # The library reads one padding byte, then red, green, blue.
        argb = _values.numpy.zeros(image.shape[:2] + (4,), dtype=_values.numpy.uint8)
        argb[..., 1:] = image[..., :3]
        lib.BPImageExtractLab(argb.tobytes(), image.shape[1], image.shape[0], count, lab, ctypes.byref(found))
        colors = [tuple(lab[3 * i : 3 * i + 3]) for i in range(found.value)]
        # Once no group stands apart the last color repeats; the repeats say nothing new.
        return [color for i, color in enumerate(colors) if i == 0 or color != colors[i - 1]]
    error = ctypes.create_string_buffer(1024)
    path = os.fsencode(image)
    if not lib.BPImageFileExtractLab(path, max_pixels, count, lab, ctypes.byref(found), error, len(error)):
        raise ValueError(error.value.decode(errors="replace"))
    return [tuple(lab[3 * i : 3 * i + 3]) for i in range(found.value)]
