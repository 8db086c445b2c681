# Shared by the project's scripts: installs the Debian packages they need, once.
# What building and running the program needs:
PEMLA_BUILD_PACKAGES=(g++ cmake ninja-build qt6-base-dev qt6-svg-dev libgl-dev fonts-dejavu-core)
# What the tests, fuzzing, benchmarks and screenshots need on top:
PEMLA_TEST_PACKAGES=(libgtest-dev libgmock-dev libbenchmark-dev clang libclang-rt-14-dev
    clang-format xvfb xauth xdotool imagemagick appstream desktop-file-utils)

# Installs what is missing of the named packages (as root, or via sudo).
pemla_install() {
    local missing=()
    for package in "$@"; do
        dpkg-query -W -f='${Status}' "$package" 2>/dev/null | grep -q "ok installed" ||
            missing+=("$package")
    done
    [ ${#missing[@]} -eq 0 ] && return 0
    echo "Installing: ${missing[*]}"
    local sudo=()
    [ "$(id -u)" -eq 0 ] || sudo=(sudo)
    "${sudo[@]}" apt-get update -qq
    DEBIAN_FRONTEND=noninteractive "${sudo[@]}" apt-get install -y -qq --no-install-recommends \
        "${missing[@]}" >/dev/null
}

# Everything, for the test, fuzz, benchmark and screenshot commands.
pemla_install_missing() {
    pemla_install "${PEMLA_BUILD_PACKAGES[@]}" "${PEMLA_TEST_PACKAGES[@]}"
}
