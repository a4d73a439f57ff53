"""Colors in and out of the C functions: one color as a sequence, many as a list or a numpy array."""

import ctypes
from collections.abc import Callable, Sequence
from typing import Any, Union

try:
    import numpy
except ImportError:  # numpy is optional; without it colors are sequences only
    numpy = None

Color = tuple[float, float, float]
Array = Any if numpy is None else numpy.ndarray
# One color, a list of colors, or an (N, width) array of them.
ColorInput = Union[Sequence[float], Sequence[Sequence[float]], Array]

_double_p = ctypes.POINTER(ctypes.c_double)


def is_array(value: Any) -> bool:
    return numpy is not None and isinstance(value, numpy.ndarray)


def doubles(values: Sequence[float], width: int, what: str) -> ctypes.Array:
    """One color as a C array of width doubles; a clear error for anything else."""
    if isinstance(values, (str, bytes)) or not isinstance(values, Sequence):
        raise TypeError(f"{what}: expected a sequence of {width} numbers, got {type(values).__name__}")
    if len(values) != width:
        raise ValueError(f"{what}: expected {width} values, got {len(values)}")
    try:
        return (ctypes.c_double * width)(*(float(v) for v in values))
    except (TypeError, ValueError):
        raise TypeError(f"{what}: every value must be a number, got {list(values)!r}") from None


def rows(array: Array, width: int, what: str) -> Array:
    """A C-ordered float64 copy or view of an (N, width) array, or of one (width,) color as (1, width)."""
    if array.ndim == 1:
        array = array.reshape(1, -1)
    if array.ndim != 2 or array.shape[1] != width:
        raise ValueError(f"{what}: expected an array of shape (N, {width}), got {array.shape}")
    if not numpy.issubdtype(array.dtype, numpy.number) or numpy.issubdtype(array.dtype, numpy.complexfloating):
        raise TypeError(f"{what}: expected an array of real numbers, got dtype {array.dtype}")
    return numpy.ascontiguousarray(array, dtype=numpy.float64)


def pointer(array: Array) -> Any:
    return array.ctypes.data_as(_double_p)


def is_color_list(values: Any) -> bool:
    """A list of colors rather than one color: its first item is itself a sequence."""
    return (
        isinstance(values, Sequence)
        and not isinstance(values, (str, bytes))
        and len(values) > 0
        and isinstance(values[0], Sequence)
        and not isinstance(values[0], (str, bytes))
    )


def per_color(values: ColorInput, one: Callable[[Any], Any], many: Callable[[Array], Any]) -> Any:
    """Calls one for a single color, once per color for a list, and many for a numpy array."""
    if is_array(values):
        return many(values)
    if is_color_list(values):
        return [one(color) for color in values]
    return one(values)
