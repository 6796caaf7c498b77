#!/usr/bin/env bash
# The Windows build under Wine: cross-builds kavu-cli.exe and the GoogleTest
# suite with the windows-cli preset and runs the suite; then runs the batch
# command on the example field book and on an example of every converter
# kind, each time with Windows paths (drive letters, backslashes, forward
# slashes, a relative path, folders with Vietnamese letters), and checks that
# it ends as the Linux build does and writes the same products byte for byte;
# the converted field books must also equal the converters' golden files.
#   tools/windows-test.sh [LINUX-KAVU-CLI]   (default build/debug/cli/kavu-cli)
# Installs what is missing (Debian 12) with apt-get first.
set -euo pipefail
cd "$(dirname "$0")/.."
root=$PWD

. tools/ensure-packages.sh
ensure_packages cmake ninja-build g++ libcli11-dev g++-mingw-w64-x86-64-posix wine

export CMAKE_GENERATOR=Ninja
cmake --preset windows-cli >/dev/null
cmake --build --preset windows-cli
exe=$root/build/windows-cli/cli/kavu-cli.exe
tests=$root/build/windows-cli/tests/kavu_tests.exe
linux=${1:-build/debug/cli/kavu-cli}
if [ ! -x "$linux" ]; then
  cmake --preset debug >/dev/null
  cmake --build --preset debug --target kavu-cli
fi
linux=$(realpath "$linux")

# A Wine prefix of our own; its first start (wineboot) is the slow part. The
# drive K: is the Windows side's work folder, so paths on another drive than
# Wine's Z: (the whole file system) are tried too.
export WINEPREFIX=$root/build/wine WINEDEBUG=-all LC_ALL=C.UTF-8
work=$root/build/windows-test
rm -rf "$work"
mkdir -p "$work/linux" "$work/windows" "$WINEPREFIX"
wineboot --init >/dev/null 2>&1
ln -sfn "$work/windows" "$WINEPREFIX/dosdevices/k:"

# The GoogleTest suite (all but the batch command's end-to-end tests, which
# need a POSIX shell; the runs below stand for them).
suite=0
wine "$tests" --gtest_brief=1 >"$work/kavu_tests.out" 2>&1 || suite=$?
tr -d '\r' <"$work/kavu_tests.out" | grep -E '^\[  (FAILED|PASSED|SKIPPED) ' || true
suiteCount=$(tr -d '\r' <"$work/kavu_tests.out" | sed -n 's/^\[  PASSED  \] \([0-9]*\) tests\?\./\1/p')

z_path() { # the Windows path of a Linux path on drive Z:, with backslashes
  printf 'Z:%s' "${1//\//\\}"
}

passed=0
failed=0
fail() {
  echo "FAIL $1: $2"
  failed=$((failed + 1))
}

