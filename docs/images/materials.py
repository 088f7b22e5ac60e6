#!/usr/bin/env python3
"""Writes the sample models of docs/materials.md as .glb files: materials.py [FOLDER]

Metres, y up. Shapes are four lists: places, normals, places in the texture and triangles."""
import json
import math
import struct
import sys
import zlib

folder = sys.argv[1] if len(sys.argv) > 1 else "."

# ---- Shapes


def lathe(profile, steps=96):
    """Turns a line of (radius, height, normal's radius, normal's height) about the y axis."""
    ring = [2 * math.pi * j / steps for j in range(steps + 1)]
    v = [(r * math.cos(a), y, r * math.sin(a)) for r, y, _, _ in profile for a in ring]
    n = [(nr * math.cos(a), ny, nr * math.sin(a)) for _, _, nr, ny in profile for a in ring]
    t = [(j / steps, i / len(profile)) for i in range(len(profile)) for j in range(steps + 1)]
    f = []
    for i in range(len(profile) - 1):
        for j in range(steps):
            a = i * (steps + 1) + j
            b = a + steps + 1
            f += [(a, b, a + 1), (a + 1, b, b + 1)]
    return v, n, t, f


def smooth(line):
    """The profile of a line of (radius, height) that runs upward outside; a third value that
    is true makes a point sharp."""
    profile = []
    for i, (r, y, *sharp) in enumerate(line):
        before, after = line[max(i - 1, 0)], line[min(i + 1, len(line) - 1)]
        ends = [((r, y), after), (before, (r, y))] if sharp else [(before, after)]
        for (r0, y0, *_), (r1, y1, *_) in reversed(ends):
            length = math.hypot(r1 - r0, y1 - y0)
            if length > 0:
                profile.append((r, y, (y1 - y0) / length, (r0 - r1) / length))
    return profile


def arc(r, y, radius, start, end, steps=12):
    angles = [math.radians(start + (end - start) * i / steps) for i in range(steps + 1)]
    return [(r + radius * math.cos(a), y + radius * math.sin(a)) for a in angles]


def ball(radius):
    return lathe(smooth(arc(0, 0, radius, -90, 90, 48)))


def rounded(x, y, z, radius, steps=16):
    """A box of half edges x, y and z whose edges are rounded."""
    half, v, n = (x, y, z), [], []
    for i in range(-1, steps * 2 + 1):
        across = math.pi * (min(max(i, 0), steps * 2 - 1) + 0.5) / (steps * 2)
        for j in range(steps * 4 + 1):
            along = math.pi * (j + 0.5) / (steps * 2)
            d = (math.sin(across) * math.cos(along), -math.cos(across), math.sin(across) * math.sin(along))
            if i in (-1, steps * 2):
                v.append((0, math.copysign(y, d[1]), 0))
                n.append((0, math.copysign(1, d[1]), 0))
            else:
                v.append(tuple(math.copysign(h - radius, c) + radius * c for h, c in zip(half, d)))
                n.append(d)
    f, row = [], steps * 4 + 1
    for i in range(steps * 2 + 1):
        for j in range(steps * 4):
            a = i * row + j
            f += [(a, a + row, a + 1), (a + 1, a + row, a + row + 1)]
    return v, n, [(0, 0)] * len(v), f


def panel(x, y, tiles=1):
    """An upright rectangle of half edges x and y that faces z."""
    v = [(-x, -y, 0), (x, -y, 0), (x, y, 0), (-x, y, 0)]
    t = [(0, tiles * y / x), (tiles, tiles * y / x), (tiles, 0), (0, 0)]
    return v, [(0, 0, 1)] * 4, t, [(0, 1, 2), (0, 2, 3)]


def disc(radius, y):
    """A round plate that faces up."""
    return lathe([(radius, y, 0, 1), (0, y, 0, 1)])


# ---- Files


