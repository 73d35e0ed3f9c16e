#!/bin/sh
# checkLayers.sh ROOT: compares every #include under ROOT with ROOT/tests/layers/layers.txt.
# Prints one line per include that breaks the table, `file:line: reason`; status 1 if there is one, 2 if it cannot run.
set -eu

root=${1:?usage: checkLayers.sh ROOT}
cd "$root"
table=tests/layers/layers.txt
[ -r "$table" ] || { echo "checkLayers: no $root/$table" >&2; exit 2; }

# Hidden folders, build trees and test data hold no source of ours; names with blanks do not occur.
files=$(find . \( -name '.?*' -o -path ./build -o -path ./tests/data \) -prune -o \
    -type f \( -name '*.h' -o -name '*.cpp' -o -name '*.hpp' -o -name '*.cc' -o -name '*.inc' \) -print | sed 's|^\./||' | sort)
[ -n "$files" ] || { echo "checkLayers: no source under $root" >&2; exit 2; }

# shellcheck disable=SC2086 # one word per file is meant
exec awk '
function complain(text) { printf "%s:%d: %s\n", FILENAME, FNR, text; broken++ }

# The row that speaks for a path: its longest leading folder in the table, or "".
function rowOf(path) {
    while (path != "" && !(path in allowed))
        if (!sub("/[^/]*$", "", path)) path = ""
    return path
}

function within(folder, above) { return folder == above || index(folder, above "/") == 1 }

function mayInclude(from, to, header,    list, n, i) {
    if (within(to, from)) return 1
    n = split(allowed[from], list, " ")
    for (i = 1; i <= n; i++)
        if (list[i] == "*" || within(to, list[i]) || header == list[i]) return 1
    return 0
}

function checkOutside(from, header,    start, list, n, i) {
    for (start in outside) {
        if (index("<" header, start) != 1) continue
        n = split(outside[start], list, " ")
        for (i = 1; i <= n; i++)
            if (within(from, list[i])) return
        complain("<" header "> belongs to " outside[start] ", not to " from)
    }
}

NR == FNR {
    sub("#.*", "")
    if (NF == 0) next
    colon = index($0, ":")
    if (!colon) { complain("a row is \"folder : folders\""); next }
    key = substr($0, 1, colon - 1); gsub("[ \t]", "", key)
    if (key ~ "^<") outside[key] = substr($0, colon + 1)
    else allowed[key] = substr($0, colon + 1)
    next
}

FNR == 1 {
    folder = FILENAME
    if (!sub("/[^/]*$", "", folder)) folder = ""
    row = rowOf(folder)
    if (row == "") complain("its folder has no row in the layer table")
}

row != "" && /^[ \t]*#[ \t]*include[ \t]*["<]/ {
    header = $0
    sub("^[ \t]*#[ \t]*include[ \t]*", "", header)
    quoted = header ~ "^\""
    sub("^[\"<]", "", header); sub("[\">].*", "", header)
    target = header
    if (!sub("/[^/]*$", "", target)) target = ""
    to = rowOf(target)
    if (to == "") {
        if (quoted) complain("\"" header "\" is not written from the project root")
        else checkOutside(folder, header)
    } else if (!mayInclude(row, target, header))
        complain(row " may not include " header)
}

END { exit broken ? 1 : 0 }
' "$table" $files
