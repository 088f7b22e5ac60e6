#!/usr/bin/env bash
# Makes the picture of docs/sun-hours.md again, with the program as it is built now: the plan of the
# example pavilion and its court on 21 March.
# BUILD   the folder it is built in (build/release)
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

build=$(realpath "${BUILD:-build/release}")
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
"$build/examples/make_pavilion" "$work" >/dev/null
"$build/bin/quarn" sunhours "$work/pavilion.obj" --place Athens --date 2026-03-21 --view plan \
    --size 900x900 --isolines 2 --out "$work/out" >/dev/null
convert "$work/out/pavilion-sunhours.png" -quality 90 docs/images/sun-hours.jpg
