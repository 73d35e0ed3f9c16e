# shellcheck shell=bash
# Configuring and building, shared by ./check and ./stillmark. To be sourced, with the checkout as current directory.

# locked COMMAND...: runs it while no other script of this checkout configures or builds.
locked()
{
    mkdir -p build
    (
        flock 9
        "$@" 9>&-
    ) 9>build/.lock
}

# configured PRESET: whether build/PRESET can be built as it is; not so after the checkout was moved.
configured()
{
    [ -f "build/$1/build.ninja" ] && grep -qxF "CMAKE_HOME_DIRECTORY:INTERNAL=$PWD" "build/$1/CMakeCache.txt"
}

# configure PRESET [-D...]
configure()
{
    local preset=$1 fresh=()
    shift
    configured "$preset" || fresh=(--fresh)
    cmake --preset "$preset" "${fresh[@]}" "$@"
}