class Glb:
    def __init__(self):
        self.bytes = b""
        self.json = dict(asset=dict(version="2.0"), scene=0, scenes=[dict(nodes=[])], nodes=[],
                         meshes=[], materials=[], accessors=[], bufferViews=[], images=[],
                         textures=[], samplers=[{}])
        self.placed = {}

    def add(self, kind, **entry):
        self.json[kind].append(entry)
        return len(self.json[kind]) - 1

    def view(self, content):
        self.bytes += b"\0" * (-len(self.bytes) % 4)
        at = len(self.bytes)
        self.bytes += content
        return self.add("bufferViews", buffer=0, byteOffset=at, byteLength=len(content))

    def numbers(self, rows, letter, component, kind, **more):
        content = b"".join(struct.pack("<%d%s" % (len(r), letter), *r) for r in rows)
        return self.add("accessors", bufferView=self.view(content), componentType=component,
                        count=len(rows), type=kind, **more)

    def texture(self, png):
        image = self.add("images", mimeType="image/png", bufferView=self.view(png))
        return dict(index=self.add("textures", source=image, sampler=0))

    def material(self, colour, metal, rough, **more):
        pbr = dict(baseColorFactor=[*colour, 1], metallicFactor=metal, roughnessFactor=rough)
        pbr.update(more.pop("pbr", {}))
        return self.add("materials", pbrMetallicRoughness=pbr, **more)

    def put(self, shape, material, at=(0, 0, 0), **more):
        v, n, t, f = shape
        if id(v) not in self.placed:
            low, high = ([pick(p[i] for p in v) for i in range(3)] for pick in (min, max))
            self.placed[id(v)] = (shape, dict(
                attributes=dict(POSITION=self.numbers(v, "f", 5126, "VEC3", min=low, max=high),
                                NORMAL=self.numbers(n, "f", 5126, "VEC3"),
                                TEXCOORD_0=self.numbers(t, "f", 5126, "VEC2")),
                indices=self.numbers([(i,) for face in f for i in face], "I", 5125, "SCALAR")))
        mesh = self.add("meshes", primitives=[dict(self.placed[id(v)][1], material=material)])
        self.json["scenes"][0]["nodes"].append(self.add("nodes", mesh=mesh, translation=at, **more))

    def sun(self, turn):
        """A light from afar that shines along -z, turned."""
        self.json["extensions"] = dict(KHR_lights_punctual=dict(lights=[dict(type="directional")]))
        self.json["scenes"][0]["nodes"].append(self.add(
            "nodes", rotation=turn, extensions=dict(KHR_lights_punctual=dict(light=0))))

    def save(self, name):
        j = {key: value for key, value in self.json.items() if value}
        j["buffers"] = [dict(byteLength=len(self.bytes))]
        used = sorted({e for m in [j, *j["materials"]] for e in m.get("extensions", {})})
        if used:
            j["extensionsUsed"] = used
        text = json.dumps(j).encode()
        text += b" " * (-len(text) % 4)
        self.bytes += b"\0" * (-len(self.bytes) % 4)
        with open("%s/%s.glb" % (folder, name), "wb") as out:
            out.write(struct.pack("<III", 0x46546C67, 2, 28 + len(text) + len(self.bytes)))
            out.write(struct.pack("<II", len(text), 0x4E4F534A) + text)
            out.write(struct.pack("<II", len(self.bytes), 0x4E4942) + self.bytes)


def png(size, pixel):
    """A picture of size by size; pixel(x, y) gives red, green and blue from 0 to 1."""
    rows = b"".join(b"\0" + bytes(round(255 * min(max(c, 0), 1)) for x in range(size) for c in pixel(x, y))
                    for y in range(size))

    def chunk(kind, content):
        sum_ = zlib.crc32(kind + content)
        return struct.pack(">I", len(content)) + kind + content + struct.pack(">I", sum_)
    head = struct.pack(">IIBBBBB", size, size, 8, 2, 0, 0, 0)
    return b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", head) + chunk(b"IDAT", zlib.compress(rows, 9)) + chunk(b"IEND", b"")


def glass(thickness, ior=1.5, colour=None, distance=None):
    volume = dict(thicknessFactor=thickness)
    if colour:
        volume.update(attenuationColor=colour, attenuationDistance=distance)
    return dict(KHR_materials_transmission=dict(transmissionFactor=1),
                KHR_materials_ior=dict(ior=ior), KHR_materials_volume=volume)


def glow(colour, strength):
    return dict(emissiveFactor=colour,
                extensions=dict(KHR_materials_emissive_strength=dict(emissiveStrength=strength)))


# ---- The samples


def metal_and_roughness():
    g, one = Glb(), ball(0.045)
    for row, metal in enumerate((1, 0.5, 0)):
        for column in range(6):
            material = g.material((0.95, 0.52, 0.34), metal, column / 5)
            g.put(one, material, (column * 0.1, 0.045, row * 0.1))
    g.save("metal")


