#!/bin/sh
# checkExports.sh PLUGIN: the plug-in has one door, EntryFI.
set -eu
found=$(nm -D --defined-only "${1:?usage: checkExports.sh PLUGIN}" | awk '{ print $3 }')
[ "$found" = EntryFI ] || { echo "exported: $found" >&2; exit 1; }
