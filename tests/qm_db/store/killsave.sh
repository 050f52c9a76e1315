#!/bin/sh
# Kills a process that saves in a loop, 100 times; after each kill the model file must be whole and
# hold the content from before or after the save that was hit, and the next editor must be able to
# open it and find no temporary file left.
# Usage: killsave.sh <killsave_helper>
set -eu

helper=$1
kills=100
folder=$(mktemp -d)
trap 'rm -rf "$folder"' EXIT
model=$folder/model.qmdb
log=$folder/log

run=0
hit=0 # kills that left a temporary file: these were in the middle of a save
while [ "$run" -lt "$kills" ]; do
    "$helper" save "$model" "$log" &
    saver=$!
    # 20 to 149 ms, spread evenly and the same in every run
    sleep "0.$(printf '%03d' $((20 + run * 37 % 130)))"
    if ! kill -9 "$saver" 2>/dev/null; then
        echo "killsave: the saver ended by itself in run $run" >&2
        exit 1
    fi
    wait "$saver" 2>/dev/null || true
    if [ "$(find "$folder" -name '*.qm.tmp-*' | wc -l)" -gt 0 ]; then hit=$((hit + 1)); fi
    if [ -e "$model" ]; then
        "$helper" check "$model" "$log" || { echo "killsave: run $run" >&2; exit 1; }
        if [ "$(find "$folder" -name '*.qm.tmp-*' | wc -l)" -gt 0 ]; then
            echo "killsave: a temporary file is left in run $run" >&2
            exit 1
        fi
    fi
    run=$((run + 1))
done

echo "killsave: $kills kills, $hit of them in the middle of a save"
if [ ! -e "$model" ] || [ "$hit" -lt 10 ]; then
    echo "killsave: too few kills hit a save" >&2
    exit 1
fi
