#!/usr/bin/env bash
# Seeded faults: each fault of tools/mutations.txt is put into a scratch copy
# of the sources (build/mutate/src; the working tree is never touched), built
# and tested; a fault is killed when a test fails, survives when the suite
# stays green, and is not applicable when its text does not match exactly once
# or the faulty tree does not build.
#
#   tools/mutate.sh [-m] [-k] [FILTER]
#
#   FILTER  run only the faults whose line contains this text (a file name)
#   -m      matrix: run the whole suite for each fault and list every failing
#           test (build/mutate/matrix.txt), to find tests that catch nothing
#           another test does not; without it ctest stops at the first failure
#   -k      keep the scratch build of an earlier call (faster)
#
# A line of mutations.txt: FILE ==> OLD ==> NEW. OLD is an exact text that must
# occur once in FILE, or "re:" and a regular expression (Python) that must match
# on exactly one line; NEW replaces it (nothing: the text is dropped). Lines
# starting with "#" and blank lines are skipped. Faults in ui/ build the window
# and run its tests too.
set -uo pipefail
cd "$(dirname "$0")/.."
top=$PWD
matrix=0
keep=0
while getopts "mk" opt; do
  case $opt in
    m) matrix=1 ;;
    k) keep=1 ;;
    *) exit 64 ;;
  esac
done
shift $((OPTIND - 1))
filter="${1:-}"
work=$top/build/mutate
src=$work/src

sync_sources() {
  mkdir -p "$src"
  git ls-files -z | while IFS= read -r -d '' f; do
    if [[ ! -e "$src/$f" ]] || ! cmp -s "$f" "$src/$f"; then
      mkdir -p "$src/$(dirname "$f")"
      cp "$f" "$src/$f"  # a fresh time, so that ninja rebuilds it
    fi
  done
}

configure() {  # build folder, ui ON/OFF
  [[ -f "$1/build.ninja" ]] && return 0
  cmake -S "$src" -B "$1" -G Ninja -DCMAKE_BUILD_TYPE=Debug -DKAVU_BUILD_UI="$2" \
    -DKAVU_BUILD_BENCH=OFF -DCMAKE_CXX_COMPILER_LAUNCHER=ccache >"$work/configure.log" 2>&1
}

# Applies one fault to the scratch copy; exit 3 when it does not match once.
apply() {
  python3 - "$src/$1" "$2" "$3" <<'EOF'
import re, sys
path, old, new = sys.argv[1], sys.argv[2], sys.argv[3]
text = open(path, encoding="latin-1").read()
if old.startswith("re:"):
    rx = re.compile(old[3:])
    lines = text.split("\n")
    hits = [i for i, line in enumerate(lines) if rx.search(line)]
    if len(hits) != 1:
        sys.exit(3)
    lines[hits[0]] = rx.sub(lambda m: new, lines[hits[0]], count=1)
    text = "\n".join(lines)
else:
    if text.count(old) != 1:
        sys.exit(3)
    text = text.replace(old, new)
open(path, "w", encoding="latin-1").write(text)
EOF
}

[[ $keep == 1 ]] || rm -rf "$work"
mkdir -p "$work"
sync_sources
# The real recordings beside the tree, where the copy's tests look for them.
[[ -d "$top/../shared" && ! -e "$work/shared" ]] && ln -s "$top/../shared" "$work/shared"
: >"$work/results.txt"
[[ $matrix == 1 ]] && : >"$work/matrix.txt"

killed=0 survived=0 na=0 n=0
survivors=()
while IFS= read -r line; do
  [[ -z "${line// /}" || "$line" == \#* ]] && continue
  [[ -n "$filter" && "$line" != *"$filter"* ]] && continue
  file="${line%% ==> *}"
  rest="${line#* ==> }"
  old="${rest%% ==> *}"
  new="${rest#* ==> }"
  [[ "$rest" == *" ==> "* ]] || new=""
  n=$((n + 1))
  ui=OFF
  [[ "$file" == ui/* ]] && ui=ON
  build=$work/build-ui-$ui
  configure "$build" "$ui"
  # The copy taken at the start, not the working tree, which may change while
  # the faults run.
  cp "$src/$file" "$work/unfaulted"
  targets=(--target kavu_tests kavu-cli)
  [[ $ui == ON ]] && targets=()
  verdict=""
  if ! apply "$file" "$old" "$new"; then
    verdict="not applicable (no single match)"
  elif ! cmake --build "$build" "${targets[@]}" >"$work/build.log" 2>&1; then
    verdict="not applicable (does not build)"
  elif [[ $matrix == 1 ]]; then
    fails=$(cd "$build" && {
      timeout 600 tests/kavu_tests --gtest_brief=1 2>&1 |
        sed -n 's/^\[  FAILED  \] \([A-Za-z0-9_/.]*\).*/\1/p'
      for t in tests/ui/ui_*_test; do  # QtTest: "FAIL!  : Class::case()"
        [[ -x $t ]] || continue
        QT_QPA_PLATFORM=offscreen timeout 600 "$t" 2>&1 | sed -n 's/^FAIL!  : \([^ (]*\).*/\1/p'
      done
    } | sort -u | tr '\n' ' ')
    if [[ -n "$fails" ]]; then verdict="killed"; else verdict="survived"; fi
    echo "$n $file | $old | $fails" >>"$work/matrix.txt"
  elif (cd "$build" && QT_QPA_PLATFORM=offscreen timeout 900 ctest -j2 --stop-on-failure \
    >"$work/test.log" 2>&1); then
    verdict="survived"
  else
    verdict="killed"
  fi
  cp "$work/unfaulted" "$src/$file"  # a fresh time, so that ninja rebuilds it
  case $verdict in
    killed) killed=$((killed + 1)) ;;
    survived) survived=$((survived + 1)); survivors+=("$n $file: $old ==> $new") ;;
    *) na=$((na + 1)) ;;
  esac
  printf '%3d %-9s %s: %s\n' "$n" "${verdict%% *}" "$file" "$old" | tee -a "$work/results.txt"
done <"$src/tools/mutations.txt"  # the list as it stood at the start

total=$((killed + survived))
echo "killed $killed / $total, survived $survived, not applicable $na" | tee -a "$work/results.txt"
if ((total > 0)); then
  echo "score $((100 * killed / total)) %" | tee -a "$work/results.txt"
fi
for s in "${survivors[@]}"; do echo "survives: $s"; done | tee -a "$work/results.txt"
