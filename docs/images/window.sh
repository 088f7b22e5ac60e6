#!/usr/bin/env bash
# Takes the pictures of docs/window.md again, of the window as it is built now: opens the example
# model on a display of its own, and goes the way that the page shows with the mouse.
#   docs/images/window.sh [BUILD_FOLDER]      (build/release where none is named)
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

build=${1:-build/release}
model=$(mktemp -d)
trap 'rm -rf "$model"' EXIT
"$build/examples/make_pavilion" "$model" >/dev/null
"$build/tests/window_pictures" "$model/pavilion.obj" docs/images
