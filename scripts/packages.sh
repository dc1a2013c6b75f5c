# Sourced by the scripts beside it: installs the Debian packages that are missing, as root or through sudo.

build_packages=(cmake g++ ninja-build openjdk-17-jdk-headless libgles-dev libegl-dev libegl-mesa0 libgl1-mesa-dri
    libstb-dev libcli11-dev libglfw3-dev ffmpeg)
test_packages=(clang clang-format clang-tidy libgtest-dev glslang-tools binutils git valgrind xvfb xauth xdotool)
fuzz_packages=(clang libclang-rt-dev llvm)
arm64_packages=(g++-aarch64-linux-gnu qemu-user)
web_packages=(cmake ninja-build openjdk-17-jdk-headless emscripten)
web_test_packages=(chromium)
bench_packages=(clang libbenchmark-dev libeigen3-dev python3)

install_missing() {
    local missing=()
    local package
    for package in "$@"; do
        dpkg-query --show --showformat='${db:Status-Abbrev}' "$package" 2>/dev/null | grep -q '^ii' || missing+=("$package")
    done
    [ ${#missing[@]} -eq 0 ] && return
    echo "Installing ${missing[*]}"
    local sudo=()
    [ "$(id -u)" -eq 0 ] || sudo=(sudo)
    "${sudo[@]}" apt-get update -qq
    "${sudo[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends "${missing[@]}"
}
