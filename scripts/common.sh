# shellcheck shell=bash
# Sourced by the scripts beside it.

# shellcheck disable=SC2034  # the scripts use them
{
    build_packages=(cmake g++ make ninja-build openjdk-17-jdk-headless libgles-dev libegl-dev libegl-mesa0 libgl1-mesa-dri
        libcli11-dev libglfw3-dev ffmpeg)
    lint_packages=(clang clang-format clang-tidy git python3 shellcheck)
    test_packages=(clang libgtest-dev junit4 aapt android-framework-res python3 xz-utils
        glslang-tools binutils llvm valgrind xvfb xauth xdotool
        libpng-dev libsdl2-dev libsdl2-image-dev)
    fuzz_packages=(clang libclang-rt-dev llvm)
    arm64_packages=(g++-aarch64-linux-gnu qemu-user mmdebstrap uidmap xvfb xauth xdotool)
    arm64_root_packages=libglfw3-dev,libpng-dev,libgles-dev,libegl-dev,libegl-mesa0,libgl1-mesa-dri
    android_packages=(clang lld llvm libc++-14-dev libc6-dev-arm64-cross libc6-dev-armel-cross android-liblog-dev
        android-platform-frameworks-native-headers android-libnativehelper-dev android-framework-res
        python3 xz-utils proguard-cli aapt zip zipalign apksigner)
    android_test_packages=(enjarify unzip)
    web_packages=(cmake ninja-build openjdk-17-jdk-headless emscripten)
    web_test_packages=(chromium firefox-esr webkit2gtk-driver xvfb xauth)
    bench_packages=(clang libbenchmark-dev libeigen3-dev python3)
}

# refuse USAGE REASON
refuse() {
    echo "$2; usage: $1" >&2
    exit 2
}

# no_more_arguments USAGE ARGUMENT...: what is left when a script has taken its own arguments. Prints the usage if that
# is --help, and refuses anything else.
no_more_arguments() {
    local usage=$1
    shift
    [ $# -gt 0 ] || return 0
    if [ "$1" = --help ]; then
        echo "usage: $usage"
        exit
    fi
    refuse "$usage" "unknown argument $1"
}

# configure_program: makes build/release ready to build the desktop program, without what only tests and benchmarks need.
configure_program() {
    [ -f build/release/build.ninja ] || cmake --preset release -DTIDEMARK_TESTS=OFF -DTIDEMARK_BENCH=OFF >/dev/null
}

# install_missing PACKAGE...: installs the Debian packages that are not there, as root or through sudo.
install_missing() {
    local missing=()
    local package
    for package in "$@"; do
        dpkg-query --show --showformat='${db:Status-Abbrev}' "$package" 2>/dev/null | grep -q '^ii' || missing+=("$package")
    done
    [ ${#missing[@]} -gt 0 ] || return 0
    local sudo=()
    [ "$(id -u)" -eq 0 ] || sudo=(sudo)
    echo "Going to install with ${sudo[*]:+sudo }apt-get: ${missing[*]}"
    "${sudo[@]}" apt-get update -qq
    "${sudo[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends "${missing[@]}"
}
