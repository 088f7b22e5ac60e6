"""usage: blender -b --factory-startup --python blender_turntable.py -- MESH FOLDER FRAMES ENGINE

ENGINE is workbench, shadows (the same with its shadows) or cycles (4 samples, hard sun).
"""

import math
import os
import sys

sys.path.insert(0, os.path.dirname(os.path.abspath(__file__)))

import bpy
from mathutils import Vector

import orbit


def empty_scene():
    for thing in list(bpy.data.objects):
        bpy.data.objects.remove(thing)


def add_camera():
    camera = bpy.data.objects.new("camera", bpy.data.cameras.new("camera"))
    camera.data.sensor_fit = "VERTICAL"
    camera.data.angle = math.radians(orbit.LENS_DEG)
    camera.data.clip_end = 1000.0
    bpy.context.scene.collection.objects.link(camera)
    bpy.context.scene.camera = camera
    return camera


def add_sun():
    sun = bpy.data.objects.new("sun", bpy.data.lights.new("sun", "SUN"))
    sun.data.energy = 3.0
    sun.data.angle = 0.0
    sun.rotation_euler = Vector(orbit.TOWARD_SUN).to_track_quat("Z", "Y").to_euler()
    bpy.context.scene.collection.objects.link(sun)


def choose_engine(scene, name):
    if name == "cycles":
        scene.render.engine = "CYCLES"
        scene.cycles.device = "CPU"
        scene.cycles.samples = 4
        scene.cycles.use_denoising = False
        scene.cycles.max_bounces = 0
        scene.render.use_persistent_data = True
        add_sun()
        return
    scene.render.engine = "BLENDER_WORKBENCH"
    scene.display.render_aa = "OFF"
    scene.display.shading.show_shadows = name == "shadows"
    x, y, z = orbit.TOWARD_SUN
    scene.display.light_direction = (x, z, -y)


def main(mesh, folder, frames, engine):
    empty_scene()
    if bpy.app.version >= (4, 0):
        bpy.ops.wm.ply_import(filepath=mesh)
    else:
        bpy.ops.import_mesh.ply(filepath=mesh)
    scene = bpy.context.scene
    camera = add_camera()
    choose_engine(scene, engine)
    scene.render.resolution_x = orbit.WIDTH
    scene.render.resolution_y = orbit.HEIGHT
    scene.render.image_settings.file_format = "JPEG"
    scene.render.image_settings.quality = 90
    for frame in range(frames):
        place = Vector(orbit.camera(frame, frames))
        camera.location = place
        camera.rotation_euler = (Vector(orbit.TARGET) - place).to_track_quat("-Z", "Y").to_euler()
        scene.render.filepath = f"{folder}/frame{frame:03d}.jpg"
        bpy.ops.render.render(write_still=True)


arguments = sys.argv[sys.argv.index("--") + 1 :]
main(arguments[0], arguments[1], int(arguments[2]), arguments[3])
