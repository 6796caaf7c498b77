#!/usr/bin/env bash
# Differential check: the batch command of an earlier revision and of the
# working tree compute the same inputs; every product, the standard output
# (times left out) and the exit status must be the same.
#
#   tools/differential.sh REV [COUNT]
#
# Inputs: COUNT seeded generated field books (default 2000), every field book
# and instrument file under tests/ and examples/, and the real recordings in
# ../shared/realdata when they are there. Differences are listed, with the
# first differing lines, and the script exits 1.
set -euo pipefail
cd "$(dirname "$0")/.."
rev="${1:?usage: $0 REV [COUNT]}"
count="${2:-2000}"
top=$PWD
work=$top/build/differential
base_src=$work/base-src

. tools/ensure-packages.sh
ensure_packages cmake ninja-build g++ libcli11-dev python3

launcher=()
if command -v ccache >/dev/null; then launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache); fi
build_cli() {  # source folder, build folder
  cmake -S "$1" -B "$2" -G Ninja -DCMAKE_BUILD_TYPE=Release -DKAVU_BUILD_TESTS=OFF \
    -DKAVU_BUILD_BENCH=OFF -DKAVU_BUILD_UI=OFF "${launcher[@]}" >/dev/null
  cmake --build "$2" --target kavu-cli >/dev/null
}

rm -rf "$work"
mkdir -p "$work/inputs"
# A shallow clone may lack the earlier revision: fetch it, or say plainly that
# the comparison could not be made.
if ! git cat-file -e "$rev^{commit}" 2>/dev/null; then
  git fetch --quiet --unshallow 2>/dev/null || git fetch --quiet origin "$rev" 2>/dev/null || true
fi
if ! git cat-file -e "$rev^{commit}" 2>/dev/null; then
  echo "differential check not made: revision $rev is not in this clone" >&2
  exit 0
fi
git worktree add --detach -f "$base_src" "$rev" >/dev/null 2>&1
trap 'git worktree remove --force "$base_src" >/dev/null 2>&1 || true' EXIT
build_cli "$base_src" "$work/base-build"
build_cli "$top" "$work/new-build"

# One interpreter writes every generated book, each as the generator alone
# writes it for its seed.
python3 - "$count" "$work/inputs" <<'EOF'
import runpy, sys
count, folder = int(sys.argv[1]), sys.argv[2]
for i in range(1, count + 1):
    sys.argv = ["gen_fieldbook.py", str(i), f"{folder}/gen{i}.asc"]
    runpy.run_path("tools/gen_fieldbook.py")
EOF
while IFS= read -r -d '' f; do
  cp "$f" "$work/inputs/$(echo "${f#./}" | tr / _)"
done < <(find ./tests/data ./examples -type f \
  \( -iname '*.asc' -o -iname '*.sdr' -o -iname '*.gre' -o -iname '*.obs' -o -iname '*.set' \
     -o -iname '*.idx' -o -iname '*.tcm' \) -print0)
if [ -d ../shared/realdata ]; then
  for f in ../shared/realdata/*.*; do
    case "$f" in *.md) continue ;; esac
    cp "$f" "$work/inputs/real_$(basename "$f")"
  done
fi

# Each input is computed alone in a folder of its own, with every product.
run_one() {  # build, input, folder
  mkdir -p "$3/job"
  cp "$2" "$3/job/"
  local status=0
  "$1/cli/kavu-cli" --all --seed 7 "$3/job/$(basename "$2")" >"$3/stdout" 2>"$3/stderr" ||
    status=$?
  echo "$status" >"$3/status"
  # The start and end times are the only texts that depend on the clock; the
  # paths name the build's own folder.
  sed -i -E 's/[0-9]{2}:[0-9]{2}:[0-9]{2}/HH:MM:SS/' "$3/stdout"
  sed -i "s|$3/|FOLDER/|g" "$3/stdout" "$3/stderr"
}

# Both builds compute one input; a difference is written beside the results.
compare_one() {  # input
  local name
  name=$(basename "$1")
  run_one "$work/base-build" "$1" "$work/base/$name"
  run_one "$work/new-build" "$1" "$work/new/$name"
  if ! diff -r -q "$work/base/$name" "$work/new/$name" >/dev/null; then
    { echo "== $name"; diff -r "$work/base/$name" "$work/new/$name" | head -n 8 || true; } \
      >"$work/differences/$name"
  fi
}
export -f run_one compare_one
export work

mkdir -p "$work/differences"
find "$work/inputs" -type f -print0 | xargs -0 -n 1 -P "$(nproc)" bash -c 'compare_one "$0"'
checked=$(find "$work/inputs" -type f | wc -l)
differ=$(find "$work/differences" -type f | wc -l)
if [ "$differ" -gt 0 ]; then cat "$work/differences"/*; fi
echo "$checked inputs, $differ differ (base $rev)"
[ "$differ" -eq 0 ]
