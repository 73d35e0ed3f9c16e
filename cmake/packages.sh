# shellcheck shell=bash
# The Debian packages that this project stands on, and what ./check and ./stillmark share. To be sourced.

# shellcheck disable=SC2034 # both lists are read by whoever sources this file
buildPackages=(
    g++ cmake ninja-build pkg-config
    libfftw3-dev libtbb-dev libpng-dev libvips-dev liblcms2-dev libcli11-dev
    libsdl2-dev libcairo2-dev libpango1.0-dev librsvg2-bin
)
# shellcheck disable=SC2034
testPackages=(libgtest-dev libgmock-dev libbenchmark-dev xvfb xdotool clang-format python3)

# missingPackages PACKAGE...: prints those that are not installed, one a line.
missingPackages()
{
    # dpkg-query complains about packages that it has never heard of, and answers for the rest.
    local installed
    installed=$(dpkg-query -W -f='${db:Status-Status} ${Package}\n' "$@" 2>/dev/null | sed -n 's/^installed //p') || true
    comm -23 <(printf '%s\n' "$@" | sort -u) <(sort -u <<<"$installed")
}

# ensurePackages PACKAGE...: installs what is missing and says so first; silent where nothing is. Output on stderr.
ensurePackages()
{
    if ! command -v dpkg-query >/dev/null || ! command -v apt-get >/dev/null; then
        echo "Not a Debian system: taking for granted what these packages hold: $*" >&2
        return 0
    fi

    local missing=() asRoot=()
    mapfile -t missing < <(missingPackages "$@")
    [ ${#missing[@]} -gt 0 ] || return 0

    echo "Installing ${#missing[@]} missing Debian packages: ${missing[*]}" >&2
    if [ "$(id -u)" != 0 ]; then
        if ! command -v sudo >/dev/null; then
            echo "This needs root, and there is no sudo. As root, run:" >&2
            echo "    apt-get install --no-install-recommends ${missing[*]}" >&2
            return 1
        fi
        asRoot=(sudo)
    fi
    asRoot+=(env DEBIAN_FRONTEND=noninteractive apt-get -qq -o DPkg::Lock::Timeout=300 -o Dpkg::Use-Pty=0)
    "${asRoot[@]}" update >&2
    "${asRoot[@]}" install -y --no-install-recommends "${missing[@]}" </dev/null >&2
}
