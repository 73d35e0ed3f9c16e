#!/bin/sh
# checkLayers_test.sh CHECKER TABLE: the checker finds each kind of violation in small trees, and passes a clean one.
set -eu

checker=$1
table=$2
tree=$(mktemp -d)
trap 'rm -rf "$tree"' EXIT
failures=0

# expect STATUS TEXT FILE LINE: FILE with LINE in an otherwise clean tree gives STATUS and a message containing TEXT.
expect()
{
    rm -rf "${tree:?}"/*
    for folder in tests/layers platform/math deblur/estimate host; do mkdir -p "$tree/$folder"; done
    cp "$table" "$tree/tests/layers/layers.txt"
    echo '#include <fftw3.h>' > "$tree/platform/math/transform.cpp"
    printf '#include "deblur/estimate/array.h"\n#include <vips/vips.h>\n#include <vector>\n' > "$tree/host/photo.cpp"
    printf '#pragma once\n#include "platform/math/transform.h"\n' > "$tree/deblur/estimate/array.h"
    mkdir -p "$tree/$(dirname "$3")"
    printf '\n%s\n' "$4" > "$tree/$3"

    status=0
    output=$(sh "$checker" "$tree" 2>&1) || status=$?
    case $output in
        *"$2"*) found=yes ;;
        *) found=no ;;
    esac
    if [ "$status" != "$1" ] || [ "$found" = no ]; then
        echo "FAILED: $3 with $4: expected status $1 and \"$2\", got $status and \"$output\""
        failures=$((failures + 1))
    fi
}

expect 0 '' deblur/deconv/render.cpp '#include "deblur/estimate/array.h"'
expect 0 '' tests/host/photo_test.cpp '#include "host/photo.h"'
expect 0 '' host/plugin/run.h '#include "shell/tintorel.h"'
expect 1 'host may not include shell/virtualHeap.h' host/plugin/bad.h '#include "shell/virtualHeap.h"'
expect 1 'deblur may not include shell/tintorel.h' deblur/estimate/bad.h '#include "shell/tintorel.h"'
expect 1 'deblur/estimate/bad.cpp:2: deblur may not include host/photo.h' deblur/estimate/bad.cpp '#include "host/photo.h"'
expect 1 'platform may not include deblur' platform/bad.h '  #  include "deblur/estimate/array.h" // why not'
expect 1 'platform/math may not include platform/files.h' platform/math/bad.cpp '#include "platform/files.h"'
expect 1 'host may not include cli' host/bad.cpp '#include <cli/options.h>'
expect 1 '<fftw3.h> belongs to' deblur/estimate/bad.cpp '#include <fftw3.h>'
expect 1 '<vips/vips8> belongs to' cli/bad.cpp '#include <vips/vips8>'
expect 1 'not written from the project root' deblur/estimate/bad.cpp '#include "array.h"'
expect 1 'not written from the project root' deblur/estimate/bad.cpp '#include "../../host/photo.h"'
expect 1 'no row in the layer table' plugins/new.cpp '#include <vector>'

[ "$failures" = 0 ] || exit 1
echo "all as expected"
