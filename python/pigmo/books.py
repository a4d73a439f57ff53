"""Color books (CxF 2.1 files) and the palettes found on this machine."""

import ctypes
import os
from collections.abc import Iterator
from typing import Any, NamedTuple, Union

from . import _values
from ._native import lib
from ._values import Color


class ColorBookError(Exception):
    """A color book that cannot be read; the message is the reader's, naming the file."""


def html_color(srgb: Any) -> str:
    """The "#RRGGBB" code of gamma-encoded sRGB on 0..255, each channel truncated after adding 0.01."""
    code = ctypes.create_string_buffer(8)
    lib.BPGetHtmlColorCode(_values.doubles(srgb, 3, "html_color"), code, len(code))
    return code.value.decode()


def _text(value: bytes) -> str:
    # Books are UTF-8 by rule, not always in fact.
    return value.decode("utf-8", errors="replace")


class BookColor(NamedTuple):
    """One color of a book, with the values the book leaves out derived."""

    name: str
    category: str
    lab: Color  #: L*, a*, b* (D50 white)
    srgb: Color  #: gamma-encoded, 0 to 255, always from the CIELAB value
    linear_rgb: Color  #: linear sRGB, 0 to 1: what the Color Map renders
    tags: tuple[str, ...]
    reflectance: tuple[float, ...]  #: in the book's order; 36 values are 380 to 730 nm by 10 nm

    @property
    def html(self) -> str:
        """The "#RRGGBB" code of the sRGB value."""
        return html_color(self.srgb)


class ColorBook:
    """A CxF 2.1 color book, read whole when it opens.

    >>> book = ColorBook("ISCC-NBS Centroid Colors.cxf")
    >>> book.name, len(book), book[0].name
    ('ISCC-NBS Centroid Colors', 267, 'Vivid Pink')

    Raises ColorBookError with the reader's message when the file is missing or is not a version 2.1
    book. Colors are indexed from 0; negative indices count from the end.
    """

    def __init__(self, path: Union[str, os.PathLike]) -> None:
        self.path = os.fspath(path)
        error = ctypes.create_string_buffer(1024)
        self._handle = lib.BPColorBookOpen(os.fsencode(self.path), error, len(error))
        if not self._handle:
            raise ColorBookError(_text(error.value))
        self.name: str = _text(lib.BPColorBookGetName(self._handle))
        self._count: int = lib.BPColorBookGetColorCount(self._handle)

    def __del__(self) -> None:
        handle, self._handle = getattr(self, "_handle", None), None
        # At interpreter exit the module's globals may already be gone.
        if handle and lib is not None:
            lib.BPColorBookClose(handle)

    def __len__(self) -> int:
        return self._count

    def __getitem__(self, index: int) -> BookColor:
        if not isinstance(index, int):
            raise TypeError(f"ColorBook indices are integers, not {type(index).__name__}")
        if index < 0:
            index += self._count
        if not 0 <= index < self._count:
            raise IndexError(f"color index out of range: {self.path} holds {self._count} colors")
        return self._color(index)

    def __iter__(self) -> Iterator[BookColor]:
        return (self._color(i) for i in range(self._count))

    def __repr__(self) -> str:
        return f"ColorBook({self.path!r}: {self.name!r}, {self._count} colors)"

    def _color(self, index: int) -> BookColor:
        handle = self._handle
        triples = []
        for getter in (lib.BPColorBookGetColorLab, lib.BPColorBookGetColorSRGB, lib.BPColorBookGetColorLinearRGB):
            out = (ctypes.c_double * 3)()
            getter(handle, index, out)
            triples.append((out[0], out[1], out[2]))
        curve = (ctypes.c_double * lib.BPColorBookGetColorReflectanceCount(handle, index))()
        lib.BPColorBookGetColorReflectance(handle, index, curve, len(curve))
        tags = tuple(
            _text(lib.BPColorBookGetColorTag(handle, index, t))
            for t in range(lib.BPColorBookGetColorTagCount(handle, index))
        )
        return BookColor(
            _text(lib.BPColorBookGetColorName(handle, index)),
            _text(lib.BPColorBookGetColorCategory(handle, index)),
            *triples,
            tags,
            tuple(curve),
        )


class Palette(NamedTuple):
    """A palette file found on this machine."""

    name: str  #: the book's palette name; empty when the file cannot be read as a book
    path: str
    kind: str  #: "system" or "user"


def palettes() -> list[Palette]:
    """The palettes found: the system palettes of the installation, then the user's own, in
    ~/.local/share/Pigmo/Tintora/User/ (or below $XDG_DATA_HOME), each in name order."""
    found = lib.BPPaletteListFind()
    if not found:
        raise MemoryError("palettes: out of memory")
    try:
        return [
            Palette(
                _text(lib.BPPaletteListGetName(found, i)),
                os.fsdecode(lib.BPPaletteListGetPath(found, i)),
                "user" if lib.BPPaletteListIsUser(found, i) == 1 else "system",
            )
            for i in range(lib.BPPaletteListGetCount(found))
        ]
    finally:
        lib.BPPaletteListFree(found)
