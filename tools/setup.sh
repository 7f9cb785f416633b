#!/usr/bin/env bash
# Installs what the build, the tests and the benchmarks need on a Debian machine; with
# --fuzz also clang and libFuzzer's runtime, for the `fuzz` preset. The web review's
# browser test gets chromium and, in tests/web, its locked npm packages.
# Runs apt-get and npm only when something is missing, so it is cheap to call every time.
set -euo pipefail
packages=(cmake ninja-build g++ pkg-config googletest libgtest-dev libgmock-dev libbenchmark-dev
          nlohmann-json3-dev libpng-dev libedit-dev libfreetype-dev libdeflate-dev fonts-dejavu-core libassimp-dev
          libegl-dev libegl-mesa0 libgl1-mesa-dri
          libocct-foundation-dev libocct-modeling-data-dev libocct-modeling-algorithms-dev libocct-ocaf-dev
          libocct-data-exchange-dev libcpp-httplib-dev chromium)
# A machine that already has node (with its npm) keeps it.
command -v node >/dev/null && command -v npm >/dev/null || packages+=(nodejs npm)
for option in "$@"; do
  case "$option" in
    --fuzz) packages+=(clang libclang-rt-dev) ;;
    *) echo "usage: bash tools/setup.sh [--fuzz]" >&2; exit 2 ;;
  esac
done
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed' || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  echo "setup: installing ${missing[*]}"
  SUDO=""
  [ "$(id -u)" -eq 0 ] || SUDO="sudo"
  $SUDO apt-get update -qq
  DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq "${missing[@]}"
fi
web_tests="$(cd "$(dirname "$0")/../tests/web" && pwd)"
if [ ! -d "$web_tests/node_modules" ]; then
  echo "setup: installing the browser test's npm packages"
  (cd "$web_tests" && npm ci --no-audit --no-fund --loglevel=error)
fi
