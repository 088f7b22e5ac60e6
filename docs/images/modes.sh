#!/usr/bin/env bash
# Makes the pictures of docs/display-modes.md and docs/rendering.md again, with the program as it is
# built now: the example, and two models of Debian's package assimp-testmodels.
#   docs/images/modes.sh [BUILD_FOLDER]      (build/release where none is named)
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

build=${1:-build/release}
models=/usr/share/assimp/models
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
"$build/examples/make_pavilion" "$work" >/dev/null

# take NAME MODEL OPTIONS...: a single picture, NAME.png
take() {
    "$build/bin/quarn" turntable "$2" --frames 1 --format png --out "$work/$1" "${@:3}" >/dev/null
    mv "$work/$1"/*.png "$work/$1.png"
}

for mode in Wireframe Shaded Rendered Translucent X-Ray Drawing Clay; do
    shot=(--mode "$mode" --size 600x375)
    take pavilion "$work/pavilion.obj" "${shot[@]}" --hide Walk --elevation 30 --distance 0.97
    take spider "$models/OBJ/spider.obj" "${shot[@]}" --up y --start-angle 225 --elevation 15
    take bull "$models/PLY/Wuson.ply" "${shot[@]}" --up y --start-angle 40 --elevation 12
    montage "$work"/{pavilion,spider,bull}.png -tile 3x -geometry +4+4 "$work/laid.png"
    convert "$work/laid.png" -shave 4x4 -quality 90 "docs/images/modes-${mode,,}.jpg"
done

take render "$work/pavilion.obj" --mode RenderFull --samples 96 --size 1280x720 --hide Walk \
    --start-angle -86 --elevation 5 --distance 0.62
convert "$work/render.png" -quality 90 docs/images/render.jpg
