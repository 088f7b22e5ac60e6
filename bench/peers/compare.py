#!/usr/bin/env python3
"""Records the same turntable of the same meshes with quarn and with the programs that one would
take instead, where they are installed, and prints how they compare.

usage: compare.py QUARN [--sizes 100k,1M,5M] [--frames 60] [--only NAME,...] [--limit SECONDS]
                  [--repeat 1]

Every figure is of a whole run, from the start of the process to its last file: reading the mesh,
building what the program builds, and writing each frame as a jpg of 1280x720. Memory is the most
that one process of the run held.
"""

import argparse
import dataclasses
import os
import pathlib
import shutil
import signal
import subprocess
import sys
import tempfile
import threading
import time

import hills
import orbit

HERE = pathlib.Path(__file__).resolve().parent


@dataclasses.dataclass
class Peer:
    name: str
    has_shadows: bool
    needs: list  # programs that must be there; all of them
    commands: object  # (mesh, folder, frames) to a list of command lines
    is_ours: bool = False


@dataclasses.dataclass
class Run:
    seconds: float
    megabytes: float
    frames: int


def quarn_peer(quarn, mode, has_shadows):
    def commands(mesh, folder, frames):
        return [[quarn, "turntable", mesh, "--frames", str(frames), "--out", folder,
                 "--mode", mode, "--size", f"{orbit.WIDTH}x{orbit.HEIGHT}"]]  # fmt: skip

    return Peer(f"quarn, {mode}", has_shadows, [quarn], commands, is_ours=True)


def script(program, name, *rest):
    return lambda mesh, folder, frames: [
        [*program, str(HERE / name), mesh, folder, str(frames), *rest]
    ]


def blender(engine):
    def commands(mesh, folder, frames):
        return [["blender", "-b", "--factory-startup", "--python-exit-code", "1", "--python",
                 str(HERE / "blender_turntable.py"), "--", mesh, folder, str(frames), engine]]  # fmt: skip

    return commands


def f3d(mesh, folder, frames):
    """One process a frame: it has no animation of a camera."""
    triple = lambda values: ",".join(f"{v:.6f}" for v in values)
    return [
        ["f3d", mesh, f"--output={folder}/frame{frame:03d}.png",
         f"--resolution={orbit.WIDTH},{orbit.HEIGHT}", "--up=+Z",
         f"--camera-position={triple(orbit.camera(frame, frames))}",
         f"--camera-focal-point={triple(orbit.TARGET)}", "--camera-view-up=0,0,1",
         f"--camera-view-angle={orbit.LENS_DEG}"]
        for frame in range(frames)
    ]  # fmt: skip


def python_with(module):
    """The first Python here that finds the module; its name in words where there is none."""
    finding = f"import importlib.util, sys; sys.exit(importlib.util.find_spec('{module}') is None)"
    for python in (sys.executable, "/usr/bin/python3"):
        if subprocess.run([python, "-c", finding], check=False).returncode == 0:
            return python
    return f"python3 with {module}"


def all_peers(quarn):
    vtk = [python_with("vtk")]
    return [
        quarn_peer(quarn, "Shaded", False),
        quarn_peer(quarn, "Rendered", True),
        Peer("VTK script", False, vtk, script(vtk, "vtk_turntable.py")),
        Peer("ParaView pvbatch", False, ["pvbatch"], script(["pvbatch"], "paraview_turntable.py")),
        Peer("F3D, a process a frame", False, ["f3d"], f3d),
        Peer("Blender Workbench", False, ["blender"], blender("workbench")),
        Peer("Blender Workbench, shadows", True, ["blender"], blender("shadows")),
        Peer("Blender Cycles, 4 samples", True, ["blender"], blender("cycles")),
    ]


def is_installed(peer):
    return all(shutil.which(program) for program in peer.needs)


class Display:
    """An X server of our own for the programs that need one."""

    def __enter__(self):
        self.server = None
        if not shutil.which("Xvfb"):
            return self
        reading, writing = os.pipe()
        self.server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(writing), "-nolisten", "tcp", "-noreset",
             "-screen", "0", f"{orbit.WIDTH}x{orbit.HEIGHT}x24"],
            pass_fds=[writing], stderr=subprocess.DEVNULL)  # fmt: skip
        os.close(writing)
        with os.fdopen(reading) as answer:
            os.environ["DISPLAY"] = ":" + answer.readline().strip()
        return self

    def __exit__(self, *_):
        if self.server:
            self.server.terminate()
            self.server.wait()


class Failed(Exception):
    pass


