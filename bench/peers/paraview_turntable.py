"""usage: pvbatch paraview_turntable.py MESH FOLDER FRAMES"""

import os
import sys

sys.path.insert(0, os.path.dirname(os.path.abspath(__file__)))

from paraview import simple

import orbit


def main(mesh, folder, frames):
    view = simple.CreateView("RenderView")
    view.ViewSize = [orbit.WIDTH, orbit.HEIGHT]
    view.OrientationAxesVisibility = 0
    view.CameraViewAngle = orbit.LENS_DEG
    view.CameraFocalPoint = list(orbit.TARGET)
    view.CameraViewUp = [0.0, 0.0, 1.0]
    simple.Show(simple.PLYReader(FileNames=[mesh]), view)
    for frame in range(frames):
        view.CameraPosition = list(orbit.camera(frame, frames))
        simple.SaveScreenshot(
            f"{folder}/frame{frame:03d}.jpg",
            view,
            ImageResolution=[orbit.WIDTH, orbit.HEIGHT],
            Quality=90,
        )


main(sys.argv[1], sys.argv[2], int(sys.argv[3]))
