#!/usr/bin/env bash
# Builds the libFuzzer targets of fuzz/ in build/fuzz (clang, with the address
# and undefined-behaviour sanitizers) and runs each one in turn:
#   tools/fuzz.sh [SECONDS [TARGET...]]   (default: 60 seconds, every target)
# Each target starts from its seeds in fuzz/corpus/TARGET and keeps what it
# learns in build/fuzz/corpus/TARGET; an input that crashes a target is kept
# as build/fuzz/crashes/TARGET-* and the script fails.
set -euo pipefail
cd "$(dirname "$0")/.."
seconds="${1:-60}"
shift || true
targets=("$@")
((${#targets[@]})) || targets=(fuzz_converters fuzz_run fuzz_cli fuzz_control)

. tools/ensure-packages.sh
ensure_packages clang libclang-rt-14-dev cmake ninja-build libcli11-dev

launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
CXX=clang++ cmake -S . -B build/fuzz -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DKAVU_BUILD_FUZZ=ON -DKAVU_SANITIZE=ON -DKAVU_BUILD_UI=OFF -DKAVU_BUILD_TESTS=OFF \
  "${launcher[@]}"
cmake --build build/fuzz --target "${targets[@]}"

mkdir -p build/fuzz/crashes
for target in "${targets[@]}"; do
  mkdir -p "build/fuzz/corpus/$target"
  echo "== $target: ${seconds} s"
  "build/fuzz/fuzz/$target" -max_total_time="$seconds" -timeout=20 -rss_limit_mb=2048 \
    -print_final_stats=1 -artifact_prefix="build/fuzz/crashes/$target-" \
    "build/fuzz/corpus/$target" "fuzz/corpus/$target"
done
