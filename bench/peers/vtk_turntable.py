"""usage: vtk_turntable.py MESH FOLDER FRAMES

Draws off screen, without smoothing, and writes each picture as it stands in the frame buffer.
"""

import sys

import vtk

import orbit


def surface(mesh):
    reader = vtk.vtkPLYReader()
    reader.SetFileName(mesh)
    mapper = vtk.vtkPolyDataMapper()
    mapper.SetInputConnection(reader.GetOutputPort())
    actor = vtk.vtkActor()
    actor.SetMapper(mapper)
    return actor


def main(mesh, folder, frames):
    renderer = vtk.vtkRenderer()
    renderer.AddActor(surface(mesh))
    renderer.SetBackground(0.9, 0.92, 0.95)
    window = vtk.vtkRenderWindow()
    window.SetOffScreenRendering(True)
    window.SetMultiSamples(0)
    window.SetSize(orbit.WIDTH, orbit.HEIGHT)
    window.AddRenderer(renderer)
    picture = vtk.vtkWindowToImageFilter()
    picture.SetInput(window)
    picture.ShouldRerenderOff()
    picture.ReadFrontBufferOff()
    writer = vtk.vtkJPEGWriter()
    writer.SetQuality(90)
    writer.SetInputConnection(picture.GetOutputPort())

    camera = renderer.GetActiveCamera()
    camera.SetViewAngle(orbit.LENS_DEG)
    camera.SetFocalPoint(*orbit.TARGET)
    camera.SetViewUp(0.0, 0.0, 1.0)
    for frame in range(frames):
        camera.SetPosition(*orbit.camera(frame, frames))
        renderer.ResetCameraClippingRange()
        window.Render()
        picture.Modified()
        writer.SetFileName(f"{folder}/frame{frame:03d}.jpg")
        writer.Write()


if __name__ == "__main__":
    main(sys.argv[1], sys.argv[2], int(sys.argv[3]))
