"""Picks a color of a shipped book, saves the .blend, removes the book and checks the pick in a new
Blender process; failing books leave the material untouched."""

import json
import shutil
import subprocess
import sys
import tempfile
from pathlib import Path

import bpy

sys.path.insert(0, str(Path(__file__).parent))
import addon_under_test  # noqa: E402

FIELDS = ("book", "index", "name", "category", "lab", "srgb", "html", "linear_rgb", "tags", "reflectance")


def snapshot(material):
    tree = material.node_tree
    return (
        material.get("pigmo") and material["pigmo"].to_dict(),
        [(n.name, n.bl_idname) for n in tree.nodes],
        [(l.from_node.name, l.to_socket.name) for l in tree.links],
        tuple(tree.nodes["Pigmo Color"].outputs[0].default_value) if "Pigmo Color" in tree.nodes else None,
    )


def close(a, b, tolerance=1e-5):
    return len(a) == len(b) and all(abs(x - y) <= tolerance for x, y in zip(a, b))


def pick_and_save(work):
    pigmo = addon_under_test.enable()
    book = work / "book.cxf"
    shutil.copy(addon_under_test.CENTROID_BOOK, book)
    index, color = addon_under_test.in_gamut_color(pigmo, book)

    cube = bpy.data.objects["Cube"]
    bpy.context.view_layer.objects.active = cube
    assert bpy.ops.pigmo.pick_color(filepath=str(book), index=index) == {"FINISHED"}
    material = cube.active_material
    node = material.node_tree.nodes["Pigmo Color"]
    assert node.bl_idname == "ShaderNodeRGB"
    assert close(node.outputs[0].default_value, (*color.linear_rgb, 1.0)), node.outputs[0].default_value[:]
    base = material.node_tree.nodes["Principled BSDF"].inputs["Base Color"]
    assert base.links[0].from_node == node

    # Failing books and a color past the end change nothing and report the reader's message.
    before = snapshot(material)
    for path, index_, words in (
        (work / "missing.cxf", 0, "doesn't exist"),
        (work, 0, "is a directory"),
        (book, 267, "there is no color 267"),
    ):
        try:
            bpy.ops.pigmo.pick_color(filepath=str(path), index=index_)
        except RuntimeError as error:
            assert words in str(error), error
        else:
            raise AssertionError(f"picking from {path} did not fail")
        assert snapshot(material) == before, path

    # An object without a material gets one.
    bpy.ops.mesh.primitive_plane_add()
    plane = bpy.context.active_object
    assert bpy.ops.pigmo.pick_color(filepath=str(book), index=0) == {"FINISHED"}
    assert plane.active_material["pigmo"]["name"] == pigmo.ColorBook(book)[0].name
    assert plane.active_material.node_tree.nodes["Principled BSDF"].inputs["Base Color"].is_linked

    expected = {
        "book": str(book), "index": index, "name": color.name, "category": color.category, "lab": color.lab,
        "srgb": color.srgb, "html": color.html, "linear_rgb": color.linear_rgb, "tags": color.tags,
        "reflectance": color.reflectance,
    }
    bpy.ops.wm.save_as_mainfile(filepath=str(work / "scene.blend"))
    book.unlink()
    return expected


def check_reloaded(expected):
    material = bpy.data.objects["Cube"].active_material
    node = material.node_tree.nodes["Pigmo Color"]
    assert close(node.outputs[0].default_value, (*expected["linear_rgb"], 1.0)), node.outputs[0].default_value[:]
    assert material.node_tree.nodes["Principled BSDF"].inputs["Base Color"].links[0].from_node == node
    stored = material["pigmo"].to_dict()
    assert sorted(stored) == sorted(FIELDS), sorted(stored)
    for key in FIELDS:
        value, want = stored[key], expected[key]
        if key in ("lab", "srgb", "linear_rgb", "reflectance"):
            assert close(value, want), (key, value, want)
        else:
            assert value == (list(want) if key == "tags" else want), (key, value, want)
    assert not Path(expected["book"]).exists()


if "--reloaded" in sys.argv:
    check_reloaded(json.loads(Path(sys.argv[-1]).read_text()))
else:
    work = Path(tempfile.mkdtemp(prefix="pigmo-blender-"))
    try:
        expected = pick_and_save(work)
        (work / "expected.json").write_text(json.dumps(expected))
        run = subprocess.run(
            [bpy.app.binary_path, "--background", "--factory-startup", str(work / "scene.blend"),
             "--python-exit-code", "1", "--python", __file__, "--", *sys.argv[sys.argv.index("--") + 1 :],
             "--reloaded", str(work / "expected.json")],
            capture_output=True, text=True, check=False,
        )
        assert run.returncode == 0, f"the reopened .blend failed its checks:\n{run.stdout}\n{run.stderr}"
    finally:
        shutil.rmtree(work)
