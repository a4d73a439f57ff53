"""Finding and loading libpigmo.so, and the C signatures the package calls."""

import ctypes
import os
from pathlib import Path

_double_p = ctypes.POINTER(ctypes.c_double)
_char_p = ctypes.c_char_p
_int = ctypes.c_int
_size = ctypes.c_size_t
_book_p = ctypes.c_void_p
_list_p = ctypes.c_void_p

# name: (result type, argument types)
_SIGNATURES: dict[str, tuple[object, list[object]]] = {
    "BPGetHtmlColorCode": (_int, [_double_p, _char_p, _size]),
    "BPCalculateDeltaE": (ctypes.c_double, [_double_p, _double_p]),
    "BPCalculateDeltaECMC": (ctypes.c_double, [_double_p, _double_p, ctypes.c_double, ctypes.c_double]),
    "BPCalculateDeltaE94": (ctypes.c_double, [_double_p, _double_p] + [ctypes.c_double] * 3),
    "BPCalculateDeltaE2000": (ctypes.c_double, [_double_p, _double_p] + [ctypes.c_double] * 3),
    "BPCalculateDeltaEArray": (_int, [_double_p, _double_p, _double_p, _size]),
    "BPCalculateDeltaECMCArray": (_int, [_double_p, _double_p, _double_p, _size] + [ctypes.c_double] * 2),
    "BPCalculateDeltaE94Array": (_int, [_double_p, _double_p, _double_p, _size] + [ctypes.c_double] * 3),
    "BPCalculateDeltaE2000Array": (_int, [_double_p, _double_p, _double_p, _size] + [ctypes.c_double] * 3),
    "BPCentroidGetCount": (_int, []),
    "BPCentroidGetCategory": (_int, [_int]),
    "BPCentroidGetCategoryName": (_char_p, [_int]),
    "BPCentroidGetName": (_char_p, [_int]),
    "BPCentroidGetLab": (_double_p, [_int]),
    "BPCentroidGetForLab": (_int, [_double_p]),
    "BPHarmonyGetMonochromatic": (_int, [_double_p, _double_p, _double_p]),
    "BPHarmonyGetNearNeighbor": (_int, [_double_p, _double_p, _double_p]),
    "BPHarmonyGetFarNeighbor": (_int, [_double_p, _double_p, _double_p]),
    "BPHarmonyGetTriadic": (_int, [_double_p, _double_p, _double_p]),
    "BPHarmonyGetComplement": (_int, [_double_p, _double_p]),
    "BPImageExtractLab": (None, [ctypes.c_char_p, _int, _int, _int, _double_p, ctypes.POINTER(_int)]),
    "BPImageFileExtractLab": (
        _int,
        [_char_p, ctypes.c_longlong, _int, _double_p, ctypes.POINTER(_int), ctypes.c_char_p, _size],
    ),
    "BPColorBookOpen": (_book_p, [_char_p, ctypes.c_char_p, _size]),
    "BPColorBookClose": (None, [_book_p]),
    "BPColorBookGetName": (_char_p, [_book_p]),
    "BPColorBookGetColorCount": (_int, [_book_p]),
    "BPColorBookGetColorName": (_char_p, [_book_p, _int]),
    "BPColorBookGetColorCategory": (_char_p, [_book_p, _int]),
    "BPColorBookGetColorLab": (_int, [_book_p, _int, _double_p]),
    "BPColorBookGetColorSRGB": (_int, [_book_p, _int, _double_p]),
    "BPColorBookGetColorLinearRGB": (_int, [_book_p, _int, _double_p]),
    "BPColorBookGetColorTagCount": (_int, [_book_p, _int]),
    "BPColorBookGetColorTag": (_char_p, [_book_p, _int, _int]),
    "BPColorBookGetColorReflectanceCount": (_int, [_book_p, _int]),
    "BPColorBookGetColorReflectance": (_int, [_book_p, _int, _double_p, _int]),
    "BPPaletteListFind": (_list_p, []),
    "BPPaletteListFree": (None, [_list_p]),
    "BPPaletteListGetCount": (_int, [_list_p]),
    "BPPaletteListGetName": (_char_p, [_list_p, _int]),
    "BPPaletteListGetPath": (_char_p, [_list_p, _int]),
    "BPPaletteListIsUser": (_int, [_list_p, _int]),
}

# The one-color conversions and their array forms share one shape: (in, out) and (in, out, count).
CONVERSIONS = (
    "BPConvert36BandSpectral2LabD502",
    "BPConvert36BandSpectral2LinearsRGB",
    "BPConvertsRGB2Lab",
    "BPConvertLab2sRGB",
    "BPConvertsLinearRGB2Lab",
    "BPConvertLab2LinearsRGB",
    "BPConvertLCh2Lab",
    "BPConvertLab2LCh",
)
for _name in CONVERSIONS:
    _SIGNATURES[_name] = (_int, [_double_p, _double_p])
    _SIGNATURES[_name + "Array"] = (_int, [_double_p, _double_p, _size])

LIBRARY_NAME = "libpigmo.so"


def candidates() -> list[tuple[str, str]]:
    """Where the library is looked for, in order, as (what, path or name) pairs."""
    # Installed as <prefix>/lib/python3/dist-packages/pigmo/, beside <prefix>/lib/libpigmo.so. Elsewhere
    # (a source tree) the folders above mean nothing, and a stray library there must not be loaded.
    package = Path(__file__).resolve().parent
    places = []
    if [folder.name for folder in list(package.parents)[:3]] == ["dist-packages", "python3", "lib"]:
        places.append(("beside the installed package", str(package.parents[2] / LIBRARY_NAME)))
    override = os.environ.get("PIGMO_LIBRARY")
    if override:
        places.append(("PIGMO_LIBRARY", override))
    places.append(("the system's library path", LIBRARY_NAME))
    return places


def load() -> ctypes.CDLL:
    """Loads the first library found and declares its functions; ImportError says where it looked."""
    tried = []
    for what, place in candidates():
        if os.sep in place and not os.path.isfile(place):
            tried.append(f"{place} ({what}: no such file)")
            continue
        try:
            library = ctypes.CDLL(place)
        except OSError as error:
            tried.append(f"{place} ({what}: {error})")
            continue
        try:
            for name, (result, arguments) in _SIGNATURES.items():
                function = getattr(library, name)
                function.restype = result
                function.argtypes = arguments
        except AttributeError as error:
            tried.append(f"{place} ({what}: too old, {error})")
            continue
        return library
    if not os.environ.get("PIGMO_LIBRARY"):
        tried.append("PIGMO_LIBRARY (not set)")
    raise ImportError("pigmo: cannot load libpigmo.so; looked at " + "; ".join(tried))


lib = load()
