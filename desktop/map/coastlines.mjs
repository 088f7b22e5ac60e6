// Makes coastlines.txt from the land of Natural Earth. README.md tells how to run it.
import { readFileSync, writeFileSync } from 'node:fs';

const TOLERANCE_DEG = 0.06; // how far a left-out point may lie from the line
const SMALLEST_DEG = 0.15; // islands and lakes that are smaller in both directions are left out
const STEPS_PER_DEG = 50; // of the numbers in the file

/// The arcs of a TopoJSON file in degrees.
function decodedArcs({ arcs, transform }) {
    return arcs.map((arc) => {
        let x = 0;
        let y = 0;
        return arc.map(([dx, dy]) => {
            x += dx;
            y += dy;
            return [
                x * transform.scale[0] + transform.translate[0],
                y * transform.scale[1] + transform.translate[1],
            ];
        });
    });
}

/// A ring, open, from the arcs it is made of; a negative index is the arc backwards.
function ring(indices, arcs) {
    const points = [];
    for (const index of indices) {
        const arc = index < 0 ? [...arcs[~index]].reverse() : arcs[index];
        points.push(...arc.slice(0, -1));
    }
    return points;
}

/// Follows a ring over the 180th meridian, so that neighbours are never half the earth apart. A
/// ring around a pole does not come back to its longitude: it is closed along the map's edge.
function unrolled(points) {
    const result = [points[0]];
    for (const [x, y] of points.slice(1)) {
        const last = result[result.length - 1][0];
        result.push([x + 360 * Math.round((last - x) / 360), y]);
    }
    const [first_x, first_y] = result[0];
    const last_x = result[result.length - 1][0];
    const turns = Math.round((last_x - first_x) / 360);
    if (turns !== 0) {
        const pole = first_y < 0 ? -90 : 90;
        const end_x = first_x + 360 * turns;
        result.push([end_x, first_y], [end_x, pole], [first_x, pole]);
    }
    return result;
}

/// What of a ring lies on one side of a meridian.
function clipped(points, meridian, keeps_west) {
    const isInside = ([x]) => (keeps_west ? x <= meridian : x >= meridian);
    const result = [];
    points.forEach((point, index) => {
        const before = points[(index + points.length - 1) % points.length];
        if (isInside(before) !== isInside(point)) {
            const share = (meridian - before[0]) / (point[0] - before[0]);
            result.push([meridian, before[1] + share * (point[1] - before[1])]);
        }
        if (isInside(point)) {
            result.push(point);
        }
    });
    return result;
}

/// The parts of an unrolled ring, each between the longitudes -180 and 180.
function partsOnTheMap(points) {
    return [-360, 0, 360]
        .map((turn) => points.map(([x, y]) => [x + turn, y]))
        .map((moved) => clipped(clipped(moved, -180, false), 180, true))
        .filter((part) => part.length > 2);
}

function distanceToSegment([x, y], [ax, ay], [bx, by]) {
    const length_squared = (bx - ax) ** 2 + (by - ay) ** 2;
    const along = length_squared === 0
        ? 0
        : Math.min(1, Math.max(0, ((x - ax) * (bx - ax) + (y - ay) * (by - ay)) / length_squared));
    return Math.hypot(x - ax - along * (bx - ax), y - ay - along * (by - ay));
}

/// Leaves out points that are hardly off the line (Douglas and Peucker, "Algorithms for the
/// reduction of the number of points", Cartographica 10, 1973).
function simplified(points) {
    if (points.length < 3) {
        return points;
    }
    const [first, last] = [points[0], points[points.length - 1]];
    let farthest = 0;
    let distance = 0;
    points.forEach((point, index) => {
        const here = distanceToSegment(point, first, last);
        if (here > distance) {
            [farthest, distance] = [index, here];
        }
    });
    if (distance <= TOLERANCE_DEG) {
        return [first, last];
    }
    const head = simplified(points.slice(0, farthest + 1));
    return [...head.slice(0, -1), ...simplified(points.slice(farthest))];
}

function simplifiedRing(points) {
    const closed = simplified([...points, points[0]]);
    return closed.slice(0, -1);
}

function isLargeEnough(points) {
    const size = (axis) => {
        const values = points.map((point) => point[axis]);
        return Math.max(...values) - Math.min(...values);
    };
    return Math.max(size(0), size(1)) >= SMALLEST_DEG;
}

/// A ring in steps: its first point, then how far each point is from the one before.
function line(points) {
    let [last_x, last_y] = [0, 0];
    const numbers = [];
    for (const [x, y] of points.map((point) => point.map((deg) => Math.round(deg * STEPS_PER_DEG)))) {
        if (numbers.length === 0 || x !== last_x || y !== last_y) {
            numbers.push(x - last_x, y - last_y);
            [last_x, last_y] = [x, y];
        }
    }
    return numbers.length >= 6 ? numbers.join(' ') : '';
}

const [source, target] = process.argv.slice(2);
const topology = JSON.parse(readFileSync(source, 'utf8'));
const arcs = decodedArcs(topology);
const lines = topology.objects.land.geometries
    .flatMap((geometry) => geometry.arcs)
    .flat()
    .map((indices) => unrolled(ring(indices, arcs)))
    .flatMap(partsOnTheMap)
    .filter(isLargeEnough)
    .map(simplifiedRing)
    .map(line)
    .filter((text) => text !== '');
writeFileSync(target, `${STEPS_PER_DEG}\n${lines.join('\n')}\n`);
