"""usage: blender -b --factory-startup --python blender_camera.py -- CAMERA.glb CAMERA.json

Reads a camera that quarn wrote as glTF, and tells how far its frustum (of a sun study, its light too)
lies beside what quarn wrote as JSON of the same animation: the largest distance of a corner of the
picture, at the target, as a part of the distance of the target. Ends with 1 where that is more than
1e-5.
"""

import json
import math
import sys

import bpy
from mathutils import Vector

MOST = 1e-5


def read(gltf_file, track):
    for thing in list(bpy.data.objects):
        bpy.data.objects.remove(thing)
    render = bpy.context.scene.render
    render.fps = track["frame_rate"]
    render.resolution_x, render.resolution_y = track["width_px"], track["height_px"]
    bpy.ops.import_scene.gltf(filepath=gltf_file)
    by_kind = {thing.type: thing for thing in bpy.data.objects}
    return by_kind["CAMERA"], by_kind.get("LIGHT")


def first_frame(thing):
    keys = thing.animation_data.action.fcurves[0].keyframe_points
    return keys[0].co.x, len(keys)


def show(start, number):
    frame = start + number
    bpy.context.scene.frame_set(math.floor(frame), subframe=frame % 1.0)


def read_corners(camera, depth):
    """Of the picture, in the world, at a distance along the view direction."""
    corners = camera.data.view_frame(scene=bpy.context.scene)
    if camera.data.type == "ORTHO":
        local = [Vector((c.x, c.y, -depth)) for c in corners]
    else:
        local = [Vector(c) * (depth / -c.z) for c in corners]
    return [camera.matrix_world @ corner for corner in local]


def written_corners(track, frame, metres):
    place, ahead, up = (Vector(frame[part]) for part in ("place", "direction", "up"))
    right = ahead.cross(up)
    depth = (Vector(frame["target"]) - place).length
    if track["projection"] == "parallel":
        half_height, half_width = track["height"] / 2, track["width"] / 2
    else:
        half_height = depth * math.tan(math.radians(track["vertical_angle_deg"]) / 2)
        half_width = half_height * track["width_px"] / track["height_px"]
    middle = place + depth * ahead
    return metres * depth, [
        metres * (middle + x * half_width * right + y * half_height * up)
        for x in (-1, 1) for y in (-1, 1)
    ]


def difference(camera, track, frame, metres):
    depth, written = written_corners(track, frame, metres)
    ahead = camera.matrix_world.to_3x3() @ Vector((0, 0, -1))
    # A parallel camera may stand back along its line of sight.
    to_middle = sum(written, Vector()) / 4 - camera.matrix_world.translation
    there = read_corners(camera, to_middle.dot(ahead))
    return max(min((a - b).length for b in there) for a in written) / depth


def main(gltf_file, json_file):
    with open(json_file) as stream:
        track = json.load(stream)
    metres = track["metres_per_unit"] or 1.0
    camera, light = read(gltf_file, track)
    start, keys = first_frame(light or camera)
    if keys != track["frame_count"]:
        sys.exit(f"{keys} keys, not {track['frame_count']}")
    worst, worst_light = 0.0, 0.0
    for number, frame in enumerate(track["frames"]):
        show(start, number)
        worst = max(worst, difference(camera, track, frame, metres))
        if light:
            back = light.matrix_world.to_3x3() @ Vector((0, 0, 1))
            worst_light = max(worst_light, (back - Vector(frame["sun"]["direction"])).length)
    print(f"{keys} keys: frustum {worst:.2g}" + (f", light {worst_light:.2g}" if light else ""))
    sys.exit(0 if max(worst, worst_light) <= MOST else 1)


main(*sys.argv[sys.argv.index("--") + 1:])
