"""The "Pigmo Color Map" panel: palettes, a book, its swatches page by page, and the picked color."""

import os
import textwrap

import bpy
import bpy.utils.previews

from . import chart, library, picking

PAGE_SIZE = 12
COLUMNS = 3

_icons = None  # preview collection of swatches and charts, made at register
_palettes = None  # (name, path, kind) as last found, None until the panel first shows
# The enum's items must outlive the call that returns them.
_palette_items = []
_book = {"key": None, "book": None, "error": ""}


def _found_palettes():
    pigmo = library.pigmo()
    return [(p.name, p.path, p.kind) for p in pigmo.palettes()] if pigmo else []


def _palette_enum(self, context):
    global _palette_items
    found = [
        (str(i), f"{name or os.path.basename(path)} ({kind})", path)
        for i, (name, path, kind) in enumerate(_palettes or [])
    ]
    _palette_items = [("NONE", "Choose a palette" if found else "No palettes found", "")] + found
    return _palette_items


def _palette_chosen(self, context):
    if self.pigmo_palette != "NONE":
        self.pigmo_book = _palettes[int(self.pigmo_palette)][1]


def _book_chosen(self, context):
    self.pigmo_page = 0


def open_book(path):
    """The book at path, read again only when the file changed; None with the reader's message."""
    pigmo = library.pigmo()
    absolute = bpy.path.abspath(path)
    try:
        status = os.stat(absolute)
        key = (absolute, status.st_mtime_ns, status.st_size)
    except OSError:
        key = (absolute, None, None)
    if key != _book["key"]:
        _book.update(key=key, book=None, error="")
        try:
            _book["book"] = pigmo.ColorBook(absolute)
        except pigmo.ColorBookError as error:
            _book["error"] = str(error)
    return _book["book"], _book["error"]


def _icon(key, width, height, pixels):
    """A preview icon made once from RGBA floats, bottom row first."""
    if key not in _icons:
        preview = _icons.new(key)
        preview.image_size = (width, height)
        preview.image_pixels_float = pixels
    return _icons[key].icon_id


def swatch_icon(color):
    # Icons show display values, so the swatch takes the 0..255 sRGB, not the linear RGB.
    rgba = [channel / 255.0 for channel in color.srgb] + [1.0]
    return _icon("swatch " + color.html, 32, 32, rgba * (32 * 32))


def _wrapped(layout, text, icon="NONE"):
    for i, line in enumerate(textwrap.wrap(text, 60) or [""]):
        layout.label(text=line, icon=icon if i == 0 else "BLANK1")


class PIGMO_OT_refresh_palettes(bpy.types.Operator):
    """Look for palette files again, in the system and user palette folders"""

    bl_idname = "pigmo.refresh_palettes"
    bl_label = "Refresh Palettes"

    def execute(self, context):
        global _palettes
        _palettes = _found_palettes()
        return {"FINISHED"}


class PIGMO_OT_page(bpy.types.Operator):
    """Show another page of the book's colors"""

    bl_idname = "pigmo.page"
    bl_label = "Page"
    bl_options = {"INTERNAL"}

    step: bpy.props.IntProperty()

    def execute(self, context):
        context.scene.pigmo_page = max(0, context.scene.pigmo_page + self.step)
        return {"FINISHED"}


