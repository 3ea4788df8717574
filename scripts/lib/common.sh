# Shared by scripts/demo and scripts/test: install what is missing, then build.
# Source it from a script in scripts/.

TAVO_ROOT=$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd)
TAVO_BUILD_DIR="$TAVO_ROOT/build"

# Debian packages the build and the Wine environment need.
TAVO_PACKAGES=(
    cmake make git
    g++-mingw-w64-x86-64-posix
    googletest
    wine wine64
    xvfb
    ghostscript
    librecad-data
    clang-format
)

tavo_step() { printf '\n==> %s\n' "$*"; }

tavo_install_packages() {
    tavo_step "checking Debian packages"
    local missing=() pkg
    for pkg in "${TAVO_PACKAGES[@]}"; do
        dpkg-query -W -f='${Status}' "$pkg" 2>/dev/null | grep -q 'install ok installed' || missing+=("$pkg")
    done
    if [ ${#missing[@]} -eq 0 ]; then
        echo "all present"
        return 0
    fi
    echo "installing: ${missing[*]}"
    if [ "$(id -u)" -ne 0 ]; then
        echo "error: installing packages needs root" >&2
        return 1
    fi
    export DEBIAN_FRONTEND=noninteractive
    apt-get update -q
    apt-get install -y -q --no-install-recommends "${missing[@]}"
}

tavo_build() {
    tavo_step "configuring (preset mingw, build directory $TAVO_BUILD_DIR)"
    cmake --preset mingw -S "$TAVO_ROOT" >/dev/null
    tavo_step "building"
    cmake --build --preset mingw
}

# Stop the build's Wine environment when the calling script exits.
tavo_stop_wine_on_exit() {
    trap '"$TAVO_ROOT/scripts/wine-stop" "$TAVO_BUILD_DIR"' EXIT
}

# Checks that every C++ source the repository tracks is laid out as
# .clang-format says; lists the files that are not.
tavo_check_format() {
    tavo_step "checking the source format (clang-format)"
    local files
    mapfile -t files < <(cd "$TAVO_ROOT" && git ls-files '*.cpp' '*.h')
    if ! (cd "$TAVO_ROOT" && clang-format --dry-run --Werror "${files[@]}" 2>/dev/null); then
        echo "these files are not formatted (run clang-format -i on them):" >&2
        (cd "$TAVO_ROOT" && for f in "${files[@]}"; do
            clang-format --dry-run --Werror "$f" >/dev/null 2>&1 || echo "  $f" >&2
        done)
        return 1
    fi
    echo "all ${#files[@]} files formatted"
}
