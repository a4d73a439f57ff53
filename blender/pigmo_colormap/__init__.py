"""Pigmo Color Map for Blender: measured colors from CxF color books in materials."""

bl_info = {
    "name": "Pigmo Color Map",
    "author": "Pigmo",
    "version": (0, 1, 0),
    "blender": (3, 4, 0),
    "location": "Properties > Material > Pigmo Color Map; Shader Editor > Sidebar > Pigmo",
    "description": "Pick colors from CxF 2.1 color books into a material's \"Pigmo Color\" node",
    "category": "Material",
}

import bpy

from . import library, panel, picking


def register():
    bpy.utils.register_class(library.PigmoPreferences)
    bpy.utils.register_class(picking.PIGMO_OT_pick_color)
    panel.register()


def unregister():
    panel.unregister()
    bpy.utils.unregister_class(picking.PIGMO_OT_pick_color)
    bpy.utils.unregister_class(library.PigmoPreferences)