def draw_swatches(layout, scene, book, pick):
    pages = max(1, (len(book) + PAGE_SIZE - 1) // PAGE_SIZE)
    page = min(scene.pigmo_page, pages - 1)
    header = layout.split(factor=0.6)
    header.label(text=f"{book.name or os.path.basename(book.path)}: {len(book)} colors")
    paging = header.row(align=True)
    paging.alignment = "RIGHT"
    paging.enabled = pages > 1
    paging.operator("pigmo.page", text="", icon="TRIA_LEFT").step = -1
    paging.label(text=f"{page + 1} / {pages}")
    paging.operator("pigmo.page", text="", icon="TRIA_RIGHT").step = 1

    grid = layout.grid_flow(row_major=True, columns=COLUMNS, even_columns=True, align=True)
    picked_here = pick is not None and bpy.path.abspath(pick["book"]) == bpy.path.abspath(scene.pigmo_book)
    for index in range(page * PAGE_SIZE, min(len(book), (page + 1) * PAGE_SIZE)):
        color = book[index]
        cell = grid.column(align=True)
        cell.template_icon(icon_value=swatch_icon(color), scale=2.0)
        button = cell.operator(
            "pigmo.pick_color",
            text=color.name,
            depress=picked_here and pick["index"] == index,
        )
        button.filepath = scene.pigmo_book
        button.index = index


def draw_pick(layout, pick):
    box = layout.box()
    box.label(text=pick["name"], icon="COLOR")
    fields = box.column(align=True)
    lab, srgb, linear = pick["lab"], pick["srgb"], pick["linear_rgb"]
    for label, value in (
        ("Category", pick["category"]),
        ("L*a*b*", f"{lab[0]:.2f}  {lab[1]:.2f}  {lab[2]:.2f}"),
        ("sRGB", f"{srgb[0]:.1f}  {srgb[1]:.1f}  {srgb[2]:.1f}"),
        ("Hex", pick["html"]),
        ("Linear RGB", f"{linear[0]:.4f}  {linear[1]:.4f}  {linear[2]:.4f}"),
        ("Tags", ", ".join(pick["tags"]) or "none"),
    ):
        row = fields.split(factor=0.3)
        row.label(text=label)
        row.label(text=value)
    if pick["reflectance"]:
        box.label(text=f"Reflectance, {len(pick['reflectance'])} values (380 to 730 nm)")
        width, height, pixels = chart.render(pick["reflectance"], pick["srgb"])
        icon = _icon(chart.key(pick["reflectance"], pick["srgb"]), width, height, pixels)
        box.template_icon(icon_value=icon, scale=6.0)


def draw_panel(layout, context):
    global _palettes
    scene = context.scene
    pigmo = library.pigmo()
    if pigmo is None:
        _wrapped(layout, library.problem(), icon="ERROR")
        layout.label(text="Set the Pigmo library in the add-on's preferences.")
        return
    if _palettes is None:
        _palettes = _found_palettes()
    row = layout.row(align=True)
    row.prop(scene, "pigmo_palette", text="Palette")
    row.operator("pigmo.refresh_palettes", text="", icon="FILE_REFRESH")
    layout.prop(scene, "pigmo_book", text="Book")

    obj = context.active_object
    pick = picking.stored_pick(obj.active_material if obj else None)
    if scene.pigmo_book:
        book, error = open_book(scene.pigmo_book)
        if book is None:
            _wrapped(layout.box(), error, icon="ERROR")
        else:
            draw_swatches(layout, scene, book, pick)
    if pick is not None:
        draw_pick(layout, pick)
    elif obj is None:
        layout.label(text="Select an object to pick a color for.", icon="INFO")


class PigmoPanel:
    bl_label = "Pigmo Color Map"

    def draw(self, context):
        draw_panel(self.layout, context)


class PIGMO_PT_material(PigmoPanel, bpy.types.Panel):
    bl_idname = "PIGMO_PT_material"
    bl_space_type = "PROPERTIES"
    bl_region_type = "WINDOW"
    bl_context = "material"


class PIGMO_PT_shader_editor(PigmoPanel, bpy.types.Panel):
    bl_idname = "PIGMO_PT_shader_editor"
    bl_space_type = "NODE_EDITOR"
    bl_region_type = "UI"
    bl_category = "Pigmo"

    @classmethod
    def poll(cls, context):
        return getattr(context.space_data, "tree_type", "") == "ShaderNodeTree"


CLASSES = (PIGMO_OT_refresh_palettes, PIGMO_OT_page, PIGMO_PT_material, PIGMO_PT_shader_editor)


def register():
    global _icons
    _icons = bpy.utils.previews.new()
    bpy.types.Scene.pigmo_palette = bpy.props.EnumProperty(
        name="Palette", description="Palettes found in the system and user palette folders", items=_palette_enum,
        update=_palette_chosen,
    )
    bpy.types.Scene.pigmo_book = bpy.props.StringProperty(
        name="Book", description="CxF 2.1 color book", subtype="FILE_PATH", update=_book_chosen
    )
    bpy.types.Scene.pigmo_page = bpy.props.IntProperty(name="Page", min=0)
    for cls in CLASSES:
        bpy.utils.register_class(cls)


def unregister():
    for cls in reversed(CLASSES):
        bpy.utils.unregister_class(cls)
    del bpy.types.Scene.pigmo_page, bpy.types.Scene.pigmo_book, bpy.types.Scene.pigmo_palette
    bpy.utils.previews.remove(_icons)
    _book.update(key=None, book=None, error="")
