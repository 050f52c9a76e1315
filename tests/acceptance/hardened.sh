#!/bin/sh
# A program is hardened: PIE, stack protector, fortified calls, and relocations that are read-only
# before it starts (full RELRO).
# Usage: hardened.sh PROGRAM...
set -eu
for program in "$@"; do
  has() { # WHAT TEXT PATTERN
    printf '%s\n' "$2" | grep -q -- "$3" || { echo "$program: no $1" >&2; exit 1; }
  }
  head=$(readelf -hW "$program")
  segments=$(readelf -lW "$program")
  dynamic=$(readelf -dW "$program")
  symbols=$(readelf --dyn-syms -W "$program")
  has PIE "$head" 'Type: *DYN'
  has RELRO "$segments" GNU_RELRO
  has BIND_NOW "$dynamic" 'BIND_NOW\|NOW'
  has "stack protector" "$symbols" __stack_chk_fail
  has FORTIFY "$symbols" '_chk@'
done
