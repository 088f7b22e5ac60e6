#!/usr/bin/env bash
# Runs a program on a display and with a home of its own, and ends what that leaves running.
#   run.sh PROGRAM [ARGUMENT...]
set -euo pipefail

for tool in xvfb-run Xvfb xauth import; do
    command -v "$tool" >/dev/null || {
        echo "cocoa tests: $tool is not installed; run ./dev setup" >&2
        exit 2
    }
done

home=$(mktemp -d)
mark=QUARN_COCOA_RUN=$$.$RANDOM
export "${mark?}"

# GNUstep starts a notification centre and a pasteboard server that outlive their programs. They
# have our mark in their environment; everything else is left alone.
end_what_is_left() {
    local found process
    for found in /proc/[0-9]*/environ; do
        process=${found//[!0-9]/}
        [[ $process -ne $$ && $process -ne $BASHPID ]] || continue
        if tr '\0' '\n' 2>/dev/null <"$found" | grep -qx "$mark"; then
            kill "$process" 2>/dev/null || true
        fi
    done
    rm -rf "$home"
}
trap end_what_is_left EXIT
trap 'exit 143' TERM INT

# GNUstep takes the user's folders from this file; HOME alone does not move them.
system_file=$(gnustep-config --variable=GNUSTEP_CONFIG_FILE 2>/dev/null || true)
cat "${system_file:-/etc/GNUstep/GNUstep.conf}" >"$home/GNUstep.conf" 2>/dev/null || true
cat >>"$home/GNUstep.conf" <<FOLDERS
GNUSTEP_USER_CONFIG_FILE=$home/none
GNUSTEP_USER_DEFAULTS_DIR=$home/Defaults
GNUSTEP_USER_DIR_LIBRARY=$home/Library
FOLDERS

export HOME=$home TMPDIR=$home GNUSTEP_CONFIG_FILE=$home/GNUstep.conf
export LC_ALL=C.UTF-8
# In the background, because a signal is only worked on between commands, or while waiting.
xvfb-run -a -e "$home/display.log" -s "-screen 0 800x600x24" "$@" &
wait $!
