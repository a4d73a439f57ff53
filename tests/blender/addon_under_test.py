"""Enables the add-on from the build tree inside the running Blender, on the built library.

Arguments after "--": the assembled add-on folder's parent, the built libpigmo.so, the shipped palettes.
"""

import sys
from pathlib import Path

import addon_utils
import bpy

ADDON_DIR, LIBRARY, PALETTES = (Path(a) for a in sys.argv[sys.argv.index("--") + 1 :][:3])
CENTROID_BOOK = PALETTES / "ISCC-NBS Centroid Colors.cxf"


def enable():
    sys.path.insert(0, str(ADDON_DIR))
    module = addon_utils.enable("pigmo_colormap", default_set=True, handle_error=None)
    assert module is not None, "the add-on did not enable"
    bpy.context.preferences.addons["pigmo_colormap"].preferences.library_path = str(LIBRARY)
    from pigmo_colormap import library

    pigmo = library.pigmo()
    assert pigmo is not None, library.problem()
    return pigmo


def in_gamut_color(pigmo, book_path):
    """Index and record of the first color whose sRGB lies well inside 0..255 on every channel."""
    book = pigmo.ColorBook(book_path)
    return next((i, c) for i, c in enumerate(book) if all(5 < v < 250 for v in c.srgb))
