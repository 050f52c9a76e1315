#!/bin/sh
# fuzz.sh QM_RPS N: compare the program with the reference calculation on N random cases.
# Environment: FIRST (first seed, 1), RELTOL (1e-9), KEEP (folder for failing cases).
# Stops after five failing cases, which are kept; exit code 1 when there was any.
[ $# -eq 2 ] || { echo "usage: fuzz.sh QM_RPS N" >&2; exit 2; }
prog=$1; n=$2; here=$(cd "$(dirname "$0")" && pwd)
first=${FIRST:-1}; reltol=${RELTOL:-1e-9}
keep=${KEEP:-$(mktemp -d)}; mkdir -p "$keep"
tmp=$(mktemp -d); trap 'rm -rf "$tmp"' EXIT INT TERM
bad=0; done=0; seed=$first
while [ "$seed" -lt $((first + n)) ] && [ $bad -lt 5 ]; do
    python3 "$here/randomcase.py" "$seed" "$tmp/case.json" || exit 2
    python3 "$here/evaluate.py" "$tmp/case.json" > "$tmp/want.json" || exit 2
    "$prog" evaluate "$tmp/case.json" --json - > "$tmp/got.json" 2> "$tmp/err.txt"; rc=$?
    if [ $rc -gt 1 ]; then
        { echo "exit code $rc"; cat "$tmp/err.txt"; } > "$tmp/diff.txt"; same=1
    else
        python3 "$here/compare.py" "$tmp/want.json" "$tmp/got.json" "$reltol" > "$tmp/diff.txt" 2>&1
        same=$?
    fi
    if [ $same -ne 0 ]; then
        bad=$((bad + 1))
        for f in case want got diff; do
            for e in json txt; do
                [ -f "$tmp/$f.$e" ] && cp "$tmp/$f.$e" "$keep/seed$seed-$f.$e"
            done
        done
        echo "seed $seed (reference | program), files in $keep:"; head -n 20 "$tmp/diff.txt"
    fi
    done=$((done + 1)); seed=$((seed + 1))
done
echo "$done cases compared, $bad differ"
[ $bad -eq 0 ]
