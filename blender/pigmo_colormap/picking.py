"""Picking a book color into the active material: a "Pigmo Color" RGB node and the stored fields."""

import bpy

from . import library

NODE_NAME = "Pigmo Color"
PROPERTY = "pigmo"


def stored_pick(material: bpy.types.Material | None) -> dict | None:
    """The fields of the material's pick, as saved in the .blend, or None."""
    if material is None or PROPERTY not in material:
        return None
    return material[PROPERTY].to_dict()


def _material_of(obj: bpy.types.Object) -> bpy.types.Material:
    """The object's active material, made and assigned when it has none."""
    if obj.active_material is not None:
        return obj.active_material
    material = bpy.data.materials.new("Pigmo Color Map")
    material.use_nodes = True
    if len(obj.material_slots) == 0:
        obj.data.materials.append(material)
    else:
        obj.active_material = material
    return material


def _principled(material: bpy.types.Material) -> bpy.types.ShaderNodeBsdfPrincipled | None:
    return next((n for n in material.node_tree.nodes if n.bl_idname == "ShaderNodeBsdfPrincipled"), None)


def _color_node(material: bpy.types.Material) -> bpy.types.ShaderNodeRGB:
    if not material.use_nodes:
        material.use_nodes = True
    nodes = material.node_tree.nodes
    node = nodes.get(NODE_NAME)
    if node is None or node.bl_idname != "ShaderNodeRGB":
        node = nodes.new("ShaderNodeRGB")
        node.name = node.label = NODE_NAME
        principled = _principled(material)
        if principled is not None:
            node.location = (principled.location.x - 250, principled.location.y)
    return node


def apply_pick(material: bpy.types.Material, path: str, index: int, color) -> None:
    node = _color_node(material)
    # The RGB node takes scene-linear Rec. 709 values, which share the primaries and white of linear
    # sRGB, so the record's linear RGB goes in unchanged.
    node.outputs[0].default_value = (*color.linear_rgb, 1.0)
    principled = _principled(material)
    if principled is not None and not principled.inputs["Base Color"].is_linked:
        material.node_tree.links.new(node.outputs[0], principled.inputs["Base Color"])
    material[PROPERTY] = {
        "book": path,
        "index": index,
        "name": color.name,
        "category": color.category,
        "lab": list(color.lab),
        "srgb": list(color.srgb),
        "html": color.html,
        "linear_rgb": list(color.linear_rgb),
        "tags": list(color.tags),
        "reflectance": list(color.reflectance),
    }


class PIGMO_OT_pick_color(bpy.types.Operator):
    """Set the active material's "Pigmo Color" node to this color of the book"""

    bl_idname = "pigmo.pick_color"
    bl_label = "Pick Pigmo Color"
    bl_options = {"REGISTER", "UNDO"}

    filepath: bpy.props.StringProperty(name="Book", subtype="FILE_PATH", description="CxF 2.1 color book")
    index: bpy.props.IntProperty(name="Color", min=0, description="Color of the book, from 0")

    @classmethod
    def description(cls, context: bpy.types.Context, properties) -> str:
        return f"Pick color {properties.index + 1} of the book into the active material"

    def execute(self, context: bpy.types.Context) -> set[str]:
        pigmo = library.pigmo()
        if pigmo is None:
            self.report({"ERROR"}, library.problem())
            return {"CANCELLED"}
        obj = context.active_object
        if obj is None or obj.data is None or not hasattr(obj.data, "materials"):
            self.report({"ERROR"}, "Pigmo: select an object that can take a material")
            return {"CANCELLED"}
        path = bpy.path.abspath(self.filepath)
        # The book is read before anything changes, so a failure leaves the material as it was.
        try:
            book = pigmo.ColorBook(path)
            color = book[self.index]
        except pigmo.ColorBookError as error:
            self.report({"ERROR"}, str(error))
            return {"CANCELLED"}
        except IndexError:
            self.report({"ERROR"}, f"{path}: there is no color {self.index}; the book holds {len(book)}")
            return {"CANCELLED"}
        apply_pick(_material_of(obj), self.filepath, self.index, color)
        self.report({"INFO"}, f"Picked {color.name} ({color.html})")
        return {"FINISHED"}