# run_case NAME FOLDER STYLE INPUT [OPTIONS...]
#   FOLDER: the folder (relative) that gets the input, on both sides.
#   STYLE:  how the Windows side names the files: z-backslash, z-slash,
#           k-drive, relative, or drive-root (FOLDER is the drive R:, so the
#           regenerated field book goes to R:\TRIDO, beside the file).
run_case() {
  local name=$1 folder=$2 style=$3 input=$4
  shift 4
  local base
  base=$(basename "$input")
  local lin="$work/linux/$name" win="$work/windows/$name"
  mkdir -p "$lin/$folder" "$win/$folder"
  cp "$input" "$lin/$folder/$base"
  cp "$input" "$win/$folder/$base"
  # A control-point file goes beside the input; "@" in an option names it.
  local -a linArgs=() winArgs=()
  local option winFile
  for option in "$@"; do
    if [[ $option == @* ]]; then
      cp "${option#@}" "$lin/$folder/"
      cp "${option#@}" "$win/$folder/"
      linArgs+=("$lin/$folder/$(basename "${option#@}")")
      winArgs+=("$(win_name "$style" "$name" "$folder/$(basename "${option#@}")")")
    else
      linArgs+=("$option")
      winArgs+=("$option")
    fi
  done
  winFile=$(win_name "$style" "$name" "$folder/$base")
  [ "$style" != drive-root ] || ln -sfn "$win/$folder" "$WINEPREFIX/dosdevices/r:"

  local linCode=0 winCode=0
  "$linux" --seed 1 "${linArgs[@]}" "$lin/$folder/$base" >"$work/$name.linux.out" 2>/dev/null ||
    linCode=$?
  (cd "$win" && wine "$exe" --seed 1 "${winArgs[@]}" "$winFile") >"$work/$name.windows.out" \
    2>"$work/$name.windows.err" || winCode=$?
  if [ "$linCode" != "$winCode" ]; then
    fail "$name" "exit status $winCode on Windows, $linCode on Linux ($(tr -d '\r' <"$work/$name.windows.err"))"
    return
  fi
  # The counts of the summary (its times differ).
  if ! cmp -s <(head -n 3 "$work/$name.linux.out") <(tr -d '\r' <"$work/$name.windows.out" | head -n 3); then
    fail "$name" "the summary differs"
    return
  fi
  if [ "$style" = drive-root ] && [ -d "$lin/TRIDO" ]; then mv "$lin/TRIDO" "$lin/$folder/"; fi
  if ! diff -r "$lin" "$win" >"$work/$name.diff"; then
    fail "$name" "the products differ (see $work/$name.diff)"
    return
  fi
  passed=$((passed + 1))
}

# win_name STYLE CASE RELATIVE: the Windows side's name for a file of a case.
win_name() {
  local style=$1 name=$2 relative=$3
  case "$style" in
    z-backslash) z_path "$work/windows/$name/$relative" ;;
    z-slash) printf 'z:%s' "$work/windows/$name/$relative" ;;
    k-drive) local r="K:/$name/$relative" && printf '%s' "${r//\//\\}" ;;
    relative) printf '%s' "${relative//\//\\}" ;;
    drive-root) local r="R:/${relative#*/}" && printf '%s' "${r//\//\\}" ;;
  esac
}

# golden NAME FOLDER INPUT: the field book converted from INPUT must equal the
# converter's golden file beside it.
golden() {
  local name=$1 folder=$2 input=$3
  local book="$work/windows/$name/$folder/$(basename "${input%%.*}").asc"
  if cmp -s "$book" "${input%.*}.asc"; then
    passed=$((passed + 1))
  else
    fail "$name" "the converted field book differs from ${input%.*}.asc"
  fi
}

vn='Khảo sát đợt 1/Xã Đồng Tâm'
ex=examples/instruments
run_case job1 "$vn" z-backslash examples/job1.asc --all
run_case job1-slash "$vn" z-slash examples/job1.asc --all
run_case job1-k-drive "$vn" k-drive examples/job1.asc --all
run_case job1-drive-root 'Tổ 3' drive-root examples/job1.asc --all
run_case job1-relative "$vn" relative examples/job1.asc --all
run_case sdr "$vn" z-backslash $ex/job-sdr.sdr --all
run_case obs "$vn" k-drive $ex/job-obs.obs --all
run_case set "$vn" relative $ex/job-set.set --all
run_case idx "$vn" z-backslash $ex/job-idx.idx --all --control-file @$ex/job-idx-tcm-control.txt
run_case tcm "$vn" k-drive $ex/job-tcm.tcm --all --control-file @$ex/job-idx-tcm-control.txt
cp $ex/job-sdr.sdr "$work/job-gre.gre"
run_case gre "$vn" relative "$work/job-gre.gre" --all
shopt -s nullglob
for input in tests/data/import/*/*.{sdr,obs,set,idx,tcm}; do
  kind=$(basename "$(dirname "$input")")
  run_case "golden-$kind" "$vn" k-drive "$input" --txt
  golden "golden-$kind" "$vn" "$input"
done

echo "Windows GoogleTest suite: ${suiteCount:-0} passed$([ "$suite" -eq 0 ] || echo ", FAILED (see $work/kavu_tests.out)")"
echo "Windows runs of kavu-cli.exe: $passed passed, $failed failed"
[ "$failed" -eq 0 ] && [ "$suite" -eq 0 ]
