"""usage: blender -b --factory-startup --python-exit-code 1 --python blender_samples.py -- FOLDER [THREADS]

Renders what `bench_samples FOLDER` wrote there with Cycles on the CPU, without its denoiser, and
prints the same table: seconds of rendering alone, and how far each picture is from one of 4096
samples. The light is alike: a sun disc of the same direction, size and colour, an even sky that
sheds as much light, a ground; paths are as long, and what brings too much light is cut at the same
height. Pixels are weighed evenly (a box filter one pixel wide) and shown by the sRGB curve alone, as
in our pictures.
"""

import math
import os
import resource
import sys
import time

import bpy
from mathutils import Vector

WIDTH, HEIGHT = 320, 180
TRUTH = 4096
SUN_DEG = 0.53


def read_view(folder):
    with open(os.path.join(folder, "view.txt")) as lines:
        eye, target, sun, sun_color, sky, angle = [
            [float(word) for word in line.split()] for line in lines
        ]
    return Vector(eye), Vector(target), Vector(sun), sun_color, sky, angle[0]


def add(name, data):
    thing = bpy.data.objects.new(name, data)
    bpy.context.scene.collection.objects.link(thing)
    return thing


def build(folder):
    scene = bpy.context.scene
    for thing in list(bpy.data.objects):
        bpy.data.objects.remove(thing)
    bpy.ops.wm.obj_import(filepath=os.path.join(folder, "pavilion.obj"),
                          forward_axis="Y", up_axis="Z")  # fmt: skip
    eye, target, sun, sun_color, sky, half_angle = read_view(folder)
    camera = add("camera", bpy.data.cameras.new("camera"))
    camera.data.sensor_fit = "VERTICAL"
    camera.data.angle = 2.0 * half_angle
    camera.data.clip_end = 100000.0
    camera.location = eye
    camera.rotation_euler = (target - eye).to_track_quat("-Z", "Y").to_euler()
    scene.camera = camera
    light = add("sun", bpy.data.lights.new("sun", "SUN"))
    light.data.color = sun_color
    light.data.energy = math.pi  # white surfaces that face it are as bright as its colour
    light.data.angle = math.radians(SUN_DEG)
    light.rotation_euler = sun.to_track_quat("Z", "Y").to_euler()
    bpy.ops.mesh.primitive_plane_add(size=10000.0, location=(0.0, 0.0, -0.01))
    scene.world.node_tree.nodes["Background"].inputs["Color"].default_value = (*sky, 1.0)
    return scene


def set_up(scene, threads):
    scene.render.engine = "CYCLES"
    scene.render.resolution_x, scene.render.resolution_y = WIDTH, HEIGHT
    scene.render.use_persistent_data = True
    scene.render.threads_mode = "FIXED"
    scene.render.threads = threads
    scene.render.image_settings.file_format = "BMP"
    scene.cycles.device = "CPU"
    scene.cycles.use_denoising = False
    scene.cycles.use_adaptive_sampling = False
    scene.cycles.pixel_filter_type = "BOX"
    scene.cycles.max_bounces = scene.cycles.diffuse_bounces = scene.cycles.glossy_bounces = 8
    scene.cycles.sample_clamp_indirect = 6.0
    scene.view_settings.view_transform = "Standard"


def processor_seconds():
    used = resource.getrusage(resource.RUSAGE_SELF)
    return used.ru_utime + used.ru_stime


def picture(scene, folder, samples):
    """The bytes of a picture, and seconds and processor seconds that it took."""
    scene.cycles.samples = samples
    scene.render.filepath = os.path.join(folder, f"cycles{samples}.bmp")
    start, processor_start = time.monotonic(), processor_seconds()
    bpy.ops.render.render(write_still=True)
    taken = time.monotonic() - start, processor_seconds() - processor_start
    with open(scene.render.filepath, "rb") as file:
        content = file.read()
    return content[int.from_bytes(content[10:14], "little"):], taken


def difference(a, b):
    return math.sqrt(sum((x - y) ** 2 for x, y in zip(a, b)) / len(a))


def main(folder, threads="2"):
    scene = build(folder)
    set_up(scene, int(threads))
    picture(scene, folder, 1)  # builds what all pictures share
    truth, _ = picture(scene, folder, TRUTH)
    print(f"{'samples':<10} {'seconds':>12} {'processor s':>12} {'difference':>12}")
    for samples in (1, 4, 16, 64, 256):
        content, (seconds, processor) = picture(scene, folder, samples)
        print(f"{samples:<10} {seconds:12.2f} {processor:12.2f} {difference(content, truth):12.2f}",
              flush=True)  # fmt: skip


main(*sys.argv[sys.argv.index("--") + 1:])
