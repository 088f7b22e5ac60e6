"""The camera's way, the same for every program: once around the hills, looking at their middle."""

import math

WIDTH = 1280
HEIGHT = 720
LENS_DEG = 30.0  # vertical angle of view
TARGET = (0.0, 0.0, 0.0)
RADIUS = 155.0
RAISED_DEG = 22.0
TOWARD_SUN = (-0.5, -0.6, 0.7)


def camera(frame, frames):
    """The camera's place at a frame, from 0; it starts in the south and goes west."""
    around = 2.0 * math.pi * frame / frames
    level = RADIUS * math.cos(math.radians(RAISED_DEG))
    height = RADIUS * math.sin(math.radians(RAISED_DEG))
    return (-level * math.sin(around), -level * math.cos(around), height)
