#pragma once

namespace quarn::program {

inline constexpr const char* JOB_SCRIPT_START = R"BASH(#!/bin/bash
# Records an animation on a cluster. Written by quarn farm submit, which submitted it as an array of
# jobs ("frames FIRST": task K records line FIRST + K of CHUNKS) and as a last job ("finish": makes
# what is missing, then the page). A task that is stopped keeps its frames; run again, it goes on.
set -uo pipefail

)BASH";

inline constexpr const char* JOB_SCRIPT_END = R"BASH(
# A task that is stopped before its time is up goes back into the queue, but not for ever.
MOST_RESTARTS=20

THREADS=${SLURM_CPUS_PER_TASK:-1}
JOB=${SLURM_JOB_ID:?is not set: submit this script with sbatch}
# An array's own number would mean all of its tasks.
[ -n "${SLURM_ARRAY_TASK_ID-}" ] && JOB=${SLURM_ARRAY_JOB_ID}_$SLURM_ARRAY_TASK_ID

tell() { printf '[quarn farm] %s\n' "$*"; }

slurm_state() { squeue --noheader --jobs="$JOB" --format=%T 2>/dev/null; }

# Prints the path of the document's copy on this node, which is made where it is not there.
staged_document() {
    local folder=$STAGE/quarn-farm-$(id -u) state copy
    state=$(stat --dereference --format=%s-%.9Y -- "$DOCUMENT") || return
    copy=$folder/$STAGED_NAME-$state.staged.quarn
    mkdir -p -m 700 -- "$folder" || return
    [ -O "$folder" ] && [ ! -L "$folder" ] || return # somebody else's
    # One task copies, the others wait; the lock goes with its holder.
    exec 9>"$folder/$STAGED_NAME.lock" || return
    flock --wait 600 9
    if [ ! -f "$copy" ]; then
        find "$folder" -maxdepth 1 -type f -name '*.staged.quarn*' -mtime +7 -delete
        copy_whole "$copy" "$state" || return
    fi
    [ "$(stat --format=%s -- "$copy")" = "${state%%-*}" ] && printf '%s' "$copy"
}

# A copy has its name only once it is whole, and if the document did not change meanwhile.
copy_whole() {
    local part=$1.$HOSTNAME-$$
    cp --dereference -- "$DOCUMENT" "$part" &&
        [ "$(stat --dereference --format=%s-%.9Y -- "$DOCUMENT")" = "$2" ] &&
        mv -- "$part" "$1" && return
    rm -f -- "$part"
    return 1
}

child=
stop_asked=
must_ask_child=
# Slurm sends SIGTERM to all processes of a job that is cancelled or preempted, but to this script
# alone before its time is up. quarn ends between two frames; a second SIGTERM would end it at once.
on_term() {
    [ -z "$stop_asked" ] || return
    stop_asked=yes
    case $(slurm_state) in
    COMPLETING | CANCELLED | PREEMPTED) tell "$JOB was asked to stop" ;;
    *)
        tell "$JOB nears the end of its time"
        must_ask_child=yes
        ask_child
        ;;
    esac
}

# The signal may come before the program that it is for has started.
ask_child() {
    if [ -n "$child" ] && [ -n "$must_ask_child" ]; then
        must_ask_child=
        kill -TERM "$child"
    fi
}

run_quarn() {
    local status last
    [ -z "$stop_asked" ] || return 143
    "$QUARN" "$@" </dev/null &
    child=$!
    ask_child
    wait "$child"
    status=$?
    while kill -0 "$child" 2>/dev/null; do # a signal ended the wait
        wait "$child"
        status=$?
    done
    if [ -n "$stop_asked" ]; then
        wait "$child"
        last=$?
        [ "$last" = 127 ] || status=$last
    fi
    return "$status"
}

# A job that Slurm does not end by itself is put back into the queue.
requeue() {
    if [ "$(slurm_state)" != RUNNING ]; then
        return
    elif [ "${SLURM_RESTART_COUNT:-0}" -ge "$MOST_RESTARTS" ]; then
        tell "$JOB was started $MOST_RESTARTS times and is not started again"
    else
        trap '' TERM
        tell "$JOB goes back into the queue"
        scontrol requeue "$JOB" && sleep 30 # Slurm ends this script meanwhile
    fi
}

end_job() {
    tell "$JOB ended with $1"
    [ -n "$stop_asked" ] && [ "$1" = 143 ] && requeue
    exit "$1"
}

record_frames() {
    local document=$DOCUMENT
    if [ -n "$STAGE" ] && ! document=$(staged_document); then
        tell "the document cannot be copied into $STAGE: it is read where it is"
        document=$DOCUMENT
    fi
    run_quarn record "$document" --out "$OUT" --frames "$1" --threads "$THREADS" \
        ${RECORD_OPTIONS[@]+"${RECORD_OPTIONS[@]}"}
}

finish() {
    run_quarn finish "$OUT" --document "$DOCUMENT" --threads "$THREADS" "${FINISH_OPTIONS[@]}"
}

trap on_term TERM
tell "$JOB began on ${SLURMD_NODENAME:-$HOSTNAME}: $ANIMATION, $*"
case ${1-} in
frames) record_frames "${CHUNKS[$2 + SLURM_ARRAY_TASK_ID]}" ;;
finish) finish ;;
*) tell "give frames FIRST, or finish" && exit 2 ;;
esac
end_job $?
)BASH";

} // namespace quarn::program
