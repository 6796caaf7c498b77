#!/usr/bin/env bash
# Builds everything and runs every test: ./run-tests.sh [debug|asan]
# (default debug; asan is the AddressSanitizer + UndefinedBehaviorSanitizer
# build). Installs what is missing (Debian 12) with apt-get first.
set -euo pipefail
cd "$(dirname "$0")"
preset="${1:-debug}"
case "$preset" in
  debug | asan | release) ;;
  *) echo "usage: $0 [debug|asan|release]" >&2; exit 64 ;;
esac

. tools/ensure-packages.sh
ensure_packages cmake ninja-build g++ libgtest-dev libcli11-dev qt6-base-dev qt6-l10n-tools qt6-tools-dev xvfb xauth \
  python3-ezdxf libbenchmark-dev fonts-dejavu-core fonts-noto-mono qt6-svg-dev poppler-utils

export CMAKE_GENERATOR=Ninja
cmake --preset "$preset"
cmake --build --preset "$preset" --parallel "$(nproc)"

# Leaks of the system libraries that Qt loads are not ours.
if [ "$preset" = asan ]; then
  export LSAN_OPTIONS="suppressions=$PWD/tests/lsan.supp${LSAN_OPTIONS:+:$LSAN_OPTIONS}"
fi

# The window's tests need a display: a virtual one when there is none.
run=()
if [ -z "${DISPLAY:-}" ] && command -v xvfb-run >/dev/null; then
  run=(xvfb-run -a)
fi
"${run[@]}" ctest --preset "$preset"
