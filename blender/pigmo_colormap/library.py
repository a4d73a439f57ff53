"""Finding libpigmo.so and loading the pigmo package that ships inside the add-on."""

import importlib
import os
from pathlib import Path
from types import ModuleType
from typing import Optional

import bpy

LIBRARY_NAME = "libpigmo.so"
# Where `cmake --install` puts Pigmo when no other prefix is given, then distribution packages.
USUAL_PREFIXES = ("/usr/local", "/usr", "/opt/pigmo")

_loaded: Optional[ModuleType] = None
_problem = ""


class PigmoPreferences(bpy.types.AddonPreferences):
    bl_idname = __package__

    library_path: bpy.props.StringProperty(
        name="Pigmo library",
        description="libpigmo.so to use instead of the one installed beside the add-on or in /usr/local, /usr "
        "or /opt/pigmo",
        subtype="FILE_PATH",
        update=lambda self, context: forget_failure(),
    )

    def draw(self, context: bpy.types.Context) -> None:
        self.layout.prop(self, "library_path")
        if _problem:
            self.layout.label(text=_problem, icon="ERROR")


def candidates(preference: str) -> list[Path]:
    """Library files to try, in order: the preference, beside the add-on's own installation, the
    usual prefixes."""
    places = [Path(bpy.path.abspath(preference))] if preference else []
    # Installed as <prefix>/share/pigmo/blender/pigmo_colormap/, beside <prefix>/lib/libpigmo.so.
    places.append(Path(__file__).resolve().parents[4] / "lib" / LIBRARY_NAME)
    places += [Path(prefix) / "lib" / LIBRARY_NAME for prefix in USUAL_PREFIXES]
    return places


def forget_failure() -> None:
    """Lets the next use try again, after the preference changed."""
    global _problem
    _problem = ""


def pigmo() -> Optional[ModuleType]:
    """The pigmo package over the first library found, or None with problem() saying why."""
    global _loaded, _problem
    if _loaded is not None or _problem:
        return _loaded
    preference = bpy.context.preferences.addons[__package__].preferences.library_path
    places = candidates(preference)
    found = next((place for place in places if place.is_file()), None)
    if found is not None:
        os.environ["PIGMO_LIBRARY"] = str(found)
    try:
        _loaded = importlib.import_module(".pigmo", __package__)
    except ImportError as error:
        if found is None:
            _problem = f"{LIBRARY_NAME} not found; looked at " + ", ".join(str(place) for place in places)
        else:
            _problem = f"{found} cannot be used: {error}"
    return _loaded


def problem() -> str:
    return _problem
