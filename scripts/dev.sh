#!/usr/bin/env bash
# Set-up, build and the two everyday runs of the project:
#   scripts/dev.sh run    install what is missing, build, run itf-run over examples/
#   scripts/dev.sh test   install what is missing, build, run the tests (plain and sanitized)
set -euo pipefail
cd "$(dirname "$0")/.."

packages=(g++ cmake ninja-build bison re2c libcli11-dev nlohmann-json3-dev
          libgtest-dev libgmock-dev libbenchmark-dev binutils python3)

install_missing() {
    local missing=()
    for p in "${packages[@]}"; do
        dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
    done
    [ ${#missing[@]} -eq 0 ] && return 0
    echo "installing: ${missing[*]}"
    local sudo=""
    [ "$(id -u)" -ne 0 ] && sudo="sudo"
    $sudo apt-get update -qq
    DEBIAN_FRONTEND=noninteractive $sudo apt-get install -y -qq "${missing[@]}" >/dev/null
}

build() { # build DIR [cmake options...]
    local dir=$1; shift
    cmake -S . -B "$dir" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo "$@" >/dev/null
    cmake --build "$dir"
}

case "${1:-}" in
run)
    install_missing
    build build
    ./build/itf-run examples
    ;;
test)
    install_missing
    build build
    ctest --test-dir build --output-on-failure -j2
    build build-asan -DITF_SANITIZE=ON -DITF_BUILD_BENCH=OFF
    ASAN_OPTIONS=detect_leaks=1 UBSAN_OPTIONS=print_stacktrace=1 \
        ctest --test-dir build-asan --output-on-failure -j2
    ;;
*)
    echo "usage: scripts/dev.sh run|test" >&2
    exit 2
    ;;
esac
