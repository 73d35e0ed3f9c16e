#!/usr/bin/env bash
# Peak memory of a job beyond the decoded picture itself. See `bench/peak_memory.sh --help`.
set -euo pipefail
root=$(dirname "$(dirname "$(readlink -f "${BASH_SOURCE[0]}")")")
binary=$root/build/release/cli/stillmark
photoTool=$root/build/release/bench/stillmark_bench_photo
timer=/usr/bin/time
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT

usage()
{
    cat <<'END'
bench/peak_memory.sh [--binary PATH] [--photo-tool PATH] [--kernel K] [PHOTO] [-- OPTION...]
Runs the main job on PHOTO (made up, 6000 x 4000 JPEG, if none is given), or `deconvolve` with the kernel K, and prints
the peak of its memory and what that is above the decoded picture. Options after -- go to stillmark (--threads 1).
The scratch folder is $TMPDIR or /tmp. Needs the Debian package `time` and a release build with benchmarks.
END
}

photo='' kernel=''
while [ $# -gt 0 ]; do
    case $1 in
        -h | --help) usage; exit 0 ;;
        --binary | --photo-tool | --kernel)
            [ $# -ge 2 ] || { echo "peak_memory.sh: $1 wants a value" >&2; exit 2; }
            case $1 in
                --binary) binary=$2 ;;
                --photo-tool) photoTool=$2 ;;
                *) kernel=$2 ;;
            esac
            shift 2 ;;
        --) shift; break ;;
        -*) echo "peak_memory.sh: unknown option '$1'" >&2; usage >&2; exit 2 ;;
        *) [ -z "$photo" ] || { echo 'peak_memory.sh: one photo only' >&2; exit 2; }
            photo=$1; shift ;;
    esac
done
for program in "$binary" "$photoTool" "$timer"; do
    [ -x "$program" ] || { echo "peak_memory.sh: no program $program" >&2; exit 1; }
done

if [ -z "$photo" ]; then
    photo=$scratch/photo.jpg
    echo 'Making a photograph of 6000 x 4000 pixels' >&2
    "$photoTool" 6000 4000 "$photo"
fi
decoded=$("$photoTool" "$photo")

job=("$binary" "$photo")
[ -z "$kernel" ] || job=("$binary" deconvolve "$photo" --kernel "$kernel")
"$timer" -v -o "$scratch/time" "${job[@]}" -o "$scratch/result.${photo##*.}" "$@" >&2
peak=$(awk -F': ' '/Maximum resident set size/ { print $2 }' "$scratch/time") # KiB

awk -v peak="$peak" -v decoded="$decoded" 'BEGIN {
    mib = 1024 * 1024
    printf "peak %.0f MiB, decoded picture %.0f MiB, above it %.0f MiB\n", peak / 1024, decoded / mib, peak / 1024 - decoded / mib
}'
