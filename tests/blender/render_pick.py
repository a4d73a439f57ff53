"""Renders with Cycles on the CPU a plane lit only by an emission shader driven by "Pigmo Color" and
checks the pixels against the picked color's sRGB."""

import shutil
import sys
import tempfile
from pathlib import Path

import bpy

sys.path.insert(0, str(Path(__file__).parent))
import addon_under_test  # noqa: E402

bpy.ops.wm.read_factory_settings(use_empty=True)
pigmo = addon_under_test.enable()
index, color = addon_under_test.in_gamut_color(pigmo, addon_under_test.CENTROID_BOOK)
scene = bpy.context.scene
bpy.ops.mesh.primitive_plane_add(size=4)
plane = bpy.context.active_object
assert bpy.ops.pigmo.pick_color(filepath=str(addon_under_test.CENTROID_BOOK), index=index) == {"FINISHED"}

tree = plane.active_material.node_tree
emission = tree.nodes.new("ShaderNodeEmission")
emission.inputs["Strength"].default_value = 1.0
tree.links.new(tree.nodes["Pigmo Color"].outputs[0], emission.inputs["Color"])
tree.links.new(emission.outputs[0], tree.nodes["Material Output"].inputs["Surface"])

camera = bpy.data.objects.new("Camera", bpy.data.cameras.new("Camera"))
camera.data.type = "ORTHO"
camera.data.ortho_scale = 2.0
camera.location = (0, 0, 5)
scene.collection.objects.link(camera)
scene.camera = camera
# No world light: the plane's emission is all there is.
scene.world = bpy.data.worlds.new("Black")
scene.world.color = (0, 0, 0)

scene.render.engine = "CYCLES"
scene.cycles.device = "CPU"
scene.cycles.samples = 4
scene.cycles.use_denoising = False
scene.render.resolution_x = scene.render.resolution_y = 16
scene.render.resolution_percentage = 100
scene.render.dither_intensity = 0.0
scene.view_settings.view_transform = "Standard"
scene.view_settings.look = "None"
scene.view_settings.exposure = 0.0
scene.view_settings.gamma = 1.0
scene.render.image_settings.file_format = "PNG"
scene.render.image_settings.color_depth = "8"

work = Path(tempfile.mkdtemp(prefix="pigmo-render-"))
try:
    scene.render.filepath = str(work / "render.png")
    bpy.ops.render.render(write_still=True)
    image = bpy.data.images.load(str(work / "render.png"))
    assert tuple(image.size) == (16, 16), tuple(image.size)
    pixels = list(image.pixels)
    for i in range(0, len(pixels), 4):
        rendered = [round(value * 255) for value in pixels[i : i + 3]]
        assert all(abs(r - s) <= 2 for r, s in zip(rendered, color.srgb)), (i // 4, rendered, color.srgb)
    print(f"rendered {color.name}: {rendered} against sRGB {[round(v, 2) for v in color.srgb]}")
finally:
    shutil.rmtree(work)
