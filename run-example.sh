#!/usr/bin/env bash
# Builds the batch command and computes the bundled example field book with
# every product, then shows the summary and the products written.
# Installs what is missing (Debian 12) with apt-get first.
set -euo pipefail
cd "$(dirname "$0")"

. tools/ensure-packages.sh
ensure_packages cmake ninja-build g++ libcli11-dev

# The release preset, in a folder of its own and with only the batch command:
# no tests, benchmarks or window, so nothing more is needed.
export CMAKE_GENERATOR=Ninja
cmake --preset release -B build/example -DKAVU_BUILD_TESTS=OFF -DKAVU_BUILD_BENCH=OFF \
  -DKAVU_BUILD_UI=OFF >/dev/null
cmake --build build/example --target kavu-cli

# The products go beside the field book, and the regenerated field book into
# TRIDO beside its folder: work on a copy under build/.
run=build/example-run
rm -rf "$run"
mkdir -p "$run/job"
cp examples/job1.asc "$run/job/"
echo
echo "kavu-cli --all --seed 1 $run/job/job1.asc"
status=0
build/example/cli/kavu-cli --all --seed 1 "$run/job/job1.asc" || status=$?
echo
echo "Products:"
(cd "$run" && find . -type f ! -path ./job/job1.asc | sort | sed 's|^\./|  '"$run"'/|')
exit "$status"