def measure_one(command, log, limit):
    """Runs a command. Returns the most memory that it, or a process that it waited for, held."""
    process = subprocess.Popen(command, stdout=log, stderr=log, start_new_session=True)
    timer = threading.Timer(limit, lambda: os.killpg(process.pid, signal.SIGKILL))
    timer.start()
    _, status, usage = os.wait4(process.pid, 0)
    process.returncode = os.waitstatus_to_exitcode(status)
    timer.cancel()
    if process.returncode == -signal.SIGKILL:
        raise Failed(f"stopped after {limit:.0f} s")
    if process.returncode != 0:
        raise Failed(f"ended with {process.returncode}")
    return usage.ru_maxrss / 1024.0


def measure(peer, mesh, frames, limit):
    with tempfile.TemporaryDirectory() as folder, tempfile.TemporaryFile("w+") as log:
        start = time.monotonic()
        megabytes = 0.0
        try:
            for command in peer.commands(mesh, folder, frames):
                rest = limit - (time.monotonic() - start)
                megabytes = max(megabytes, measure_one(command, log, max(rest, 0.1)))
        except Failed as why:
            log.seek(0)
            last_words = log.read().strip().splitlines()[-1:]
            raise Failed(f"{why} {' '.join(last_words)}".strip()) from why
        seconds = time.monotonic() - start
        pictures = [file for file in pathlib.Path(folder).iterdir()
                    if file.suffix in (".jpg", ".png")]  # fmt: skip
        if len(pictures) != frames:
            raise Failed(f"{len(pictures)} of {frames} frames were written")
        return Run(seconds, megabytes, frames)


COLUMNS = ["triangles", "program", "seconds", "ms a frame", "peak MB"]


def print_cells(cells):
    print("| " + " | ".join(cells) + " |", flush=True)


def cells_of(size, peer, run):
    return [size, peer.name, f"{run.seconds:.2f}", f"{1000 * run.seconds / run.frames:.0f}",
            f"{run.megabytes:.0f}"]  # fmt: skip


def compare(size, peers, columns, options):
    with tempfile.TemporaryDirectory() as folder:
        mesh = os.path.join(folder, "hills.ply")
        # Not here: the peak memory of a program begins with what this process holds.
        subprocess.run([sys.executable, str(HERE / "hills.py"), size, mesh], check=True)
        own = {}
        for peer in peers:
            try:
                runs = [measure(peer, mesh, options.frames, options.limit)
                        for _ in range(options.repeat)]  # fmt: skip
            except Failed as why:
                print_cells([size, peer.name, str(why)] + (len(columns) - 3) * [""])
                continue
            run = min(runs, key=lambda each: each.seconds)
            if peer.is_ours:
                own[peer.has_shadows] = run.seconds
            base = own.get(peer.has_shadows)
            ratio = f"{run.seconds / base:.1f}" if base else ""
            print_cells((cells_of(size, peer, run) + [ratio])[: len(columns)])


def wanted(options):
    peers = all_peers(options.quarn)
    if options.only:
        words = [word.lower() for word in options.only.split(",")]
        peers = [peer for peer in peers if any(word in peer.name.lower() for word in words)]
    for peer in peers:
        if not is_installed(peer):
            print(f"not installed: {peer.name}", file=sys.stderr)
    return [peer for peer in peers if is_installed(peer)]


def read_options():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("quarn", help="the program quarn")
    parser.add_argument("--sizes", default="100k,1M,5M", help="of " + ", ".join(hills.CELLS))
    parser.add_argument("--frames", type=int, default=60)
    parser.add_argument("--only", help="names of programs, or parts of them")
    parser.add_argument("--limit", type=float, default=900.0, help="seconds that a run may take")
    parser.add_argument("--repeat", type=int, default=1, help="runs, the fastest of which counts")
    options = parser.parse_args()
    options.sizes = options.sizes.split(",")
    for size in options.sizes:
        if size not in hills.CELLS:
            parser.error(f"no size {size}; there are {', '.join(hills.CELLS)}")
    if options.frames < 1 or options.repeat < 1:
        parser.error("--frames and --repeat must be at least 1")
    return options


def main():
    options = read_options()
    peers = wanted(options)
    columns = list(COLUMNS)
    print(f"{options.frames} frames of {orbit.WIDTH}x{orbit.HEIGHT}, from process start to the "
          "last file", end="")  # fmt: skip
    if not all(peer.is_ours for peer in peers):
        columns.append("ratio")
        print("; the ratio is to quarn's own row with, or without, shadows", end="")
    print("\n")
    print_cells(columns)
    print("|" + len(columns) * "---|")
    with Display():
        for size in options.sizes:
            compare(size, peers, columns, options)


if __name__ == "__main__":
    main()
