"""Pigmo: measured color in Python.

The color library of Pigmo Color Map, over libpigmo.so (ctypes, no compiled extension).

Conversions (L* 0..100 against a D50 white, sRGB 0..255, hue in degrees, 36-band reflectance
380..730 nm by 10 nm)::

    >>> import pigmo
    >>> pigmo.lab_to_srgb((50, 0, 0))
    (128.203525349172, 117.56399625828564, 102.03851396073598)
    >>> pigmo.srgb_to_lab([(255, 255, 255), (0, 0, 0)])
    [(100.0, -2.382857620387202, -19.37365015457928), (0.0, 0.0, 0.0)]

lab_to_srgb, srgb_to_lab, lab_to_linear_rgb, linear_rgb_to_lab, lab_to_lch, lch_to_lab,
spectrum_to_lab and spectrum_to_linear_rgb take one color, a list of colors, or a numpy array of
shape (N, 3) (N, 36 for spectra) that is converted in one call.

Color science:
    delta_e(lab1, lab2, method="ciede2000")   also "cie94", "cmc", "cie76"; numpy arrays too
    nearest_centroid(lab)                      the nearest ISCC-NBS centroid: index, name, category, lab
    centroid(index)                            one of the 267 centroids
    harmony(lab, "triadic")                    also "monochromatic", "near", "far", "complement"
    dominant_colors(path_or_pixels, count)     the main colors of an image file or a uint8 array

Color books and palettes:
    book = ColorBook(path)                     book.name, len(book), book[i], iteration
    book[i].name, .category, .lab, .srgb, .linear_rgb, .tags, .reflectance, .html
    ColorBookError                             raised with the reader's message
    palettes()                                 the palettes found: .name, .path, .kind ("system"/"user")
    html_color(srgb)                           "#RRGGBB"

The library is looked for beside the installed package (<prefix>/lib/libpigmo.so), then at
$PIGMO_LIBRARY, then on the system's library path; importing fails with an ImportError that says
where it looked.
"""

from .books import BookColor, ColorBook, ColorBookError, Palette, html_color, palettes
from .catalogue import Centroid, centroid, dominant_colors, harmony, nearest_centroid
from .conversions import (
    delta_e,
    lab_to_lch,
    lab_to_linear_rgb,
    lab_to_srgb,
    lch_to_lab,
    linear_rgb_to_lab,
    spectrum_to_lab,
    spectrum_to_linear_rgb,
    srgb_to_lab,
)

__all__ = [
    "BookColor",
    "Centroid",
    "ColorBook",
    "ColorBookError",
    "Palette",
    "centroid",
    "delta_e",
    "dominant_colors",
    "harmony",
    "html_color",
    "lab_to_lch",
    "lab_to_linear_rgb",
    "lab_to_srgb",
    "lch_to_lab",
    "linear_rgb_to_lab",
    "nearest_centroid",
    "palettes",
    "spectrum_to_lab",
    "spectrum_to_linear_rgb",
    "srgb_to_lab",
]