def drinking_glass():
    g = Glb()
    outside = [(0, 0), (0.026, 0, 1), *arc(0.026, 0.004, 0.004, -90, 0)[1:], (0.038, 0.116)]
    rim = arc(0.037, 0.116, 0.001, 0, 180)
    inside = [(0.029, 0.014), *arc(0.024, 0.014, 0.005, 0, -90)[1:], (0, 0.009)]
    g.put(lathe(smooth(outside + rim + inside)), g.material((1, 1, 1), 0, 0, extensions=glass(0.003)))
    drink = [(0, 0.0092), *arc(0.0236, 0.0142, 0.005, -90, 0), (0.0330, 0.080, 1), (0, 0.080)]
    g.put(lathe(smooth(drink)),
          g.material((1, 1, 1), 0, 0, extensions=glass(0.05, 1.33, [0.95, 0.35, 0.06], 0.03)))
    g.put(ball(0.022), g.material((0.95, 0.93, 0.88), 1, 0.15), (0.075, 0.022, -0.05))
    blue = g.material((1, 1, 1), 0, 0, extensions=glass(0.044, 1.5, [0.25, 0.65, 0.9], 0.04))
    g.put(ball(0.022), blue, (-0.07, 0.022, 0.02))
    g.save("glass")


def sign():
    g = Glb()
    wall = g.material((0.22, 0.23, 0.27), 0, 0.7)
    g.put(rounded(0.75, 0.42, 0.03, 0.004), wall, (0, 0.42, 0))
    warm = g.material((0.05, 0.05, 0.05), 0, 0.5, **glow([1, 0.06, 0.015], 10))
    cold = g.material((0.05, 0.05, 0.05), 0, 0.5, **glow([0.02, 0.2, 1], 10))
    upright, beam, long = (rounded(x, y, 0.016, 0.0159) for x, y in
                           ((0.016, 0.16), (0.1, 0.016), (0.55, 0.016)))
    lean = rounded(0.016, 0.185, 0.016, 0.0159)
    letters = {"O": ((0, 1), (-1, 0, 1)), "P": ((0, ), (0, 1)), "E": ((0, ), (-1, 0, 1)), "N": ((0, 1), ())}
    for i, letter in enumerate("OPEN"):
        x, (sides, beams) = -0.46 + i * 0.27, letters[letter]
        for side in sides:
            g.put(upright, warm, (x + 0.17 * side - 0.03, 0.5, 0.07))
        for at in beams:
            if letter != "O" or at:
                g.put(beam, warm, (x + 0.055, 0.5 + 0.144 * at, 0.07))
        if letter == "P":
            g.put(rounded(0.016, 0.088, 0.016, 0.0159), warm, (x + 0.14, 0.572, 0.07))
        if letter == "N":
            g.put(lean, warm, (x + 0.055, 0.5, 0.07), rotation=[0, 0, math.sin(0.24), math.cos(0.24)])
    g.put(long, cold, (0, 0.24, 0.07))
    g.save("sign")


