#!/usr/bin/env bash
# Makes the pictures of docs/materials.md again, with the program as it is built now.
#   docs/images/materials.sh [PICTURE...]      (metal glass sign wall paint web pavilion: all, where none is named)
# BUILD   the folder it is built in (build/release)
# BEFORE  a quarn built from the last commit before materials, for the left of the pavilion
# WEB     the folder of the npm package @webxr-input-profiles/assets 1.0.20, unpacked; the third
#         model is of Debian's package assimp-testmodels
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

build=$(realpath "${BUILD:-build/release}")
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
python3 docs/images/materials.py "$work"

# take NAME MODEL MODE SIZE OPTIONS...: a single picture, NAME.png
take() {
    "${program:-$build/bin/quarn}" turntable "$2" --frames 1 --mode "$3" --size "$4" "${@:5}" \
        --format png --out "$work/$1" >/dev/null
    mv "$work/$1"/*.png "$work/$1.png"
}

# lay PAGE'S_PICTURE COLUMNS NAME...: pictures beside one another, with white between them
lay() {
    montage "${@:3}" -tile "$2x" -geometry '1x1+4+4<' "$work/laid.png"
    convert "$work/laid.png" -shave 4x4 -quality 88 "docs/images/materials-$1.jpg"
}

# both NAME OPTIONS...: a sample in Rendered, and in RenderFull at its right
both() {
    take "$1-display" "$work/$1.glb" Rendered 640x400 "${@:2}"
    take "$1-traced" "$work/$1.glb" RenderFull 640x400 "${@:2}"
}

pair() {
    both "$@"
    lay "$1" 2 "$work/$1-display.png" "$work/$1-traced.png"
}

metal() { pair metal --start-angle -90 --elevation 30 --lens 85; }
glass() { pair glass --start-angle -70 --elevation 22 --lens 85; }
wall() { pair wall --start-angle -80 --elevation 5; }
sign() {
    pair sign --start-angle -80 --elevation 5 --distance 0.85 --light studio --exposure -3 \
        --ground off --background 0a0b0e
}
paint() {
    both car --start-angle -50 --elevation 18 --lens 85
    both device --start-angle -65 --elevation 18 --lens 85
    lay paint 2 "$work"/{car,device}-{display,traced}.png
}
web() {
    local profiles=${WEB:?names the folder of the package}/dist/profiles mode
    for mode in Rendered RenderFull; do
        take "1-$mode" /usr/share/assimp/models/glTF2/ClearCoat-glTF/ClearCoatTest.gltf $mode 420x420 \
            --start-angle -90 --elevation 4 --lens 85 --light studio --ground off
        take "2-$mode" "$profiles/hp-mixed-reality/left.glb" $mode 420x420 \
            --start-angle -60 --elevation 35 --lens 85
        take "3-$mode" "$profiles/magicleap-two/none.glb" $mode 420x420 \
            --start-angle -60 --elevation 35 --lens 85
    done
    lay web 3 "$work"/{1,2,3}-Rendered.png "$work"/{1,2,3}-RenderFull.png
}
pavilion() {
    local old=${BEFORE:?names the program of before} mode
    "$build/examples/make_pavilion" "$work" >/dev/null
    local view=(640x360 --hide Walk --start-angle -75 --elevation 9 --distance 0.62)
    for mode in Rendered RenderFull; do
        program=$old take "before-$mode" "$work/pavilion.obj" $mode "${view[@]}"
        take "after-$mode" "$work/pavilion.obj" $mode "${view[@]}"
    done
    lay pavilion-display 2 "$work"/{before,after}-Rendered.png
    lay pavilion-traced 2 "$work"/{before,after}-RenderFull.png
}

pictures=("$@")
[ $# -gt 0 ] || pictures=(metal glass sign wall paint web pavilion)
for picture in "${pictures[@]}"; do
    "$picture"
done