def brick(size=512):
    """Colour and height of a wall of bricks, each six times as wide as its mortar is deep."""
    def noise(x, y, seed):
        n = (x * 374761393 + y * 668265263 + seed * 974634221) & 0xFFFFFFFF
        n = ((n ^ (n >> 13)) * 1274126177) & 0xFFFFFFFF
        return (n ^ (n >> 16)) / 0xFFFFFFFF

    def soft(x, y, cell, seed):
        """Noise of cells that many pixels wide, which repeats with the picture."""
        cells, i, j = size // cell, x // cell, y // cell
        u, v = (x % cell) / cell, (y % cell) / cell
        u, v = u * u * (3 - 2 * u), v * v * (3 - 2 * v)
        corner = [noise((i + a) % cells, (j + b) % cells, seed) for b in (0, 1) for a in (0, 1)]
        top, low = corner[0] + u * (corner[1] - corner[0]), corner[2] + u * (corner[3] - corner[2])
        return top + v * (low - top)

    width, height, joint = size // 4, size // 8, 5
    colours, heights = [], []
    for y in range(size):
        row = y // height
        for x in range(size):
            along = (x + (row % 2) * width // 2) % size
            edge = min(along % width, width - along % width, y % height, height - y % height)
            edge += 3 * soft(x, y, 8, 1) - 1.5
            inside = min(max((edge - joint) / 6, 0), 1)
            inside = inside * inside * (3 - 2 * inside)
            grain = 0.5 * soft(x, y, 16, 2) + 0.3 * soft(x, y, 4, 3) + 0.2 * noise(x, y, 4)
            tone = 0.7 + 0.5 * noise(along // width, row, 5) + 0.35 * (grain - 0.5)
            mortar = 0.55 + 0.25 * grain
            fired = (0.52 * tone, (0.21 + 0.08 * noise(along // width, row, 6)) * tone, 0.15 * tone)
            colours.append([m + inside * (b - m) for m, b in zip((mortar, mortar * 0.96, mortar * 0.9), fired)])
            heights.append(6 * inside + 2.2 * grain)
    return colours, heights


def brick_wall(size=512):
    colours, heights = brick(size)

    def height(x, y):
        return heights[(y % size) * size + x % size]

    def normal(x, y):
        across, up = height(x - 1, y) - height(x + 1, y), height(x, y + 1) - height(x, y - 1)
        length = math.sqrt(across * across + up * up + 4)
        return (0.5 + 0.5 * across / length, 0.5 + 0.5 * up / length, 0.5 + 1 / length)

    g, one = Glb(), panel(0.6, 0.6)
    colour = g.texture(png(size, lambda x, y: colours[y * size + x]))
    relief = g.texture(png(size, normal))
    flat = g.material((1, 1, 1), 0, 0.8, pbr=dict(baseColorTexture=colour))
    mapped = g.material((1, 1, 1), 0, 0.8, pbr=dict(baseColorTexture=colour), normalTexture=relief)
    g.put(one, flat, (-0.61, 0.6, 0))
    g.put(one, mapped, (0.61, 0.6, 0))
    g.sun((-0.5, 0.33, 0, 0.8))
    g.save("wall")


def car():
    g = Glb()
    coat = dict(KHR_materials_clearcoat=dict(clearcoatFactor=1, clearcoatRoughnessFactor=0.02))
    paint = g.material((0.5, 0.015, 0.02), 0.7, 0.45, extensions=coat)
    window = g.material((0.015, 0.017, 0.02), 0, 0.03)
    rubber, chrome = g.material((0.02, 0.02, 0.02), 0, 0.8), g.material((0.9, 0.9, 0.9), 1, 0.08)
    lamp = g.material((0.5, 0.48, 0.4), 0, 0.05, **glow([1, 0.85, 0.6], 0.4))
    g.put(rounded(0.11, 0.024, 0.05, 0.0235, 24), paint, (0, 0.04, 0))
    g.put(rounded(0.058, 0.026, 0.043, 0.0255, 24), window, (-0.012, 0.068, 0))
    g.put(rounded(0.044, 0.008, 0.034, 0.0078, 24), paint, (-0.012, 0.0885, 0))
    tyre = arc(0.016, 0, 0.007, -90, 90)
    wheel = lathe(smooth([(0, -0.007), *tyre, (0, 0.007)]))
    hub = lathe(smooth([(0.0125, 0.0071), *arc(0.010, 0.0071, 0.0025, 0, 90), (0, 0.0085)]))
    for x in (-0.066, 0.066):
        for side in (1, -1):
            turn = [side * math.sqrt(0.5), 0, 0, math.sqrt(0.5)]
            g.put(wheel, rubber, (x, 0.023, side * 0.047), rotation=turn)
            g.put(hub, chrome, (x, 0.023, side * 0.047), rotation=turn)
    for z in (-0.028, 0.028):
        g.put(ball(0.011), lamp, (0.1, 0.046, z))
    g.put(rounded(0.008, 0.006, 0.044, 0.0055), chrome, (0.105, 0.026, 0))
    g.save("car")


def device():
    g = Glb()
    body, front = g.material((0.012, 0.012, 0.013), 0, 0.42), g.material((0.008, 0.008, 0.009), 0, 0.05)
    metal, rubber = g.material((0.35, 0.35, 0.36), 1, 0.3), g.material((0.01, 0.01, 0.01), 0, 0.9)
    g.put(rounded(0.11, 0.045, 0.07, 0.006), body, (0, 0.049, 0))
    g.put(rounded(0.098, 0.034, 0.002, 0.0019), front, (0, 0.049, 0.07))
    turn = [math.sqrt(0.5), 0, 0, math.sqrt(0.5)]
    knob = [*arc(0.0215, 0.0, 0.0015, 0, 1, 1), (0.023, 0.012), *arc(0.0215, 0.012, 0.0015, 0, 90), (0, 0.0135)]
    g.put(lathe(smooth(knob)), metal, (0.062, 0.049, 0.072), rotation=turn)
    for x in (-0.085, 0.085):
        for z in (-0.05, 0.05):
            g.put(rounded(0.012, 0.004, 0.008, 0.001), rubber, (x, 0.004, z))
    lit = g.material((0, 0, 0), 0, 0.5, **glow([0.1, 0.9, 0.4], 2))
    g.put(rounded(0.003, 0.003, 0.001, 0.0009), lit, (-0.08, 0.049, 0.0715))
    g.save("device")


for sample in (metal_and_roughness, drinking_glass, sign, brick_wall, car, device):
    sample()
